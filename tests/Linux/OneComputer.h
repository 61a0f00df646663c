#pragma once

#include "support/SimulatedHost.h"

namespace test {

/// The host of one computer, changed by `change`, and its chassis.
template <class Change>
void simulateOne(Change change) {
    Node node = computer(0, "node7");
    change(node);
    simulate({node, chassis(0, 0, "CZ1")});
}

} // namespace test
