#include "objectmanager/endpoint/Contexts.h"

#include "objectmanager/cimxml/Errors.h"

#include <sys/random.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <system_error>

namespace endpoint {
namespace {

constexpr int serverLimitsExceeded = 27;

std::string randomName() {
    std::array<unsigned char, 16> bytes{};
    if (getrandom(bytes.data(), bytes.size(), 0) != static_cast<ssize_t>(bytes.size())) {
        throw std::system_error(errno, std::generic_category(), "getrandom");
    }
    constexpr const char* digits = "0123456789abcdef";
    std::string name;
    for (const unsigned char byte : bytes) {
        name += digits[byte >> 4U];
        name += digits[byte & 0xFU];
    }
    return name;
}

std::size_t sizeOf(const Enumeration& enumeration) {
    std::size_t bytes = 0;
    for (std::size_t i = enumeration.next; i < enumeration.elements.size(); ++i)
        bytes += enumeration.elements[i].size();
    return bytes;
}

} // namespace

void Contexts::dropOld(Clock::time_point now) {
    for (auto each = kept.begin(); each != kept.end();) {
        if (each->second.deadline > now) {
            ++each;
            continue;
        }
        held -= each->second.bytes;
        each = kept.erase(each);
    }
}

void Contexts::store(const std::string& name, Enumeration enumeration, Clock::time_point now) {
    const std::size_t bytes = sizeOf(enumeration);
    const Clock::time_point deadline = now + enumeration.timeout;
    held += bytes;
    kept[name] = {std::move(enumeration), bytes, deadline};
}

std::string Contexts::keep(Enumeration enumeration, Clock::time_point now) {
    std::string name = randomName();
    const std::lock_guard lock(mutex);
    dropOld(now);
    const auto ofUser = std::count_if(
        kept.begin(), kept.end(), [&](const auto& each) { return each.second.enumeration.user == enumeration.user; });
    if (kept.size() >= mostContexts || static_cast<std::size_t>(ofUser) >= mostOfAUser ||
        held + sizeOf(enumeration) > mostBytes) {
        throw cimxml::CimError(serverLimitsExceeded, "too many enumerations are open");
    }
    store(name, std::move(enumeration), now);
    return name;
}

std::optional<Enumeration> Contexts::take(const std::string& name, Clock::time_point now) {
    const std::lock_guard lock(mutex);
    dropOld(now);
    const auto found = kept.find(name);
    if (found == kept.end()) return std::nullopt;
    Enumeration enumeration = std::move(found->second.enumeration);
    held -= found->second.bytes;
    kept.erase(found);
    return enumeration;
}

void Contexts::putBack(const std::string& name, Enumeration enumeration, Clock::time_point now) {
    const std::lock_guard lock(mutex);
    store(name, std::move(enumeration), now);
}

} // namespace endpoint
