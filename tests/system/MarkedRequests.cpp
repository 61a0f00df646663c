// Puts every request of the bench to the host that the environment names. What happens between the marks, which a
// tracer sees, is ten times what one request makes of a host that is known. The program's clock (CoarseClock.h) stands
// still, so that nothing of a host that runs grows a second old, and each look at another clock is a system call.

#include "bench/Rows.h"
#include "support/Provider.h"

#include <exception>
#include <iostream>
#include <optional>
#include <unistd.h>

namespace {

void mark(const std::string& name) {
    access(("mark:" + name).c_str(), F_OK);
}

/// Nothing where the host lacks the element that the row is about.
std::optional<om::Request> requestOf(const bench::Row& row) {
    try {
        return bench::requestOf(row, test::provider());
    } catch (const std::runtime_error&) {
        return std::nullopt;
    }
}

void ask(const om::Request& request, int times) {
    for (int i = 0; i < times; ++i)
        if (test::provider().run(request).code != CMPI_RC_OK) throw std::runtime_error("a request failed");
}

} // namespace

int main() try {
    for (const bench::Row& row : bench::rows()) {
        const std::optional<om::Request> request = requestOf(row);
        if (!request) continue;
        ask(*request, 2);
        mark(bench::nameOf(row));
        ask(*request, 10);
        mark("");
    }
} catch (const std::exception& error) {
    std::cerr << error.what() << '\n';
    return 1;
}
