#pragma once

#include "objectmanager/broker/Managed.h"
#include "objectmanager/broker/Slot.h"

namespace om {

/// A CMPI object: the two-word handle that providers see, and our side of it. `Kind` is the class derived from this;
/// it has a `static const ...FT table`.
template <class Kind, class HandleType>
class Object : public HandleType, public Managed {
public:
    using Handle = HandleType;

    explicit Object(Broker& broker) : Handle(), Managed(broker) { initialise(); }
    Object(const Object& other) : Handle(), Managed(other) { initialise(); }
    Object& operator=(const Object&) = delete;

protected:
    /// Never null in a live object; providers may look at it to recognise a null object.
    void pointTo(const void* data) { this->hdl = const_cast<void*>(data); }
    void invalidate() noexcept { this->hdl = nullptr; }

private:
    void initialise() {
        pointTo(this);
        this->ft = const_cast<std::remove_const_t<std::remove_pointer_t<decltype(this->ft)>>*>(&Kind::table);
    }
};

template <class T>
bool isValid(const typename T::Handle* handle) {
    return handle != nullptr && handle->hdl != nullptr && handle->ft == &T::table;
}

/// Our side of a handle; a null, released or foreign one is a failure. Constness is only the headers' affair: what
/// they declare const differs between their versions.
template <class T>
T& open(const typename T::Handle* handle) {
    if (!isValid<T>(handle)) throw Failure{CMPI_RC_ERR_INVALID_HANDLE};
    return *static_cast<T*>(const_cast<typename T::Handle*>(handle));
}

/// A text argument, which must be there.
inline const char* text(const char* argument) {
    if (argument == nullptr) throw Failure{CMPI_RC_ERR_INVALID_PARAMETER};
    return argument;
}

template <class T>
CMPIStatus releaseObject(const typename T::Handle* handle) {
    open<T>(handle).release();
    return status(CMPI_RC_OK);
}

template <class T>
typename T::Handle* cloneObject(const typename T::Handle* handle, CMPIStatus*) {
    auto copy = std::make_unique<T>(open<T>(handle));
    copy->becomeClone();
    return copy.release();
}

} // namespace om
