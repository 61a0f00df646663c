#include "objectmanager/cimxml/Message.h"

#include "objectmanager/cimxml/Document.h"

#include <gmock/gmock.h>

namespace cimxml {
namespace {

using testing::HasSubstr;

Request request() {
    Request made;
    made.id = "a&<\"b";
    made.name = "getclass";
    return made;
}

std::string textOf(Pieces pieces) {
    Writer writer;
    pieces.writeTo(writer, std::string::npos);
    return writer.take();
}

TEST(Message, EchoesIdentifierAndSpelling) {
    const std::string text = textOf(response(request(), std::string("<IRETURNVALUE></IRETURNVALUE>")));
    EXPECT_EQ(text, "<?xml version=\"1.0\" encoding=\"utf-8\"?>\n<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\">"
                    "<MESSAGE ID=\"a&amp;&lt;&quot;b\" PROTOCOLVERSION=\"1.0\"><SIMPLERSP>"
                    "<IMETHODRESPONSE NAME=\"getclass\"><IRETURNVALUE></IRETURNVALUE></IMETHODRESPONSE>"
                    "</SIMPLERSP></MESSAGE></CIM>");
    Request method = request();
    method.intrinsic = false;
    EXPECT_THAT(textOf(response(method, {})), HasSubstr("<METHODRESPONSE NAME=\"getclass\"></METHODRESPONSE>"));
}

TEST(Message, AnErrorHasANumberAndALine) {
    EXPECT_THAT(textOf(errorResponse(request(), 6, "no\nfan \"x\"")),
                HasSubstr("<ERROR CODE=\"6\" DESCRIPTION=\"no fan &quot;x&quot;\"></ERROR>"));
    EXPECT_THAT(textOf(errorResponse(request(), 21, "")),
                HasSubstr("<ERROR CODE=\"21\" DESCRIPTION=\"CIM_ERR_INVALID_ENUMERATION_CONTEXT\"></ERROR>"));
}

TEST(Message, AStatusThatTheStandardLacksBecomesAFailure) {
    for (const int code : {0, 18, 19, 29, 60, 200, -1}) {
        EXPECT_THAT(textOf(errorResponse(request(), code, "")), HasSubstr("CODE=\"1\" DESCRIPTION=\"CIM_ERR_FAILED\""))
            << code;
    }
}

TEST(Message, CutsAVeryLongDescriptionBetweenCharacters) {
    std::string description;
    for (int i = 0; i < 1500; ++i) description += "\xE2\x82\xAC";
    const std::string text = textOf(errorResponse(request(), 1, description));
    EXPECT_LT(text.size(), 3000U);
    EXPECT_THAT(text, testing::Not(HasSubstr("\xEF\xBF\xBD")));
}

} // namespace
} // namespace cimxml
