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
        {"{\"nodes\":[1e999]}", "a number that is too large for JSON"},
        {"[]", "array instead of an object"},
        {"7", "number \"7\" instead of an object"},
        {"{}", "no \"nodes\""},
        {"{\"nodes\":{}}", "nodes: object instead of an array"},
        {"{\"nodes\":null}", "nodes: null instead of an array"},
        {"{\"nodes\":[],\"nodes\":[]}", "key \"nodes\" is given twice"},
        {"{\"nodes\":[],\"extra\":1}", "unknown key \"extra\""},
        {"{\"nodes\":[1]}", "nodes[0]: number \"1\" instead of an object"},
        {"{\"nodes\":[],\"product\":{\"kvm\":1}}", "product.kvm: number \"1\" instead of true or false"},
        {"{\"nodes\":[],\"product\":{\"kvm\":true,\"kvm\":true}}", "product: key \"kvm\" is given twice"},
        {"{\"nodes\":[],\"product\":{\"path\":\"/\"}}", "product: unknown key \"path\""},
    };
    for (const Refused& each : refused) EXPECT_THAT(readTreeText(each.text).problem, StartsWith(each.problem));
}

TEST(TreeText, RefusesWhatIsNoNode) {
    const Refused refused[] = {
        {",\"path\":\"/c\"", "nodes[0]: key \"path\" is given twice"},
        {",\"typ\":1", "nodes[0]: unknown key \"typ\""},
        {",\"nodes\":[]", "nodes[0]: unknown key \"nodes\""},
        {",\"status\":\"1\"", "nodes[0].status: text instead of a whole number from 0 to 4294967295"},
        {",\"status\":true", "nodes[0].status: true or false instead of a whole number"},
        {",\"status\":-1", "nodes[0].status: number \"-1\" instead of a whole number"},
        {",\"status\":1.0", "nodes[0].status: number \"1.0\" instead of a whole number"},
        {",\"status\":4294967296", "nodes[0].status: number \"4294967296\" instead of a whole number"},
        {",\"status\":18446744073709551616", "nodes[0].status: number \"1.8446744073709552e+19\" instead of"},
        {",\"parent\":1", "nodes[0].parent: number \"1\" instead of a text"},
        {",\"properties\":[]", "nodes[0].properties: array instead of an object"},
        {",\"properties\":{\"1\":{}}", "nodes[0].properties.1: object instead of"},
        {",\"properties\":{\"1\":null}", "nodes[0].properties.1: null instead of"},
        {",\"properties\":{\"1\":true}", "nodes[0].properties.1: true or false instead of"},
        {",\"properties\":{\"1\":1,\"1\":2}", "nodes[0].properties: key \"1\" is given twice"},
        {",\"properties\":{\"01\":1}", "nodes[0].properties: property \"01\" is not a number in decimal"},
        {",\"properties\":{\"\":1}", "nodes[0].properties: property \"\" is not a number in decimal"},
        {",\"properties\":{\"-1\":1}", "nodes[0].properties: property \"-1\" is not a number in decimal"},
        {",\"properties\":{\"+1\":1}", "nodes[0].properties: property \"+1\" is not a number in decimal"},
        {",\"properties\":{\"0x10\":1}", "nodes[0].properties: property \"0x10\" is not a number in decimal"},
        {",\"properties\":{\"4294967296\":1}", "nodes[0].properties: property \"4294967296\" is not a number"},
        {",\"readOnly\":{}", "nodes[0].readOnly: object instead of an array"},
        {",\"readOnly\":[[]]", "nodes[0].readOnly[0]: array instead of a whole number"},
        {",\"readOnly\":[1,\"108\"]", "nodes[0].readOnly[1]: text instead of a whole number"},
        {",\"failWrites\":[-108]", "nodes[0].failWrites[0]: number \"-108\" instead of a whole number"},
        {",\"description\":\"a\\u0000b\"", "nodes[0].description: text with a zero byte"},
        {",\"parent\":\"\\u0000\"", "nodes[0].parent: text with a zero byte"},
        {",\"properties\":{\"108\":\"node7\\u0000\"}", "nodes[0].properties.108: text with a zero byte"},
    };
    for (const Refused& each : refused) {
        EXPECT_THAT(readTreeText(node(each.text)).problem, StartsWith(each.problem)) << each.text;
        EXPECT_TRUE(readTreeText(node(each.text)).nodes.empty()) << each.text;
    }
}

TEST(TreeText, RefusesNodesWithoutTypeOrPathAndPathsGivenTwice) {
    EXPECT_EQ(readTreeText(R"({"nodes":[{"type":1}]})").problem, "nodes[0]: no \"path\"");
    EXPECT_EQ(readTreeText(R"({"nodes":[{"path":"/"}]})").problem, "nodes[0]: no \"type\"");
    EXPECT_EQ(readTreeText(R"({"nodes":[{"type":1,"path":"/\u0000"}]})").problem,
              "nodes[0].path: text with a zero byte");
    EXPECT_EQ(readTreeText(R"({"nodes":[{"type":1,"path":""}]})").problem, "nodes[0].path: empty path");
    EXPECT_EQ(readTreeText(R"({"nodes":[{"type":1,"path":"/a"},{"type":2,"path":"/a"}]})").problem,
              "nodes[1].path: path \"/a\" is given twice");
}

TEST(TreeText, NamesTheObjectThatHasAKeyTwice) {
    EXPECT_EQ(
        readTreeText(R"({"nodes":[{"type":1,"path":"/a","readOnly":[1,2]},{"type":2,"path":"/b","type":2}]})").problem,
        "nodes[1]: key \"type\" is given twice");
}

TEST(TreeText, DoesNotChokeOnDeepNesting) {
    EXPECT_THAT(readTreeText(std::string(1 << 20, '[')).problem, StartsWith("not JSON at byte "));
    const std::string nested = std::string(1 << 18, '[') + std::string(1 << 18, ']');
    EXPECT_EQ(readTreeText(nested).problem, "array instead of an object");
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
