#include "objectmanager/vkcim/Effect.h"
#include "tests/objectmanager/vkcim/TestSchema.h"

#include <gmock/gmock.h>

namespace vkcim {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

om::Value number(std::uint64_t value, CMPIType type = CMPI_uint16) {
    return {type, value};
}

om::Answer instance(std::vector<om::NamedValue> properties) {
    om::Answer answer;
    answer.results.emplace_back(om::Instance{{}, std::move(properties)});
    return answer;
}

std::vector<std::string> unchanged(std::vector<om::NamedValue> wanted, const om::Answer& afterwards,
                                   const std::string& reason = "") {
    om::Request request;
    request.path.nameSpace = "root/cimv2";
    request.values = std::move(wanted);
    return notChanged(request, afterwards, reason, testSchema());
}

TEST(Effect, IsThatEveryPropertyHasTheWantedValue) {
    const om::Answer afterwards = instance({{"Speed", number(7)}, {"Name", {CMPI_string, std::string("a")}}});
    EXPECT_THAT(unchanged({{"speed", number(7)}, {"Name", {CMPI_string, std::string("a")}}}, afterwards), IsEmpty());
    EXPECT_THAT(unchanged({{"Speed", number(7, CMPI_uint32)}}, afterwards), IsEmpty()) << "the width does not count";
    EXPECT_THAT(unchanged({{"Gone", {CMPI_string, {}}}}, afterwards), IsEmpty()) << "null is no value";
}

TEST(Effect, NamesWhatHasAnotherValueOrNone) {
    const om::Answer afterwards = instance({{"Speed", number(7)}, {"Null", {CMPI_uint16, {}}}});
    EXPECT_THAT(
        unchanged({{"Speed", number(8)}, {"Null", number(1)}, {"Gone", number(1)}}, afterwards),
        ElementsAre("not changed: Speed is 7", "not changed: Null has no value", "not changed: Gone has no value"));
    EXPECT_THAT(unchanged({{"Speed", {CMPI_uint16, {}}}}, afterwards), ElementsAre("not changed: Speed is 7"));
    EXPECT_THAT(unchanged({{"Null", {CMPI_string, std::string("has no value")}}}, afterwards),
                ElementsAre("not changed: Null has no value"));
}

TEST(Effect, HasTheReasonBehindIt) {
    EXPECT_THAT(unchanged({{"Speed", number(8)}}, instance({{"Speed", number(7)}}), "no right"),
                ElementsAre("not changed: Speed is 7 (no right)"));
}

TEST(Effect, HasNoReasonForWhatCannotBeWritten) {
    om::Request request;
    request.path.className = "VESKA_TimeService";
    request.values = {{"AutomaticDSTAdjustment", {CMPI_boolean, false}}, {"Region", number(1)}, {"Regoin", number(1)}};
    const om::Answer afterwards = instance({{"AutomaticDSTAdjustment", {CMPI_boolean, true}}});
    EXPECT_THAT(notChanged(request, afterwards, "no right", om::Schema::builtin()),
                ElementsAre("not changed: AutomaticDSTAdjustment is true (no right)",
                            "not changed: Region has no value", "not changed: Regoin has no value"));
}

TEST(Effect, IsNoneWhereTheInstanceIsNotThere) {
    EXPECT_THAT(unchanged({{"Speed", number(8)}}, {}), ElementsAre("not changed: no such instance"));
}

TEST(Effect, CannotBeSeenOfAProviderThatKnowsNoGet) {
    om::Answer unsupported;
    unsupported.code = CMPI_RC_ERR_NOT_SUPPORTED;
    EXPECT_THAT(unchanged({{"Speed", number(8)}}, unsupported), IsEmpty());
}

} // namespace
} // namespace vkcim
