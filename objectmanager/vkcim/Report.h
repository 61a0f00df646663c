#pragma once

#include "objectmanager/broker/ObjectManager.h"

#include <ctime>
#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace vkcim {

struct Report {
    using Answers = std::vector<std::pair<std::string, om::Answer>>;

    std::string host; ///< the name of the host that is described, for people
    Answers classes;
    Answers associations;
    std::vector<std::string> notes;
    std::string version;  ///< of this program
    std::time_t time = 0; ///< of the end
};

/// A time in UTC: `2026-11-21T06:00:00Z`.
std::string utcText(std::time_t time);

/// Whether a key or property of that name names a class only: CreationClassName, SystemCreationClassName and the like.
bool namesClass(std::string_view name);

/// The classes and associations of a report, in its order.
struct Subjects {
    std::vector<std::string> classes;
    std::vector<std::string> associations;
};

/// Every class and every association that the schema says is served.
Subjects everythingServed(const om::Schema& schema);

/// Asks every class and then every association for its instances. `run` runs one request; `notes` is asked last.
Report makeReport(const Subjects& subjects, const std::string& nameSpace,
                  const std::optional<std::vector<std::string>>& properties,
                  const std::function<om::Answer(const om::Request&)>& run,
                  const std::function<std::vector<std::string>()>& notes);

/// One association as the report draws it: what stands above and what below.
struct Link {
    std::string above;
    std::string below;
    std::string association;
};

/// The associations among what was answered, each end as its path's text without the keys that name a class only.
std::vector<Link> links(const Report::Answers& associations, const std::string& nameSpace, const om::Schema& schema);

} // namespace vkcim
