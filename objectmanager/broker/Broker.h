#pragma once

#include "objectmanager/broker/Context.h"
#include "objectmanager/broker/Memory.h"
#include "objectmanager/model/Schema.h"

#include <cmpift.h>

#include <list>
#include <memory>
#include <mutex>
#include <string>

namespace om {

class ProviderLibrary;

/// What a provider is given: the handle with the four function tables, and behind it the schema, the provider that
/// up-calls go to, and all memory that no call owns.
class Broker {
public:
    Broker(const Schema& schema, std::string nameSpace);
    ~Broker();
    Broker(const Broker&) = delete;
    Broker& operator=(const Broker&) = delete;

    const CMPIBroker* handle() const { return &handle_; }
    const Schema& schema() const { return schema_; }
    /// The namespace of requests that name none.
    const std::string& nameSpace() const { return nameSpace_; }

    /// The provider that up-calls go to; null until one is loaded.
    ProviderLibrary* provider = nullptr;
    MemoryBlocks memory; ///< of cmpiMalloc and its like

    /// Keeps an object that was made on a thread without a call.
    void keepUntilTheEnd(std::unique_ptr<Managed> object);

    /// A context with which another thread can be attached.
    CMPIContext* prepareAttach(const CMPIContext* context);
    void attach(const CMPIContext* context);
    void detach(const CMPIContext* context);

private:
    /// A thread that the provider made: its context, and its call from attach to detach.
    struct Attachment {
        Attachment(Broker& broker, std::vector<ContextEntry> entries) : context(broker, std::move(entries)) {}

        ContextObject context;
        std::unique_ptr<Call> call;
    };
    using Attachments = std::list<std::unique_ptr<Attachment>>;

    Attachments::iterator findAttachment(const CMPIContext* context);

    CMPIBroker handle_;
    const Schema& schema_;
    std::string nameSpace_;
    std::mutex mutex; // of the two below
    Arena orphans;
    Attachments attachments;
};

/// Our side of a broker handle; throws Failure INVALID_HANDLE.
Broker& open(const CMPIBroker* handle);

extern const CMPIBrokerFT upCallTable;
extern const CMPIBrokerEncFT factoryTable;
extern const CMPIBrokerExtFT threadTable;
extern const CMPIBrokerMemFT memoryTable;

} // namespace om
