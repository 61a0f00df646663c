#include "objectmanager/broker/String.h"

namespace om {

namespace {

const char* getCharPtr(const CMPIString* handle, CMPIStatus*) {
    return open<StringObject>(handle).text().c_str();
}

constexpr CMPIStringFT makeTable() {
    auto ft = emptyTable<CMPIStringFT>();
    ft.release = Slot<&releaseObject<StringObject>, FaultKind::release>();
    ft.clone = Slot<&cloneObject<StringObject>, FaultKind::clone>();
    ft.getCharPtr = Slot<&getCharPtr, FaultKind::getCharPtr>();
    return ft;
}

} // namespace

const CMPIStringFT StringObject::table = makeTable();

// The handle points to the text itself: providers built with older headers read it there.
StringObject::StringObject(Broker& broker, std::string text) : Object(broker), text_(std::move(text)) {
    pointTo(text_.c_str());
}

StringObject::StringObject(const StringObject& other) : Object(other), text_(other.text_) {
    pointTo(text_.c_str());
}

void StringObject::clear() noexcept {
    invalidate();
    text_ = std::string();
}

CMPIString* newString(Broker& broker, std::string text) {
    return &make<StringObject>(broker, std::move(text));
}

CMPIString* partString(const Managed& parent, std::string text) {
    return &static_cast<StringObject&>(parent.part({CMPI_string, std::move(text)}));
}

} // namespace om
