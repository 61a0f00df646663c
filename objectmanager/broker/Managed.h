#pragma once

#include "objectmanager/model/Values.h"

#include <cmpift.h>

#include <memory>
#include <mutex>
#include <utility>
#include <vector>

namespace om {

class Broker;
class Arena;

/// Who ends a CMPI object.
enum class Owner {
    Call,     ///< the call, when it ends; the provider may release it before
    Provider, ///< a clone, which lives until it is released
    Parent,   ///< the clone that it was got from
    Broker    ///< an argument of a provider's function: releasing it does nothing
};

/// What every CMPI object of the broker has besides its handle: its owner.
class Managed {
public:
    virtual ~Managed();
    Managed& operator=(const Managed&) = delete;

    /// The provider's release: frees a clone at once. An object of the call loses its content, so that a later use is
    /// refused as an invalid handle; its shell goes with the call.
    void release() noexcept;
    void becomeClone();
    /// Makes it the broker's own, which a provider cannot release.
    void lend() { owner_ = Owner::Broker; }

    /// An object for a value that is part of this one: a string, array, date-time, path or instance. It lives as long
    /// as this one does, or at least to the end of the call.
    Managed& part(Value value) const;

    Broker& broker() const { return *broker_; }

protected:
    explicit Managed(Broker& broker);
    /// A copy is nobody's yet.
    Managed(const Managed& other);

    /// Makes the handle invalid and frees what the object holds.
    virtual void clear() noexcept = 0;

private:
    friend class Arena;

    struct Children;
    Managed& childFor(Value value) const;

    Broker* broker_;
    Managed* below_ = nullptr; ///< the object made before it in its arena
    Arena* arena_ = nullptr;
    Owner owner_ = Owner::Call;
    std::unique_ptr<Children> children_; ///< of clones, which are not tied to a call
};

/// The objects of one call, newest first. Used by one thread only.
class Arena {
public:
    Arena() = default;
    ~Arena() { endBackTo(nullptr); }
    Arena(const Arena&) = delete;
    Arena& operator=(const Arena&) = delete;

    void take(std::unique_ptr<Managed> object, Owner owner) noexcept;
    bool holds(const Managed* object) const;
    /// Frees what was made after `object`, and `object` itself last; everything for null.
    void endBackTo(const Managed* object) noexcept;

private:
    Managed* newest = nullptr;
};

/// The provider's function that the present thread is in: owns the objects made meanwhile. Calls nest, as a provider
/// may call back. Also opened by what wants to use the broker without a provider.
class Call {
public:
    Call();
    ~Call();
    Call(const Call&) = delete;
    Call& operator=(const Call&) = delete;

    /// The innermost call of this thread, or null.
    static Call* current();
    /// Whether the arena belongs to a call of this thread, so that this thread may touch its objects.
    static bool ofThisThread(const Arena* arena);

    Arena& arena() { return arena_; }
    /// How many calls of this thread are open.
    int depth() const { return depth_; }

private:
    Call* outer;
    int depth_;
    Arena arena_;
};

/// Hands a new object to the present call, or to the broker's own list where the thread is in none.
void adopt(std::unique_ptr<Managed> object, Owner owner = Owner::Call);

template <class T>
T& adopted(std::unique_ptr<T> object, Owner owner = Owner::Call) {
    T& result = *object;
    adopt(std::move(object), owner);
    return result;
}

/// Makes an object that the present call owns.
template <class T, class... A>
T& make(Broker& broker, A&&... arguments) {
    return adopted(std::make_unique<T>(broker, std::forward<A>(arguments)...));
}

} // namespace om
