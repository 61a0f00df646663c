#include "host/Fact.h"

#include <cerrno>

namespace VK::Host {

namespace {

/// How much a miss says of why there is no text.
unsigned int weight(const Fact& miss) {
    if (!miss.placeholder.empty()) return 3;
    if (!miss.problem.empty() || miss.error != ENOENT) return 2;
    return 1;
}

} // namespace

Fact missing(const std::string& source, int error) {
    Fact fact;
    fact.source = source;
    fact.error = error;
    return fact;
}

Fact factOf(const std::string& source, const std::string& text, FirmwareText kind) {
    Fact fact;
    fact.source = source;
    if (!text.empty() && !isPlaceholder(text, kind)) {
        fact.text = text;
        return fact;
    }
    fact.error = ENOENT;
    fact.placeholder = text;
    return fact;
}

Fact firstOf(std::initializer_list<Fact> facts) {
    Fact best;
    for (const Fact& fact : facts) {
        if (fact) return fact;
        if (best.source.empty() || weight(fact) > weight(best)) best = fact;
    }
    return best;
}

} // namespace VK::Host
