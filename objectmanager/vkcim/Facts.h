#pragma once

#include "objectmanager/vkcim/HostNotes.h"
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
    HostClock clock;
    std::vector<std::string> notes;
    std::string version;  ///< of this program
    std::time_t time = 0; ///< of the end
};

/// Asks for the instances, and `clock` before the notes. The rest is as for makeReport. The clock is not the time
/// service's method: its answer is in the zone that the object manager thinks in, which for most is UTC.
Facts gatherFacts(const om::Schema& schema, const std::string& nameSpace,
                  const std::optional<std::vector<std::string>>& properties,
                  const std::function<om::Answer(const om::Request&)>& run, const std::function<HostClock()>& clock,
                  const std::function<std::vector<std::string>()>& notes);

} // namespace vkcim
