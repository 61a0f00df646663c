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

std::size_t sizeOf(const om::ObjectPath& path);
std::size_t sizeOf(const om::Instance& instance);

std::size_t sizeOf(const om::Value& value) {
    std::size_t bytes = sizeof value;
    if (const auto* text = std::get_if<std::string>(&value.data)) bytes += text->size();
    const auto* path = std::get_if<std::shared_ptr<const om::ObjectPath>>(&value.data);
    if (path && *path) bytes += sizeOf(**path);
    const auto* part = std::get_if<std::shared_ptr<const om::Instance>>(&value.data);
    if (part && *part) bytes += sizeOf(**part);
    if (const auto* elements = std::get_if<std::vector<om::Value>>(&value.data)) {
        for (const om::Value& element : *elements) bytes += sizeOf(element);
    }
    return bytes;
}

std::size_t sizeOf(const std::vector<om::NamedValue>& values) {
    std::size_t bytes = 0;
    for (const auto& [name, value] : values) bytes += sizeof(std::string) + name.size() + sizeOf(value);
    return bytes;
}

std::size_t sizeOf(const om::ObjectPath& path) {
    return sizeof path + path.host.size() + path.nameSpace.size() + path.className.size() + sizeOf(path.keys);
}

std::size_t sizeOf(const om::Instance& instance) {
    return sizeOf(instance.path) + sizeOf(instance.properties);
}

/// About what it takes of memory.
std::size_t sizeOf(const Enumeration& enumeration) {
    std::size_t bytes = 0;
    for (std::size_t i = enumeration.next; i < enumeration.elements.size(); ++i)
        bytes += std::visit([](const auto& each) { return sizeOf(each); }, enumeration.elements[i]);
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

void Contexts::store(const std::string& name, Enumeration enumeration, std::size_t bytes, Clock::time_point now) {
    const Clock::time_point deadline = now + enumeration.timeout;
    held += bytes;
    kept[name] = {std::move(enumeration), bytes, deadline};
}

std::string Contexts::keep(Enumeration enumeration, Clock::time_point now) {
    std::string name = randomName();
    const std::size_t bytes = sizeOf(enumeration); // of all its elements: nobody waits for that
    const std::lock_guard lock(mutex);
    dropOld(now);
    const auto ofUser = std::count_if(
        kept.begin(), kept.end(), [&](const auto& each) { return each.second.enumeration.user == enumeration.user; });
    if (kept.size() >= mostContexts || static_cast<std::size_t>(ofUser) >= mostOfAUser || held + bytes > mostBytes) {
        throw cimxml::CimError(serverLimitsExceeded, "too many enumerations are open");
    }
    store(name, std::move(enumeration), bytes, now);
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
    const std::size_t bytes = sizeOf(enumeration);
    const std::lock_guard lock(mutex);
    store(name, std::move(enumeration), bytes, now);
}

} // namespace endpoint
