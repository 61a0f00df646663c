#pragma once

#include <cstddef>
#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace om {

// The broker operations that can be made to fail, named after their slots. Slots of one name in several function
// tables are one kind.
// clang-format off
#define OM_FAULT_KINDS(X) \
    X(newInstance) X(newObjectPath) X(newArgs) X(newString) X(newArray) X(newDateTime) X(newDateTimeFromBinary) \
    X(newDateTimeFromChars) X(newCMPIError) X(classPathIsA) X(toString) X(isOfType) X(getType) X(getMessage) \
    X(release) X(clone) \
    X(setNameSpace) X(getNameSpace) X(setHostname) X(getHostname) X(setClassName) X(getClassName) X(addKey) X(getKey) \
    X(getKeyAt) X(getKeyCount) X(setNameSpaceFromObjectPath) X(setHostAndNameSpaceFromObjectPath) \
    X(getProperty) X(getPropertyAt) X(getPropertyCount) X(setProperty) X(getObjectPath) X(setPropertyFilter) \
    X(setObjectPath) X(setPropertyWithOrigin) \
    X(addArg) X(getArg) X(getArgAt) X(getArgCount) \
    X(getSize) X(getSimpleType) X(getElementAt) X(setElementAt) \
    X(getCharPtr) X(getBinaryFormat) X(getStringFormat) X(isInterval) X(getNext) X(hasNext) X(toArray) \
    X(getEntry) X(getEntryAt) X(getEntryCount) X(addEntry) \
    X(returnData) X(returnInstance) X(returnObjectPath) X(returnDone) X(returnError) \
    X(enumerateInstanceNames) X(enumerateInstances) X(getInstance) X(createInstance) X(modifyInstance) \
    X(deleteInstance) X(execQuery) X(associators) X(associatorNames) X(references) X(referenceNames) X(invokeMethod) \
    X(prepareAttachThread) X(attachThread) X(detachThread) \
    X(mark) X(cmpiMalloc) X(cmpiCalloc) X(cmpiRealloc) X(cmpiStrDup) \
    X(newThread) X(newMutex) X(newCondition) X(createThreadKey)
// clang-format on

#define OM_ENUMERATOR(name) name,
enum class FaultKind : unsigned char {
    None, ///< of slots that never fail on request
    OM_FAULT_KINDS(OM_ENUMERATOR)
};
#undef OM_ENUMERATOR

/// The names of all kinds, in their order.
const std::vector<std::string>& faultNames();
/// The kind of that name, exactly as it is written; nothing for another text.
std::optional<FaultKind> faultKind(std::string_view name);

/// A failure that is asked for: as object managers fail when they run out of memory. It returns null (a count 0, data
/// that is not there) with the status CMPI_RC_ERR_FAILED, and does nothing else.
struct Fault {
    FaultKind kind = FaultKind::None;
    std::size_t call = 1;  ///< which call of that kind fails, counted from 1
    bool lasting = false;  ///< all later ones fail, too
    bool unstated = false; ///< the status says OK, as some object managers leave it; not for slots that return it
};

/// Receives the slot's name before each call to the broker is done, so that a test can write it into the log
/// between the provider's lines. Slots that never fail on request are not reported.
using CallObserver = std::function<void(const std::string& slot)>;

/// Watches the calls that this thread's providers make while it lives: counts those that may fail, and reports them.
/// A nested one changes nothing: a provider's call back is part of the operation.
class CallWatch {
public:
    explicit CallWatch(const std::optional<Fault>& fault, CallObserver observer = {});
    ~CallWatch();
    CallWatch(const CallWatch&) = delete;
    CallWatch& operator=(const CallWatch&) = delete;

    /// The present thread's; null, as nearly always, when there is nothing to watch for.
    static CallWatch* current() { return current_; }

    /// Takes note of one call; whether it is to fail.
    bool fails(FaultKind kind) {
        if (observer_) observer_(faultNames()[static_cast<std::size_t>(kind) - 1]);
        if (kind != fault_.kind) return false;
        ++calls_;
        const bool due = fault_.lasting ? calls_ >= fault_.call : calls_ == fault_.call;
        happened_ = happened_ || due;
        return due;
    }
    bool unstated() const { return fault_.unstated; }
    /// Whether a call has failed.
    bool happened() const { return happened_; }

private:
    // A plain pointer, so that it costs every call next to nothing and needs no destructor when a thread ends.
    inline static thread_local CallWatch* current_ = nullptr;

    Fault fault_;
    CallObserver observer_;
    std::size_t calls_ = 0;
    bool happened_ = false;
};

} // namespace om
