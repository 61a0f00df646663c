#include "objectmanager/model/QualifierTypes.h"

#include "objectmanager/model/Names.h"

#include <algorithm>

namespace om {

namespace {

constexpr bool fixed = false; // what a subclass may not change
constexpr bool restricted = false;

} // namespace

const std::vector<QualifierType>& qualifierTypes() {
    constexpr std::string_view any = "carpmin";
    static const std::vector<QualifierType> types = {
        {"Abstract", CMPI_boolean, "can", true, restricted, false, "false"},
        {"Aggregate", CMPI_boolean, "r", fixed, true, false, "false"},
        {"Aggregation", CMPI_boolean, "a", fixed, true, false, "false"},
        {"ArrayType", CMPI_string, "pi", fixed, true, false, "Bag"},
        {"Association", CMPI_boolean, "a", fixed, true, false, "false"},
        {"BitMap", CMPI_stringA, "pmi", true, true, false, {}},
        {"BitValues", CMPI_stringA, "pmi", true, true, true, {}},
        {"ClassConstraint", CMPI_stringA, "can", true, true, false, {}},
        {"Correlatable", CMPI_stringA, "p", true, true, false, {}},
        {"Counter", CMPI_boolean, "pmi", true, true, false, "false"},
        {"Deprecated", CMPI_stringA, any, true, restricted, false, {}},
        {"Description", CMPI_string, any, true, true, true, {}},
        {"DisplayName", CMPI_string, any, true, true, true, {}},
        {"DN", CMPI_boolean, "pmi", fixed, true, false, "false"},
        {"EmbeddedInstance", CMPI_string, "pmi", true, true, false, {}},
        {"EmbeddedObject", CMPI_boolean, "pmi", fixed, true, false, "false"},
        {"Exception", CMPI_boolean, "cn", fixed, true, false, "false"},
        {"Experimental", CMPI_boolean, any, true, restricted, false, "false"},
        {"Gauge", CMPI_boolean, "pmi", true, true, false, "false"},
        {"In", CMPI_boolean, "i", fixed, true, false, "true"},
        {"IsPUnit", CMPI_boolean, "pmi", true, true, false, "false"},
        {"Key", CMPI_boolean, "pr", fixed, true, false, "false"},
        {"MappingStrings", CMPI_stringA, any, true, true, false, {}},
        {"Max", CMPI_uint32, "r", true, true, false, {}},
        {"MaxLen", CMPI_uint32, "pmi", true, true, false, {}},
        {"MaxValue", CMPI_sint64, "pmi", true, true, false, {}},
        {"MethodConstraint", CMPI_stringA, "m", true, true, false, {}},
        {"Min", CMPI_uint32, "r", true, true, false, "0"},
        {"MinLen", CMPI_uint32, "pmi", true, true, false, "0"},
        {"MinValue", CMPI_sint64, "pmi", true, true, false, {}},
        {"ModelCorrespondence", CMPI_stringA, any, true, true, false, {}},
        {"NullValue", CMPI_string, "p", true, true, false, {}},
        {"OctetString", CMPI_boolean, "pmi", fixed, true, false, "false"},
        {"Out", CMPI_boolean, "i", fixed, true, false, "false"},
        {"Override", CMPI_string, "prm", true, restricted, false, {}},
        {"Propagated", CMPI_string, "p", fixed, true, false, {}},
        {"PropertyConstraint", CMPI_stringA, "pr", true, true, false, {}},
        {"PUnit", CMPI_string, "pmi", true, true, false, {}},
        {"Read", CMPI_boolean, "pr", true, true, false, "true"},
        {"Required", CMPI_boolean, "prmi", fixed, true, false, "false"},
        {"Static", CMPI_boolean, "pm", fixed, true, false, "false"},
        {"Terminal", CMPI_boolean, "can", true, true, false, "false"},
        {"UMLPackagePath", CMPI_string, "can", true, true, false, {}},
        {"Units", CMPI_string, "pmi", true, true, true, {}},
        {"ValueMap", CMPI_stringA, "pmi", true, true, false, {}},
        {"Values", CMPI_stringA, "pmi", true, true, true, {}},
        {"Version", CMPI_string, "can", true, restricted, true, {}},
        {"Weak", CMPI_boolean, "r", fixed, true, false, "false"},
        {"Write", CMPI_boolean, "pr", true, true, false, "false"},
    };
    return types;
}

const QualifierType* findQualifierType(std::string_view name) {
    const std::vector<QualifierType>& types = qualifierTypes();
    const auto found =
        std::find_if(types.begin(), types.end(), [&](const QualifierType& each) { return sameName(each.name, name); });
    return found == types.end() ? nullptr : &*found;
}

} // namespace om
