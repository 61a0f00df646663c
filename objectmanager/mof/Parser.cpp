#include "objectmanager/mof/Parser.h"

#include "objectmanager/model/TypeNames.h"
#include "objectmanager/mof/Lexer.h"
#include "objectmanager/mof/Literal.h"
#include "objectmanager/mof/MofError.h"

#include <algorithm>

namespace mof {
namespace {

using Kind = Token::Kind;

std::string lowerCase(std::string text) {
    std::transform(text.begin(), text.end(), text.begin(), om::lower);
    return text;
}

std::string shown(const Token& token) {
    return token.kind == Kind::End ? "the file's end" : '\'' + token.text + '\'';
}

class Parser {
public:
    Parser(std::string_view text, const std::string& name) : file(name), tokens(readTokens(text, name)) {}

    std::vector<om::ClassDeclaration> classes() {
        std::vector<om::ClassDeclaration> found;
        while (now().kind != Kind::End) found.push_back(classDeclaration());
        return found;
    }

private:
    const Token& now() const { return tokens[at]; }

    const Token& next() {
        const Token& token = tokens[at];
        if (token.kind != Kind::End) ++at;
        return token;
    }

    [[noreturn]] void fail(const Token& token, const std::string& what) const {
        throw MofError(file, token.line, what);
    }

    [[noreturn]] void failAt(const Token& token, const std::string& expected) const {
        fail(token, "expected " + expected + ", found " + shown(token));
    }

    bool stands(std::string_view word) const {
        return (now().kind == Kind::Mark || now().kind == Kind::Name) && om::sameName(now().text, word);
    }

    bool take(std::string_view word) {
        if (!stands(word)) return false;
        next();
        return true;
    }

    void expect(std::string_view word) {
        if (!take(word)) failAt(now(), '\'' + std::string(word) + '\'');
    }

    const Token& name(const char* what) {
        const Token& token = next();
        if (token.kind != Kind::Name) failAt(token, what);
        return token;
    }

    /// Items between commas up to the end, where `least` is 1 at least one.
    template <class Item>
    void list(std::string_view end, int least, Item item) {
        for (int count = 0; count < least || !take(end); ++count) {
            if (count > 0) expect(",");
            item();
        }
    }

    om::ClassDeclaration classDeclaration() {
        if (now().kind == Kind::Pragma) fail(now(), now().text + " is refused: compilers may ignore it");
        om::ClassDeclaration declared;
        declared.qualifiers = qualifiers(declared.place);
        if (!take("class")) failAt(now(), "a class");
        declared.name = placed(name("a class name"), declared.place);
        if (take(":")) declared.superclass = name("a superclass").text;
        declared.association = om::isMarked(declared.qualifiers, "Association");
        expect("{");
        while (!take("}")) {
            om::PropertyDeclaration found = feature("a name");
            if (take("(")) {
                declared.methods.push_back(method(std::move(found)));
            } else {
                declared.properties.push_back(property(std::move(found)));
            }
            expect(";");
        }
        expect(";");
        return declared;
    }

    /// The name that a token is, whose place becomes the declaration's.
    const std::string& placed(const Token& token, om::Place& place) const {
        place.file = file;
        place.line = token.line;
        return token.text;
    }

    /// What properties, methods and parameters begin with.
    om::PropertyDeclaration feature(const char* what) {
        om::PropertyDeclaration found;
        found.qualifiers = qualifiers(found.place);
        const Token& type = name("a type");
        if (take("ref")) {
            found.type = CMPI_ref;
            found.referenceClass = type.text;
        } else {
            found.type = om::typeNamed(lowerCase(type.text)).value_or(CMPI_ref);
            if (found.type == CMPI_ref) fail(type, shown(type) + " is no type");
        }
        found.name = placed(name(what), found.place);
        found.key = om::isMarked(found.qualifiers, "Key");
        return found;
    }

    om::PropertyDeclaration property(om::PropertyDeclaration found) {
        found.type = withArray(found.type);
        if (take("=")) found.defaultValue = value();
        return found;
    }

    om::MethodDeclaration method(om::PropertyDeclaration head) {
        if (head.type == CMPI_ref) fail(now(), "method " + head.name + " returns a reference");
        om::MethodDeclaration found{head.name, head.type, {}, std::move(head.qualifiers), std::move(head.place)};
        list(")", 0, [&] { found.parameters.push_back(parameter()); });
        return found;
    }

    om::ParameterDeclaration parameter() {
        om::ParameterDeclaration found{feature("a parameter's name")};
        found.type = withArray(found.type);
        const om::Value* in = om::findValue(found.qualifiers, "In");
        found.in = in == nullptr || *in != om::Value{CMPI_boolean, false};
        found.out = om::isMarked(found.qualifiers, "Out");
        return found;
    }

    CMPIType withArray(CMPIType type) {
        if (!take("[")) return type;
        if (now().kind == Kind::Integer) next();
        expect("]");
        return static_cast<CMPIType>(type | CMPI_ARRAY);
    }

    om::Qualifiers qualifiers(om::Place& place) {
        om::Qualifiers found;
        if (!take("[")) return found;
        list("]", 1, [&] {
            const Token& token = name("a qualifier");
            if (om::findValue(found, token.text) != nullptr)
                fail(token, "qualifier " + token.text + " stands here twice");
            place.qualifierLines.push_back(token.line);
            found.emplace_back(token.text, qualifierValue());
        });
        return found;
    }

    om::Value qualifierValue() {
        if (take("(")) {
            om::Value found = value();
            expect(")");
            return found;
        }
        return stands("{") ? value() : om::qualifierValue(true);
    }

    om::Value value() {
        if (!take("{")) return scalar();
        std::vector<om::Value> elements;
        list("}", 0, [&] { elements.push_back(scalar()); });
        const CMPIType type = elements.empty() ? CMPI_string : elements.front().type;
        return {static_cast<CMPIType>(type | CMPI_ARRAY), std::move(elements)};
    }

    om::Value scalar() {
        const Token& token = next();
        if (token.kind == Kind::String) {
            std::string text = token.text;
            while (now().kind == Kind::String) text += next().text;
            return {CMPI_string, std::move(text)};
        }
        if (token.kind == Kind::Integer || token.kind == Kind::Real) return readLiteral(token.text);
        const std::string word = token.kind == Kind::Name ? lowerCase(token.text) : std::string();
        if (word == "true" || word == "false") return om::qualifierValue(word == "true");
        if (word == "null") return {};
        failAt(token, "a value");
    }

    const std::string& file;
    const std::vector<Token> tokens;
    std::size_t at = 0;
};

} // namespace

std::vector<om::ClassDeclaration> parse(std::string_view text, const std::string& file) {
    return Parser(text, file).classes();
}

} // namespace mof
