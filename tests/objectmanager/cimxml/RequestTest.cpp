#include "objectmanager/cimxml/Request.h"

#include "objectmanager/cimxml/Document.h"
#include "objectmanager/cimxml/Errors.h"
#include "tests/objectmanager/cimxml/Messages.h"

#include <gmock/gmock.h>

namespace cimxml {
namespace {

using Kind = ValueElement::Kind;

TEST(Request, ReadsAnIntrinsicOperation) {
    const Request request = readRequest(
        intrinsic("EnumerateInstances",
                  parameter("ClassName", className("X")) + parameter("DeepInheritance", text("TRUE")) +
                      parameter("PropertyList", "<VALUE.ARRAY/>") + "<IPARAMVALUE NAME=\"LocalOnly\"></IPARAMVALUE>"));
    EXPECT_EQ(request.id, "4711");
    EXPECT_TRUE(request.intrinsic);
    EXPECT_EQ(request.name, "EnumerateInstances");
    EXPECT_EQ(request.nameSpace, "root/cimv2");
    ASSERT_EQ(request.parameters.size(), 4U);
    EXPECT_EQ(request.parameters[0].value.path->className, "X");
    EXPECT_EQ(request.parameters[1].value.text, "TRUE");
    EXPECT_EQ(request.parameters[2].value.kind, Kind::Array);
    EXPECT_EQ(request.parameters[3].value.kind, Kind::None);
}

TEST(Request, HasABoundedNumberOfElements) {
    const auto requestWith = [](int values) {
        std::string array;
        for (int i = 0; i < values; ++i) array += "<VALUE/>";
        return intrinsic("EnumerateInstances", parameter("PropertyList", "<VALUE.ARRAY>" + array + "</VALUE.ARRAY>"));
    };
    EXPECT_NO_THROW(readRequest(requestWith(mostElements - 100)));
    EXPECT_THROW(readRequest(requestWith(mostElements)), Refusal);
}

TEST(Request, ReadsAMethodOfAnInstanceAndOfAClass) {
    const auto method = [](const std::string& target) {
        return message("<SIMPLEREQ><METHODCALL NAME=\"Do\">" + target +
                       "<PARAMVALUE NAME=\"A\" PARAMTYPE=\"uint8\"><VALUE>1</VALUE></PARAMVALUE>"
                       "<PARAMVALUE NAME=\"B\"/></METHODCALL></SIMPLEREQ>");
    };
    const Request ofInstance = readRequest(
        method("<LOCALINSTANCEPATH>" + localNameSpace + instanceName("X", key("K", "v")) + "</LOCALINSTANCEPATH>"));
    EXPECT_FALSE(ofInstance.intrinsic);
    EXPECT_TRUE(ofInstance.target.instance);
    EXPECT_EQ(ofInstance.target.keys.at(0).value.text, "v");
    EXPECT_EQ(ofInstance.nameSpace, "root/cimv2");
    EXPECT_EQ(ofInstance.parameters.at(0).type, "uint8");
    EXPECT_EQ(ofInstance.parameters.at(1).type, "");
    const Request ofClass =
        readRequest(method("<LOCALCLASSPATH>" + localNameSpace + className("X") + "</LOCALCLASSPATH>"));
    EXPECT_FALSE(ofClass.target.instance);
}

TEST(Request, TakesVersionsByTheirFirstNumberAndSkipsCorrelators) {
    const Request request = readRequest("<?xml version='1.0'?><CIM DTDVERSION='2.4' CIMVERSION='2.8'><MESSAGE "
                                        "PROTOCOLVERSION='1.4' ID='&lt;a&gt;'><SIMPLEREQ>"
                                        "<CORRELATOR NAME='a' TYPE='string'/><IMETHODCALL NAME='EnumerateQualifiers'>" +
                                        localNameSpace + "</IMETHODCALL></SIMPLEREQ></MESSAGE></CIM>");
    EXPECT_EQ(request.id, "<a>");
    EXPECT_EQ(request.protocolVersion, "1.4");
}

TEST(Request, TakesUtf8InAnyCaseBehindAByteOrderMark) {
    const std::string whole = intrinsic("EnumerateQualifiers", "");
    const std::string content = whole.substr(whole.find("<CIM"));
    EXPECT_EQ(readRequest("\xEF\xBB\xBF<?xml version='1.0' encoding='UTF-8'?>" + content).name, "EnumerateQualifiers");
}

} // namespace
} // namespace cimxml
