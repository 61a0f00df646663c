#pragma once

#include "objectmanager/vkcim/Report.h"

#include <string_view>

/// What programs that know many hosts are handed of one: computers, chassis and time service, and nothing that a
/// command must be run for. What is not known is missing: null, an empty text, and a number or text that stands for
/// Unknown.
namespace vkcim {

/// What the schema calls a value that is none.
constexpr std::string_view unknownWord = "Unknown";

struct Facts {
    std::optional<std::string> host; ///< the name of the host that is described
    std::vector<om::Instance> computers;
    std::vector<om::Instance> chassis;
    std::vector<om::Instance> timeServices;
    std::optional<std::string> timeData; ///< the time service's time, a CIM date-time
    std::vector<std::string> notes;
    std::string version; ///< of this program
    std::string time;    ///< of the end, in UTC: `2026-11-21T06:00:00Z`
};

/// Asks for the instances, and the time service for its time. The rest is as for makeReport.
Facts gatherFacts(const om::Schema& schema, const std::string& nameSpace,
                  const std::optional<std::vector<std::string>>& properties,
                  const std::function<om::Answer(const om::Request&)>& run,
                  const std::function<std::vector<std::string>()>& notes);

/// How far the time service's local time is ahead of UTC.
std::optional<int> offsetInMinutes(const Facts& facts);

} // namespace vkcim
