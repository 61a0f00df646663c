#pragma once

#include "objectmanager/broker/ObjectManager.h"

#include <string>
#include <vector>

namespace bench {

/// One request that is measured, at each number of computers of its series.
struct Row {
    om::Operation operation;
    std::string className;
    std::string assocClass;     ///< for associations, empty otherwise
    std::vector<int> computers; ///< of the simulated host
};

inline const std::vector<int> one = {1};

/// Every class of the schema that answers without running a command. GetInstance and associations ask for the last
/// element of the class.
std::vector<Row> rows();

/// `EnumInstances/VESKA_ComputerSystem`, behind it the association's class where there is one.
std::string nameOf(const Row& row);

/// The same with `/computers:10` or `/live` behind it.
std::string nameOf(const Row& row, bool live, int computers);

/// The request of a row, put to the host as it stands. Throws when the class has no element to ask for.
om::Request requestOf(const Row& row, om::ObjectManager& provider);

} // namespace bench
