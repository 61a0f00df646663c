#include "objectmanager/cimxml/Elements.h"

#include "objectmanager/cimxml/Document.h"
#include "objectmanager/cimxml/Errors.h"

#include <gmock/gmock.h>

namespace cimxml {
namespace {

using Kind = ValueElement::Kind;

ValueElement value(const std::string& xml) {
    pugi::xml_document document;
    load(document, xml);
    return readValue(document.document_element());
}

TEST(Elements, ReadsTextWithoutTrimmingIt) {
    EXPECT_EQ(value("<VALUE> a&lt;b\n</VALUE>").text, " a<b\n");
    EXPECT_EQ(value("<VALUE>  </VALUE>").text, "  ");
    EXPECT_EQ(value("<VALUE/>").kind, Kind::Text);
    EXPECT_EQ(value("<VALUE></VALUE>").text, "");
    EXPECT_EQ(value("<VALUE>a<![CDATA[<b>]]>c</VALUE>").text, "a<b>c");
}

TEST(Elements, ReadsArraysWithNulls) {
    const ValueElement array = value("<VALUE.ARRAY>\n<VALUE>a</VALUE> <VALUE.NULL/></VALUE.ARRAY>");
    ASSERT_EQ(array.elements.size(), 2U);
    EXPECT_EQ(array.elements[0].text, "a");
    EXPECT_EQ(array.elements[1].kind, Kind::None);
    EXPECT_EQ(value("<VALUE.ARRAY>\n</VALUE.ARRAY>").elements.size(), 0U);
}

TEST(Elements, ReadsAllSixFormsOfAReference) {
    const std::string local =
        R"(<LOCALNAMESPACEPATH><NAMESPACE NAME="root"></NAMESPACE><NAMESPACE NAME="x"/></LOCALNAMESPACEPATH>)";
    const std::string space = "<NAMESPACEPATH><HOST>node7</HOST>" + local + "</NAMESPACEPATH>";
    const std::string name = R"(<INSTANCENAME CLASSNAME="X"/>)";
    const std::string ofClass = R"(<CLASSNAME NAME="X"/>)";
    struct {
        std::string xml;
        bool instance;
        const char* nameSpace;
        const char* host;
    } const forms[] = {{name, true, "", ""},
                       {"<LOCALINSTANCEPATH>" + local + name + "</LOCALINSTANCEPATH>", true, "root/x", ""},
                       {"<INSTANCEPATH>" + space + name + "</INSTANCEPATH>", true, "root/x", "node7"},
                       {ofClass, false, "", ""},
                       {"<LOCALCLASSPATH>" + local + ofClass + "</LOCALCLASSPATH>", false, "root/x", ""},
                       {"<CLASSPATH>" + space + ofClass + "</CLASSPATH>", false, "root/x", "node7"}};
    for (const auto& form : forms) {
        const ValueElement reference = value("<VALUE.REFERENCE>" + form.xml + "</VALUE.REFERENCE>");
        ASSERT_EQ(reference.kind, Kind::Reference) << form.xml;
        EXPECT_EQ(reference.path->className, "X");
        EXPECT_EQ(reference.path->instance, form.instance) << form.xml;
        EXPECT_EQ(reference.path->nameSpace, form.nameSpace) << form.xml;
        EXPECT_EQ(reference.path->host, form.host) << form.xml;
    }
}

TEST(Elements, ReadsKeysWithWhatTheySayOfTheirType) {
    const ValueElement name = value(R"(<INSTANCENAME CLASSNAME="X">
        <KEYBINDING NAME="A"><KEYVALUE> text </KEYVALUE></KEYBINDING>
        <KEYBINDING NAME="B"><KEYVALUE TYPE="uint8" VALUETYPE="numeric">5</KEYVALUE></KEYBINDING>
        <KEYBINDING NAME="C"><VALUE.REFERENCE><INSTANCENAME CLASSNAME="Y"/></VALUE.REFERENCE></KEYBINDING>
        </INSTANCENAME>)");
    ASSERT_EQ(name.path->keys.size(), 3U);
    EXPECT_EQ(name.path->keys[0].value.text, " text ");
    EXPECT_EQ(name.path->keys[0].valueType, "string");
    EXPECT_EQ(name.path->keys[1].type, "uint8");
    EXPECT_EQ(name.path->keys[2].value.path->className, "Y");
}

TEST(Elements, ReadsInstancesWithWhatServersAddToThem) {
    const ValueElement named = value(R"(<VALUE.NAMEDINSTANCE><INSTANCENAME CLASSNAME="X"/><INSTANCE CLASSNAME="X">
        <QUALIFIER NAME="Q" TYPE="string"/>
        <PROPERTY NAME="A" TYPE="string" CLASSORIGIN="Y" PROPAGATED="true"><QUALIFIER NAME="Q" TYPE="string"/><VALUE>1</VALUE></PROPERTY>
        <PROPERTY.ARRAY NAME="B" TYPE="uint8"></PROPERTY.ARRAY>
        <PROPERTY.REFERENCE NAME="C" REFERENCECLASS="Z"/>
        </INSTANCE></VALUE.NAMEDINSTANCE>)");
    ASSERT_EQ(named.kind, Kind::NamedInstance);
    const auto& properties = named.instance->properties;
    ASSERT_EQ(properties.size(), 3U);
    EXPECT_EQ(properties[0].value.text, "1");
    EXPECT_TRUE(properties[1].array);
    EXPECT_EQ(properties[1].value.kind, Kind::None);
    EXPECT_EQ(properties[2].type, "");
}

TEST(Elements, RefusesWhatTheDtdDoesNotAllow) {
    const char* const bad[] = {
        R"(<VALUE><VALUE/></VALUE>)",
        R"(<VALUE TYPE="string"/>)",
        R"(<VALUE.ARRAY>text</VALUE.ARRAY>)",
        R"(<VALUE.ARRAY><VALUE.ARRAY/></VALUE.ARRAY>)",
        R"(<VALUE.ARRAY><VALUE.NULL><VALUE/></VALUE.NULL></VALUE.ARRAY>)",
        R"(<VALUE.REFERENCE/>)",
        R"(<VALUE.REFERENCE><VALUE/></VALUE.REFERENCE>)",
        R"(<VALUE.REFERENCE><CLASSNAME NAME="X"/><CLASSNAME NAME="X"/></VALUE.REFERENCE>)",
        R"(<CLASSNAME/>)",
        R"(<CLASSNAME NAME=""/>)",
        R"(<CLASSNAME NAME="X" OTHER="Y"/>)",
        R"(<CLASSNAME NAME="X"><VALUE/></CLASSNAME>)",
        R"(<INSTANCENAME NAME="X"/>)",
        R"(<INSTANCENAME CLASSNAME="X"><VALUE/></INSTANCENAME>)",
        R"(<INSTANCENAME CLASSNAME="X"><KEYBINDING><KEYVALUE/></KEYBINDING></INSTANCENAME>)",
        R"(<INSTANCENAME CLASSNAME="X"><KEYBINDING NAME="A"/></INSTANCENAME>)",
        R"(<INSTANCENAME CLASSNAME="X"><KEYBINDING NAME="A"><KEYVALUE VALUETYPE="text"/></KEYBINDING></INSTANCENAME>)",
        R"(<INSTANCENAME CLASSNAME="X"><KEYVALUE/><KEYVALUE/></INSTANCENAME>)",
        R"(<VALUE.NAMEDINSTANCE><INSTANCENAME CLASSNAME="X"/></VALUE.NAMEDINSTANCE>)",
        R"(<VALUE.NAMEDINSTANCE><INSTANCE CLASSNAME="X"/><INSTANCENAME CLASSNAME="X"/></VALUE.NAMEDINSTANCE>)",
        R"(<INSTANCE/>)",
        R"(<INSTANCE CLASSNAME="X"><VALUE/></INSTANCE>)",
        R"(<INSTANCE CLASSNAME="X"><PROPERTY NAME="A"/></INSTANCE>)",
        R"(<INSTANCE CLASSNAME="X"><PROPERTY NAME="A" TYPE="string"><VALUE.ARRAY/></PROPERTY></INSTANCE>)",
        R"(<INSTANCE CLASSNAME="X"><PROPERTY NAME="A" TYPE="string"><VALUE/><VALUE/></PROPERTY></INSTANCE>)",
        R"(<INSTANCE CLASSNAME="X"><PROPERTY NAME="A" TYPE="string"/><QUALIFIER NAME="Q" TYPE="string"/></INSTANCE>)",
        R"(<VALUE.REFERENCE><LOCALCLASSPATH><LOCALNAMESPACEPATH/><CLASSNAME NAME="X"/></LOCALCLASSPATH></VALUE.REFERENCE>)",
        R"(<VALUE.REFERENCE><LOCALCLASSPATH><LOCALNAMESPACEPATH><NAMESPACE NAME="a/b"/></LOCALNAMESPACEPATH><CLASSNAME NAME="X"/></LOCALCLASSPATH></VALUE.REFERENCE>)",
        R"(<VALUE.REFERENCE><LOCALCLASSPATH><LOCALNAMESPACEPATH><NAMESPACE NAME="a"/></LOCALNAMESPACEPATH><INSTANCENAME CLASSNAME="X"/></LOCALCLASSPATH></VALUE.REFERENCE>)",
        R"(<VALUE.REFERENCE><CLASSPATH><NAMESPACEPATH><HOST>h</HOST></NAMESPACEPATH><CLASSNAME NAME="X"/></CLASSPATH></VALUE.REFERENCE>)"};
    for (const char* xml : bad) {
        try {
            value(xml);
            ADD_FAILURE() << xml << " was read";
        } catch (const Refusal& refusal) {
            EXPECT_EQ(refusal.cimError, "request-not-valid") << xml;
        }
    }
}

TEST(Elements, RefusesAnAttributeThatStandsTwice) {
    EXPECT_THROW(value(R"(<CLASSNAME NAME="X" NAME="Y"/>)"), Refusal);
}

} // namespace
} // namespace cimxml
