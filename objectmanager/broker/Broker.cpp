#include "objectmanager/broker/Broker.h"

#include <algorithm>

namespace om {

namespace {

/// Table pointers are const in some versions of the headers only.
template <class Table>
Table* tablePointer(const Table& table) {
    return const_cast<Table*>(&table);
}

} // namespace

Broker::Broker(const Schema& schema, std::string nameSpace)
    : handle_(), schema_(schema), nameSpace_(std::move(nameSpace)) {
    handle_.hdl = this;
    handle_.bft = tablePointer(upCallTable);
    handle_.eft = tablePointer(factoryTable);
    handle_.xft = tablePointer(threadTable);
    handle_.mft = tablePointer(memoryTable);
}

Broker::~Broker() = default;

void Broker::keepUntilTheEnd(std::unique_ptr<Managed> object) {
    const std::lock_guard lock(mutex);
    orphans.take(std::move(object), Owner::Broker);
}

CMPIContext* Broker::prepareAttach(const CMPIContext* context) {
    auto attachment = std::make_unique<Attachment>(*this, om::open<ContextObject>(context).entries);
    attachment->context.lend();
    const std::lock_guard lock(mutex);
    return &attachments.emplace_back(std::move(attachment))->context;
}

Broker::Attachments::iterator Broker::findAttachment(const CMPIContext* context) {
    const auto found = std::find_if(attachments.begin(), attachments.end(),
                                    [context](const auto& each) { return &each->context == context; });
    if (found == attachments.end()) throw Failure{CMPI_RC_ERR_INVALID_HANDLE};
    return found;
}

void Broker::attach(const CMPIContext* context) {
    const std::lock_guard lock(mutex);
    const auto found = findAttachment(context);
    if ((*found)->call) throw Failure{CMPI_RC_ERR_FAILED};
    (*found)->call = std::make_unique<Call>();
}

void Broker::detach(const CMPIContext* context) {
    std::unique_ptr<Attachment> ended; // destroyed after the lock is gone
    const std::lock_guard lock(mutex);
    const auto found = findAttachment(context);
    // Only the thread that was attached can be detached, and not from within a call back into a provider.
    if ((*found)->call == nullptr || (*found)->call.get() != Call::current()) throw Failure{CMPI_RC_ERR_FAILED};
    ended = std::move(*found);
    attachments.erase(found);
}

Broker& open(const CMPIBroker* handle) {
    if (handle == nullptr || handle->hdl == nullptr || handle->bft != &upCallTable) {
        throw Failure{CMPI_RC_ERR_INVALID_HANDLE};
    }
    return *static_cast<Broker*>(const_cast<void*>(static_cast<const void*>(handle->hdl)));
}

} // namespace om
