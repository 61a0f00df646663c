#include "objectmanager/model/Values.h"

namespace om {

namespace {

template <class T>
bool same(const T& a, const T& b) {
    return a == b;
}

template <class T>
bool same(const std::shared_ptr<const T>& a, const std::shared_ptr<const T>& b) {
    return a == b || (a && b && *a == *b);
}

} // namespace

bool operator==(const Value& a, const Value& b) {
    if (a.type != b.type || a.data.index() != b.data.index()) return false;
    return std::visit([&b](const auto& left) { return same(left, std::get<std::decay_t<decltype(left)>>(b.data)); },
                      a.data);
}

bool operator==(const ObjectPath& a, const ObjectPath& b) {
    return a.host == b.host && a.nameSpace == b.nameSpace && a.className == b.className && a.keys == b.keys;
}

bool operator==(const Instance& a, const Instance& b) {
    return a.path == b.path && a.properties == b.properties;
}

} // namespace om
