#pragma once

#include <string>
#include <vector>

/// A syslog of the test's own: what the logger sent since it was last asked, as `PRIORITY TEXT`.
std::vector<std::string> takeSyslog();

/// How often openlog and closelog were called, which belong to the object manager.
int openlogCalls();
