#include "objectmanager/model/Schema.h"
#include "schema/Adapters.h" // made from the headers in cmpi
#include "support/Provider.h"
#include "support/SimulatedHost.h"

#include <gmock/gmock.h>

#include <fstream>
#include <map>
#include <set>

namespace {

using namespace VK::BaseServerProvider;
using testing::IsSupersetOf;

using Names = std::set<std::string>;
using Types = std::map<std::string, CMPIType>;

/// The CIM type that a property table's setter gives to a getter's value.
template <class Value>
constexpr CMPIType typeOf() {
    if constexpr (std::is_same_v<Value, bool>) return CMPI_boolean;
    if constexpr (std::is_same_v<Value, float>) return CMPI_real32;
    if constexpr (std::is_same_v<Value, unsigned int>) return CMPI_uint32;
    if constexpr (std::is_same_v<Value, unsigned short>) return CMPI_uint16;
    if constexpr (std::is_same_v<Value, std::vector<std::string>>) return CMPI_stringA;
    if constexpr (std::is_same_v<Value, std::vector<unsigned short>>) return CMPI_uint16A;
    return CMPI_string;
}

/// What an adapter sets: from its property table, or its references and what it adds.
struct Produced {
    std::string className;
    Types properties;
    Names keys;
};

template <class Adapter>
concept Association = requires {
    Adapter::roles;
};

template <class Adapter>
Produced produced() {
    Produced produced{Adapter::className, {}, {}};
    for (const auto& property : Adapter::properties) {
        produced.properties[property.name] = std::visit(
            [&](auto getter) {
                using Value = typename detail::GetterValue<decltype(getter)>::type;
                return static_cast<CMPIType>(property.dateTime ? CMPI_dateTime : typeOf<Value>());
            },
            property.getter);
    }
    for (const auto& key : Adapter::keys) produced.keys.insert(key.name);
    return produced;
}

template <Association Adapter>
Produced produced() {
    Produced produced{Adapter::className, {}, {}};
    for (const char* role : Adapter::roles) {
        produced.keys.insert(role);
        produced.properties[role] = CMPI_ref;
    }
    if constexpr (std::is_same_v<Adapter, CMPIComputerSystemPackage>) produced.properties["PlatformGUID"] = CMPI_string;
    return produced;
}

template <class... Adapters>
struct List {};

template <class... Adapters>
std::vector<Produced> allOf(List<Adapters...>) {
    return {produced<Adapters>()...};
}

const std::vector<Produced>& producedClasses() {
    static const std::vector<Produced> classes = allOf(List<ALL_ADAPTERS>());
    return classes;
}

/// Declared for clients that ask for them; no host has them.
const std::map<std::string, Names> neverSupplied = {{"VESKA_TimeService", {"Region"}},
                                                    {"VESKA_EnabledLogicalElementCapabilities", {"StateAwareness"}}};

const om::Schema& schema() {
    return om::Schema::builtin();
}

Types declaredTypes(const std::string& className) {
    Types types;
    for (const auto& property : schema().find(className)->properties) types[property.name] = property.type;
    return types;
}

Names declaredKeys(const std::string& className) {
    Names keys;
    for (const auto* declared = schema().find(className); declared; declared = schema().find(declared->superclass))
        for (const auto& property : declared->properties)
            if (property.key) keys.insert(property.name);
    return keys;
}

Names ours() {
    const std::vector<std::string> served = schema().served();
    return {served.begin(), served.end()};
}

void simulateRichHost() {
    std::ifstream example(VK_EXAMPLE_HOST);
    test::simulateText({std::istreambuf_iterator<char>(example), {}});
}

TEST(Schema, DeclaresExactlyTheClassesThatAreServed) {
    Names served;
    for (const Produced& produced : producedClasses()) served.insert(produced.className);
    EXPECT_EQ(ours(), served);
}

TEST(Schema, DeclaresEachPropertyOfATableWithItsType) {
    for (const Produced& produced : producedClasses())
        for (const auto& [name, type] : produced.properties) {
            SCOPED_TRACE(produced.className + "." + name);
            const om::PropertyDeclaration* declared = schema().findProperty(produced.className, name);
            ASSERT_NE(declared, nullptr);
            EXPECT_EQ(declared->name, name); // in the same letter case
            EXPECT_EQ(declared->type, type);
        }
}

TEST(Schema, DeclaresTheKeysThatPathsCarryAndNoOther) {
    for (const Produced& produced : producedClasses())
        EXPECT_EQ(declaredKeys(produced.className), produced.keys) << produced.className;
}

TEST(Schema, RefersToTheClassesAtTheEndsOfAnAssociation) {
    const auto refersTo = [](const char* className, const char* role) {
        return schema().findProperty(className, role)->referenceClass;
    };
    EXPECT_EQ(refersTo("VESKA_ComputerCapabilities", "ManagedElement"), "VESKA_ComputerSystem");
    EXPECT_EQ(refersTo("VESKA_ComputerCapabilities", "Capabilities"), "VESKA_EnabledLogicalElementCapabilities");
    EXPECT_EQ(refersTo("VESKA_ComputerSystemPackage", "Antecedent"), "VESKA_PhysicalPackage");
    EXPECT_EQ(refersTo("VESKA_ComputerSystemPackage", "Dependent"), "VESKA_ComputerSystem");
    EXPECT_EQ(refersTo("VESKA_TimeServiceAffectsElement", "AffectedElement"), "VESKA_ComputerSystem");
    EXPECT_EQ(refersTo("VESKA_TimeServiceAffectsElement", "AffectingElement"), "VESKA_TimeService");
}

TEST(Schema, DeclaresInOurClassesNothingThatTheTablesLack) {
    for (const Produced& produced : producedClasses())
        EXPECT_THAT(produced.properties, IsSupersetOf(declaredTypes(produced.className))) << produced.className;
}

TEST(Schema, DeclaresInOurClassesExactlyWhatAHostThatTellsEverythingIsSeenWith) {
    simulateRichHost();
    for (const Produced& produced : producedClasses()) {
        SCOPED_TRACE(produced.className);
        Types expected = declaredTypes(produced.className);
        if (const auto absent = neverSupplied.find(produced.className); absent != neverSupplied.end()) {
            for (const std::string& name : absent->second) EXPECT_EQ(expected.erase(name), 1U) << name;
        }
        const std::vector<om::Instance> instances = test::instancesOf(test::instances(produced.className));
        ASSERT_FALSE(instances.empty());
        Types seen;
        for (const auto& [name, value] : instances.front().properties) seen[name] = value.type;
        EXPECT_EQ(seen, expected);
        Names keys;
        for (const auto& [name, value] : instances.front().path.keys) keys.insert(name);
        EXPECT_EQ(keys, produced.keys);
    }
}

// Values

/// The numbers or texts of a property's ValueMap, as the MOF files have them.
Names valueMap(const std::string& className, const std::string& property) {
    std::ifstream file(VK_SCHEMA_JSON);
    const nlohmann::json described = nlohmann::json::parse(file);
    for (const auto& declared : described["classes"])
        if (declared["name"] == className)
            for (const auto& listed : declared["properties"])
                if (listed["name"] == property) return listed["ValueMap"].get<Names>();
    return {};
}

void addValue(Names& values, const om::Value& value) {
    if (const auto* number = std::get_if<std::uint64_t>(&value.data)) values.insert(std::to_string(*number));
    if (const auto* words = std::get_if<std::string>(&value.data)) values.insert(*words);
    if (const auto* elements = std::get_if<std::vector<om::Value>>(&value.data))
        for (const om::Value& element : *elements) addValue(values, element);
}

TEST(Schema, MapsExactlyTheValuesThatAreAnswered) {
    std::map<std::pair<std::string, std::string>, Names> answered;
    for (unsigned number = 0; number <= 30; ++number) {
        test::Node computer = test::computer(0, "node7");
        computer.status = number;
        computer.properties[123] = number;
        test::Node chassis = test::chassis(0, 0, "C0");
        chassis.properties[128] = number;
        test::simulate({computer, chassis});
        for (const char* className : {"VESKA_ComputerSystem", "VESKA_PhysicalPackage"})
            for (const om::Instance& instance : test::instancesOf(test::instances(className)))
                for (const auto& [name, value] : instance.properties) addValue(answered[{className, name}], value);
    }
    for (const char* property : {"OperationalStatus", "HealthState", "Status", "EnabledState", "Dedicated"})
        EXPECT_EQ(answered[std::make_pair("VESKA_ComputerSystem", property)],
                  valueMap("VESKA_ComputerSystem", property))
            << property;
    EXPECT_EQ(answered[std::make_pair("VESKA_PhysicalPackage", "PackageType")],
              valueMap("VESKA_PhysicalPackage", "PackageType"));
}

// Methods

Names declaredMethods(const std::string& className) {
    Names names;
    for (const auto& method : schema().find(className)->methods) names.insert(method.name);
    return names;
}

om::Value reference() {
    return {CMPI_ref, std::make_shared<const om::ObjectPath>(test::path("VESKA_TimeService"))};
}

TEST(Schema, DeclaresTheMethodsWhereTheyRun) {
    for (const std::string& className : ours()) {
        Names expected;
        if (className == "VESKA_TimeService") expected = {"ManageTime"};
        if (className == "VESKA_CIMServiceConfig") expected = {"SetCIMconfig"};
        EXPECT_EQ(declaredMethods(className), expected) << className;
        const om::Answer answer = test::invoke(test::path(className), expected.empty() ? "Any" : *expected.begin(), {});
        EXPECT_EQ(answer.code, expected.empty() ? CMPI_RC_ERR_INVALID_CLASS : CMPI_RC_ERR_INVALID_PARAMETER)
            << className;
    }
}

TEST(Schema, DeclaresTheParametersOfManageTime) {
    simulateRichHost();
    const om::MethodDeclaration* method = schema().findMethod("VESKA_TimeService", "ManageTime");
    ASSERT_NE(method, nullptr);
    ASSERT_EQ(method->parameters.size(), 3U);
    const om::ParameterDeclaration& getRequest = method->parameters[0];
    const om::ParameterDeclaration& timeData = method->parameters[1];
    const om::ParameterDeclaration& managedElement = method->parameters[2];
    const om::Answer answer =
        test::invoke(test::path("VESKA_TimeService"), method->name,
                     {{getRequest.name, {getRequest.type, true}}, {managedElement.name, reference()}});
    EXPECT_EQ(answer.code, CMPI_RC_OK);
    EXPECT_EQ(answer.returnValue.value().type, method->returnType);
    ASSERT_EQ(answer.out.size(), 1U);
    EXPECT_EQ(answer.out[0].first, timeData.name);
    EXPECT_EQ(answer.out[0].second.type, timeData.type);
    EXPECT_TRUE(timeData.in && timeData.out);
    EXPECT_TRUE(getRequest.in && !getRequest.out && managedElement.in && !managedElement.out);
    EXPECT_EQ(managedElement.type, CMPI_ref);
}

TEST(Schema, DeclaresTheParametersOfSetCIMconfig) {
    simulateRichHost();
    const om::MethodDeclaration* method = schema().findMethod("VESKA_CIMServiceConfig", "SetCIMconfig");
    ASSERT_NE(method, nullptr);
    EXPECT_EQ(method->parameters.size(), 2U);
    for (const om::ParameterDeclaration& parameter : method->parameters) {
        // Without an argument that it knows the method answers 4; the command itself is missing here, which answers 1.
        const om::Answer answer = test::invoke(test::path("VESKA_CIMServiceConfig"), method->name,
                                               {{parameter.name, {parameter.type, std::uint64_t{30}}}});
        EXPECT_NE(answer.code, CMPI_RC_ERR_INVALID_PARAMETER) << parameter.name;
        EXPECT_TRUE(parameter.in && !parameter.out);
    }
}

} // namespace
