#pragma once

#include "support/HostCopy.h"
#include "support/LogCapture.h"
#include "vk/Root.h"

#include <gtest/gtest.h>

#include <string>

namespace VK::Zone {

/// A host of the test's own with the installed zones, and a log that begins with the test.
class HostWithZones : public testing::Test {
protected:
    HostWithZones() { support::takeLog(); }

    Root root() const { return Root(host.path()); }
    void use(const std::string& zone) { host.useZone(zone); }

    support::HostCopy host;
};

} // namespace VK::Zone
