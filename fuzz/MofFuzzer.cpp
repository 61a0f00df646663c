// A MOF file: whatever it holds, it is read into a schema or refused, and every complaint names its place.
#include "fuzz/Expect.h"
#include "objectmanager/mof/Checker.h"
#include "objectmanager/mof/MofError.h"
#include "objectmanager/mof/Parser.h"

#include <cstdint>

namespace {

constexpr std::string_view standard = R"(
class CIM_Top { string Caption; uint16 States[]; };
class CIM_Keyed : CIM_Top { [Key] string Name; uint32 Do([In] boolean Really, [In, Out] datetime When); };
[Association] class CIM_Link { [Key] CIM_Top REF From; [Key] CIM_Keyed REF To; };
)";

void expectPlace(std::string_view complaint) {
    fuzz::expect(complaint.substr(0, 2) == "f:" && complaint.find(": ", 2) != std::string_view::npos,
                 "a complaint names file and line");
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    mof::Checker checker;
    checker.add(mof::parse(standard, "standard"), false);
    fuzz::expect(checker.complaints().empty(), "the standard's classes are right");
    try {
        checker.add(mof::parse({reinterpret_cast<const char*>(data), size}, "f"));
    } catch (const mof::MofError& error) {
        expectPlace(error.what());
    }
    for (const std::string& complaint : checker.complaints()) expectPlace(complaint);
    for (const om::ClassDeclaration& declared : checker.schema().classes()) {
        const om::ResolvedClass& resolved = *checker.schema().resolve(declared.name);
        for (const om::PropertyDeclaration& property : declared.properties) {
            fuzz::expect(resolved.findProperty(property.name) != nullptr, "what is declared is found");
        }
    }
    return 0;
}
