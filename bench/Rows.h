#pragma once

#include "objectmanager/broker/ObjectManager.h"

#include <string>
#include <vector>

namespace bench {

/// One request that is measured, at each number of computers of its series.
struct Row {
    om::Operation operation;
    const char* className;
    const char* assocClass;     ///< for associations, null otherwise
    std::vector<int> computers; ///< of the simulated host
};

inline const std::vector<int> one = {1};
inline const std::vector<int> series = {1, 10, 100, 1000};
inline const std::vector<int> shortSeries = {1, 10, 100}; ///< for what may grow with the square

// A further class is a further row. GetInstance and associations ask for the last element of the class.
// clang-format off
inline const std::vector<Row> rows = {
    {om::Operation::EnumInstanceNames, "VESKA_ComputerSystem",                    nullptr, series},
    {om::Operation::EnumInstances,     "VESKA_ComputerSystem",                    nullptr, series},
    {om::Operation::GetInstance,       "VESKA_ComputerSystem",                    nullptr, series},
    {om::Operation::EnumInstanceNames, "VESKA_PhysicalPackage",                   nullptr, series},
    {om::Operation::EnumInstances,     "VESKA_PhysicalPackage",                   nullptr, series},
    {om::Operation::GetInstance,       "VESKA_PhysicalPackage",                   nullptr, series},
    {om::Operation::EnumInstanceNames, "VESKA_EnabledLogicalElementCapabilities", nullptr, series},
    {om::Operation::EnumInstances,     "VESKA_EnabledLogicalElementCapabilities", nullptr, series},
    {om::Operation::GetInstance,       "VESKA_EnabledLogicalElementCapabilities", nullptr, series},
    {om::Operation::EnumInstances,     "VESKA_ComputerSystemPackage",             nullptr, shortSeries},
    {om::Operation::EnumInstances,     "VESKA_ComputerCapabilities",              nullptr, shortSeries},
    {om::Operation::Associators,       "VESKA_ComputerSystem",  "VESKA_ComputerSystemPackage", shortSeries},
    {om::Operation::AssociatorNames,   "VESKA_ComputerSystem",  "VESKA_ComputerSystemPackage", shortSeries},
    {om::Operation::Associators,       "VESKA_PhysicalPackage", "VESKA_ComputerSystemPackage", shortSeries},
    {om::Operation::Associators,       "VESKA_ComputerSystem",  "VESKA_ComputerCapabilities",  shortSeries},
    {om::Operation::EnumInstanceNames, "VESKA_TimeService",                       nullptr, one},
    {om::Operation::EnumInstanceNames, "VESKA_TimeServiceAffectsElement",         nullptr, one},
};
// clang-format on

/// `EnumInstances/VESKA_ComputerSystem/computers:10`, or `/live`.
std::string nameOf(const Row& row, bool live, int computers);

/// The request of a row, put to the host as it stands. Throws when the class has no element to ask for.
om::Request requestOf(const Row& row, om::ObjectManager& provider);

} // namespace bench
