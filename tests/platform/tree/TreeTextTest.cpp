#include "tree/TreeText.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace VK::Tree {

namespace {

using testing::ElementsAre;
using testing::EndsWith;
using testing::StartsWith;

std::string node(const std::string& more) {
    return R"({"nodes":[{"type":40,"path":"/c")" + more + "}]}";
}

TEST(TreeText, ReadsEveryKeyOfANode) {
    const TreeText tree = readTreeText(R"({"nodes": [
        {"type": 40, "path": "/computer/0", "parent": "", "status": 1, "description": "Rack server",
         "properties": {"108": "node7", "123": 1, "127": 4294966996, "126": ""},
         "readOnly": [108], "unanswerable": [200, 4294967295], "failWrites": []},
        {"type": 1, "path": "/computer/0/chassis/0", "parent": "/computer/0"}]})");

    ASSERT_EQ(tree.problem, "");
    ASSERT_EQ(tree.nodes.size(), 2U);
    const Node& computer = tree.nodes[0];
    EXPECT_EQ(computer.type, 40U);
    EXPECT_EQ(computer.path, "/computer/0");
    EXPECT_EQ(computer.parent, "");
    EXPECT_EQ(computer.status, 1U);
    EXPECT_EQ(computer.description, "Rack server");
    EXPECT_THAT(computer.properties, ElementsAre(std::pair(108U, Value("node7")), std::pair(123U, Value(1U)),
                                                 std::pair(126U, Value("")), std::pair(127U, Value(4294966996U))));
    EXPECT_THAT(computer.readOnly, ElementsAre(108U));
    EXPECT_THAT(computer.unanswerable, ElementsAre(200U, 4294967295U));
    EXPECT_THAT(computer.failWrites, ElementsAre());
    EXPECT_EQ(tree.nodes[1].parent, "/computer/0");
    EXPECT_EQ(tree.nodes[1].status, 0U);
    EXPECT_EQ(tree.nodes[1].description, "");
}

TEST(TreeText, ReadsTheProductWhereverItStands) {
    const TreeText tree = readTreeText(
        R"({"nodes": [], "product": {"architecture": "s390x", "uid": "u", "rootDirectory": "/opt/vk/", "kvm": false}})");

    EXPECT_EQ(tree.problem, "");
    EXPECT_EQ(tree.product.architecture, "s390x");
    EXPECT_EQ(tree.product.uid, "u");
    EXPECT_EQ(tree.product.rootDirectory, "/opt/vk/");
    EXPECT_EQ(tree.product.kvm, false);
    EXPECT_FALSE(readTreeText(R"({"nodes": [], "product": {}})").product.kvm.has_value());
}

struct Refused {
    const char* text;
    const char* problem;
};

TEST(TreeText, RefusesWhatIsNoTreeAndSaysWhere) {
    const Refused refused[] = {
        {"", "not JSON at byte 1"},
        {"{", "not JSON at byte 2"},
        {"garbage", "not JSON at byte 1"},
        {"{\"nodes\":[]} x", "not JSON at byte 14"},
        {"[]", "array where it does not belong at byte 1"},
        {"7", "number where it does not belong"},
        {"{}", "no \"nodes\" at byte 2"},
        {"{\"nodes\":{}}", "object where it does not belong at byte 10"},
        {"{\"nodes\":null}", "null where it does not belong at byte 13"},
        {"{\"nodes\":[],\"nodes\":[]}", "key \"nodes\" is given twice at byte 19"},
        {"{\"nodes\":[],\"extra\":1}", "unknown key \"extra\" at byte 19"},
        {"{\"nodes\":[1]}", "number where it does not belong"},
        {"{\"nodes\":[],\"product\":{\"kvm\":1}}", "number where it does not belong"},
        {"{\"nodes\":[],\"product\":{\"kvm\":true,\"kvm\":true}}", "key \"kvm\" is given twice"},
        {"{\"nodes\":[],\"product\":{\"path\":\"/\"}}", "unknown key \"path\""},
    };
    for (const Refused& each : refused) EXPECT_THAT(readTreeText(each.text).problem, StartsWith(each.problem));
}

TEST(TreeText, RefusesWhatIsNoNode) {
    const Refused refused[] = {
        {",\"path\":\"/c\"", "key \"path\" is given twice"},
        {",\"typ\":1", "unknown key \"typ\""},
        {",\"nodes\":[]", "unknown key \"nodes\""},
        {",\"status\":\"1\"", "text where it does not belong"},
        {",\"status\":true", "true or false where it does not belong"},
        {",\"status\":-1", "negative number -1"},
        {",\"status\":1.0", "number \"1.0\" is not a whole one"},
        {",\"status\":4294967296", "number 4294967296 is too large"},
        {",\"status\":18446744073709551616", "number \"18446744073709551616\" is not a whole one or too large"},
        {",\"parent\":1", "number where it does not belong"},
        {",\"properties\":[]", "array where it does not belong"},
        {",\"properties\":{\"1\":{}}", "object where it does not belong"},
        {",\"properties\":{\"1\":null}", "null where it does not belong"},
        {",\"properties\":{\"1\":true}", "true or false where it does not belong"},
        {",\"properties\":{\"1\":1,\"1\":2}", "property \"1\" is given twice"},
        {",\"properties\":{\"01\":1}", "property \"01\" is not a number in decimal"},
        {",\"properties\":{\"\":1}", "property \"\" is not a number in decimal"},
        {",\"properties\":{\"-1\":1}", "property \"-1\" is not a number in decimal"},
        {",\"properties\":{\"0x10\":1}", "property \"0x10\" is not a number in decimal"},
        {",\"properties\":{\"4294967296\":1}", "property \"4294967296\" is not a number in decimal"},
        {",\"readOnly\":{}", "object where it does not belong"},
        {",\"readOnly\":[[]]", "array where it does not belong"},
        {",\"readOnly\":[\"108\"]", "text where it does not belong"},
        {",\"failWrites\":[-108]", "negative number -108"},
        {",\"description\":\"a\\u0000b\"", "text with a zero byte at byte "},
        {",\"parent\":\"\\u0000\"", "text with a zero byte at byte "},
        {",\"properties\":{\"108\":\"node7\\u0000\"}", "text with a zero byte at byte 66"},
    };
    for (const Refused& each : refused) {
        EXPECT_THAT(readTreeText(node(each.text)).problem, StartsWith(each.problem)) << each.text;
        EXPECT_TRUE(readTreeText(node(each.text)).nodes.empty()) << each.text;
    }
}

TEST(TreeText, RefusesNodesWithoutTypeOrPathAndPathsGivenTwice) {
    EXPECT_EQ(readTreeText(R"({"nodes":[{"type":1}]})").problem, "node without \"path\" at byte 20");
    EXPECT_EQ(readTreeText(R"({"nodes":[{"path":"/"}]})").problem, "node without \"type\" at byte 22");
    EXPECT_EQ(readTreeText(R"({"nodes":[{"type":1,"path":"/\u0000"}]})").problem, "text with a zero byte at byte 36");
    EXPECT_EQ(readTreeText(R"({"nodes":[{"type":1,"path":""}]})").problem, "empty path at byte 29");
    EXPECT_EQ(readTreeText(R"({"nodes":[{"type":1,"path":"/a"},{"type":2,"path":"/a"}]})").problem,
              "path \"/a\" is given twice at byte 54");
}

TEST(TreeText, DoesNotChokeOnDeepNesting) {
    EXPECT_THAT(readTreeText(std::string(1 << 20, '[')).problem, StartsWith("array where it does not belong"));
}

TEST(TreeText, ChangesOnePropertyAndNothingElse) {
    const std::string before =
        R"({"product":{"uid":"é"},"nodes":[{"path":"/a","type":1},{"path":"/b","type":1,"properties":{"7":"x","3":1}}]})";

    const TreeText added = readTreeText(changeTreeText(before, "/a", 200, Value(1U)));
    EXPECT_THAT(added.nodes[0].properties, ElementsAre(std::pair(200U, Value(1U))));
    EXPECT_EQ(added.product.uid, "é");

    EXPECT_EQ(changeTreeText(before, "/b", 7, Value("y\"\n")),
              R"({
  "product": {
    "uid": "é"
  },
  "nodes": [
    {
      "path": "/a",
      "type": 1
    },
    {
      "path": "/b",
      "type": 1,
      "properties": {
        "7": "y\"\n",
        "3": 1
      }
    }
  ]
}
)");
}

TEST(TreeText, RefusesChangesThatCannotBeWritten) {
    const std::string text = R"({"nodes":[{"type":1,"path":"/a"}]})";
    EXPECT_EQ(changeTreeText(text, "/b", 1, Value("x")), "");
    EXPECT_EQ(changeTreeText(text, "/a", 1, Value("\xFF")), "");
    EXPECT_EQ(changeTreeText(text, "/a", 1, Value(std::string("x\0y", 3))), "");
    EXPECT_EQ(changeTreeText("{", "/a", 1, Value("x")), "");
}

} // namespace

} // namespace VK::Tree
