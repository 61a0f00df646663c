#include "objectmanager/broker/Managed.h"

#include "objectmanager/broker/Broker.h"
#include "objectmanager/broker/Convert.h"

namespace om {

namespace {

// A plain pointer, so that it needs no destructor when a thread ends.
thread_local Call* currentCall = nullptr;

} // namespace

/// The parts of a clone that were asked for, each with the value it shows: asking again gives the same object, so that
/// a clone that is kept for long does not grow.
struct Managed::Children {
    std::mutex mutex; // clones may be used by several threads
    std::vector<std::pair<Value, std::unique_ptr<Managed>>> list;
};

Managed::Managed(Broker& broker) : broker_(&broker) {}

Managed::Managed(const Managed& other) : broker_(other.broker_) {}

Managed::~Managed() = default;

void Managed::becomeClone() {
    children_ = std::make_unique<Children>();
    owner_ = Owner::Provider;
}

Managed& Managed::part(Value value) const {
    if (children_) return childFor(std::move(value));
    return adopted(wrap(broker(), std::move(value)));
}

Managed& Managed::childFor(Value value) const {
    const std::lock_guard lock(children_->mutex);
    for (auto& [source, child] : children_->list) {
        if (source == value) return *child;
    }
    auto child = wrap(broker(), value);
    child->becomeClone();
    child->owner_ = Owner::Parent;
    return *children_->list.emplace_back(std::move(value), std::move(child)).second;
}

void Managed::release() noexcept {
    if (owner_ == Owner::Provider) {
        // What was got from the clone stays valid to the end of the call.
        if (Call* call = Call::current()) {
            for (auto& child : children_->list) call->arena().take(std::move(child.second), Owner::Call);
        }
        delete this;
    } else if (owner_ == Owner::Call && Call::ofThisThread(arena_)) {
        clear();
    }
}

void Arena::take(std::unique_ptr<Managed> object, Owner owner) noexcept {
    object->arena_ = this;
    object->owner_ = owner;
    object->below_ = newest;
    newest = object.release();
}

bool Arena::holds(const Managed* object) const {
    for (const Managed* each = newest; each != nullptr; each = each->below_) {
        if (each == object) return true;
    }
    return false;
}

void Arena::endBackTo(const Managed* object) noexcept {
    while (newest != nullptr) {
        const std::unique_ptr<Managed> ended(newest);
        newest = ended->below_;
        if (ended.get() == object) return;
    }
}

Call::Call() : outer(currentCall), depth_(outer == nullptr ? 1 : outer->depth_ + 1) {
    currentCall = this;
}

Call::~Call() {
    // An attached thread's call may be ended by another thread, when the broker goes.
    if (currentCall == this) currentCall = outer;
}

Call* Call::current() {
    return currentCall;
}

bool Call::ofThisThread(const Arena* arena) {
    for (Call* call = currentCall; call != nullptr; call = call->outer) {
        if (&call->arena_ == arena) return true;
    }
    return false;
}

void adopt(std::unique_ptr<Managed> object, Owner owner) {
    if (Call* call = Call::current()) {
        call->arena().take(std::move(object), owner);
    } else {
        Broker& broker = object->broker();
        broker.keepUntilTheEnd(std::move(object));
    }
}

} // namespace om
