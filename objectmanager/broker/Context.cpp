#include "objectmanager/broker/Context.h"

#include "objectmanager/broker/Convert.h"
#include "objectmanager/broker/String.h"
#include "objectmanager/model/Names.h"

namespace om {

namespace {

CMPIData giveEntry(const ContextObject& self, const ContextEntry& entry) {
    if (entry.value.type != CMPI_ptr) return give(self, entry.value);
    CMPIData data = noData();
    data.type = CMPI_ptr;
    data.state = CMPI_goodValue;
    data.value.dataPtr = entry.pointer;
    return data;
}

ContextEntry* find(ContextObject& self, const char* name) {
    for (ContextEntry& entry : self.entries) {
        if (sameName(entry.name, name)) return &entry;
    }
    return nullptr;
}

CMPIData getEntry(const CMPIContext* handle, const char* name, CMPIStatus* rc) {
    auto& self = open<ContextObject>(handle);
    if (const ContextEntry* entry = find(self, text(name))) return giveEntry(self, *entry);
    report(rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
    return noData();
}

CMPIData getEntryAt(const CMPIContext* handle, CMPICount index, CMPIString** name, CMPIStatus* rc) {
    if (name != nullptr) *name = nullptr;
    const auto& self = open<ContextObject>(handle);
    if (index >= self.entries.size()) {
        report(rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
        return noData();
    }
    const ContextEntry& entry = self.entries[index];
    if (name != nullptr) *name = partString(self, entry.name);
    return giveEntry(self, entry);
}

CMPICount getEntryCount(const CMPIContext* handle, CMPIStatus*) {
    return static_cast<CMPICount>(open<ContextObject>(handle).entries.size());
}

CMPIStatus addEntry(const CMPIContext* handle, const char* name, const CMPIValue* value, CMPIType type) {
    auto& self = open<ContextObject>(handle);
    ContextEntry entry{text(name), {}, {}};
    if (type != CMPI_ptr) {
        entry.value = read(value, type);
    } else {
        entry.value.type = CMPI_ptr;
        if (value != nullptr) std::memcpy(&entry.pointer, static_cast<const void*>(value), sizeof entry.pointer);
    }
    if (ContextEntry* old = find(self, name)) {
        *old = std::move(entry);
    } else {
        self.entries.push_back(std::move(entry));
    }
    return status(CMPI_RC_OK);
}

constexpr CMPIContextFT makeTable() {
    auto ft = emptyTable<CMPIContextFT>();
    ft.release = Slot<&releaseObject<ContextObject>, FaultKind::release>();
    ft.clone = Slot<&cloneObject<ContextObject>, FaultKind::clone>();
    ft.getEntry = Slot<&getEntry, FaultKind::getEntry>();
    ft.getEntryAt = Slot<&getEntryAt, FaultKind::getEntryAt>();
    ft.getEntryCount = Slot<&getEntryCount, FaultKind::getEntryCount>();
    ft.addEntry = Slot<&addEntry, FaultKind::addEntry>();
    return ft;
}

} // namespace

const CMPIContextFT ContextObject::table = makeTable();

void ContextObject::clear() noexcept {
    invalidate();
    entries = std::vector<ContextEntry>();
}

std::vector<ContextEntry> usualEntries(const std::string& nameSpace, const std::string& principal) {
    const auto string = [](const char* name, std::string text) {
        return ContextEntry{name, {CMPI_string, std::move(text)}, {}};
    };
    return {{CMPIInvocationFlags, {CMPI_uint32, std::uint64_t{0}}, {}},
            string(CMPIInitNameSpace, nameSpace),
            string(CMPIPrincipal, principal),
            string(CMPIRole, ""),
            string(CMPIAcceptLanguage, ""),
            string(CMPIContentLanguage, "")};
}

} // namespace om
