#include "objectmanager/broker/Broker.h"
#include "objectmanager/broker/Slot.h"

#include <condition_variable>
#include <ctime>
#include <memory>
#include <mutex>
#include <pthread.h>
#include <string>

namespace om {

namespace {

pthread_t nativeThread(void* thread) {
    return reinterpret_cast<pthread_t>(thread);
}

/// Memory for the caller to free, as older providers do.
char* resolveFileName(const char* library) {
    const std::string name = library == nullptr ? "" : library;
    return name.empty() ? nullptr : strdup(("lib" + name + ".so").c_str());
}

using ThreadFunction = void* (*)(void*);

void* newThread(ThreadFunction start, void* argument, int detached) {
    if (start == nullptr) return nullptr;
    pthread_attr_t attributes;
    if (pthread_attr_init(&attributes) != 0) return nullptr;
    if (detached != 0) pthread_attr_setdetachstate(&attributes, PTHREAD_CREATE_DETACHED);
    pthread_t thread{};
    const int error = pthread_create(&thread, &attributes, start, argument);
    pthread_attr_destroy(&attributes);
    return error == 0 ? reinterpret_cast<void*>(thread) : nullptr;
}

int joinThread(void* thread, void** result) {
    return thread == nullptr ? EINVAL : pthread_join(nativeThread(thread), result);
}

int exitThread(void* result) {
    pthread_exit(result);
}

int cancelThread(void* thread) {
    return thread == nullptr ? EINVAL : pthread_cancel(nativeThread(thread));
}

int threadSleep(CMPIUint32 milliseconds) {
    timespec left{static_cast<time_t>(milliseconds / 1000), static_cast<long>(milliseconds % 1000) * 1'000'000};
    int error = 0;
    do {
        error = clock_nanosleep(CLOCK_MONOTONIC, 0, &left, &left);
    } while (error == EINTR);
    return error;
}

/// The variable starts as 0; others wait until the function of the first has returned. If that ends by an exception
/// or with its thread, the next one runs it again.
int threadOnce(int* once, void (*initialise)()) {
    constexpr int fresh = 0;
    constexpr int done = 1;
    constexpr int running = 2;
    if (once == nullptr || initialise == nullptr) return EINVAL;
    if (__atomic_load_n(once, __ATOMIC_ACQUIRE) == done) return 0;
    static std::mutex mutex;
    static std::condition_variable changed;
    std::unique_lock lock(mutex);
    changed.wait(lock, [once] { return __atomic_load_n(once, __ATOMIC_RELAXED) != running; });
    if (__atomic_load_n(once, __ATOMIC_RELAXED) == done) return 0;
    __atomic_store_n(once, running, __ATOMIC_RELAXED);
    lock.unlock();
    const auto finish = [&](int state) {
        lock.lock();
        __atomic_store_n(once, state, __ATOMIC_RELEASE);
        changed.notify_all();
    };
    try {
        initialise();
    } catch (...) {
        finish(fresh);
        throw;
    }
    finish(done);
    return 0;
}

/// Exactly four bytes are written; providers whose keys have eight initialise them and pass them by value.
int createThreadKey(void* key, void (*destructor)(void*)) {
    if (key == nullptr) return EINVAL;
    pthread_key_t created{};
    const int error = pthread_key_create(&created, destructor);
    static_assert(sizeof created == 4);
    if (error == 0) std::memcpy(key, &created, sizeof created);
    return error;
}

pthread_key_t nativeKey(unsigned long key) {
    return static_cast<pthread_key_t>(key);
}

int destroyThreadKey(unsigned long key) {
    return pthread_key_delete(nativeKey(key));
}
void* getThreadSpecific(unsigned long key) {
    return pthread_getspecific(nativeKey(key));
}
int setThreadSpecific(unsigned long key, void* value) {
    return pthread_setspecific(nativeKey(key), value);
}

pthread_mutex_t* nativeMutex(void* mutex) {
    return static_cast<pthread_mutex_t*>(mutex);
}
pthread_cond_t* nativeCondition(void* condition) {
    return static_cast<pthread_cond_t*>(condition);
}

void* newMutex(int) {
    auto mutex = std::make_unique<pthread_mutex_t>();
    pthread_mutexattr_t attributes;
    if (pthread_mutexattr_init(&attributes) != 0) return nullptr;
    pthread_mutexattr_settype(&attributes, PTHREAD_MUTEX_RECURSIVE);
    const int error = pthread_mutex_init(mutex.get(), &attributes);
    pthread_mutexattr_destroy(&attributes);
    return error == 0 ? mutex.release() : nullptr;
}

/// A mutex that is still locked stays, for who holds it.
int destroyMutex(void* mutex) {
    if (mutex == nullptr) return EINVAL;
    const int error = pthread_mutex_destroy(nativeMutex(mutex));
    if (error == 0) delete nativeMutex(mutex);
    return error;
}

int lockMutex(void* mutex) {
    return mutex == nullptr ? EINVAL : pthread_mutex_lock(nativeMutex(mutex));
}
int unlockMutex(void* mutex) {
    return mutex == nullptr ? EINVAL : pthread_mutex_unlock(nativeMutex(mutex));
}

void* newCondition(int) {
    auto condition = std::make_unique<pthread_cond_t>();
    return pthread_cond_init(condition.get(), nullptr) == 0 ? condition.release() : nullptr;
}

int destroyCondition(void* condition) {
    if (condition == nullptr) return EINVAL;
    const int error = pthread_cond_destroy(nativeCondition(condition));
    if (error == 0) delete nativeCondition(condition);
    return error;
}

int condWait(void* condition, void* mutex) {
    if (condition == nullptr || mutex == nullptr) return EINVAL;
    return pthread_cond_wait(nativeCondition(condition), nativeMutex(mutex));
}

/// `until` is a time of the realtime clock, not a duration.
int timedCondWait(void* condition, void* mutex, const timespec* until) {
    if (condition == nullptr || mutex == nullptr || until == nullptr) return EINVAL;
    return pthread_cond_timedwait(nativeCondition(condition), nativeMutex(mutex), until);
}

/// Wakes one waiter.
int signalCondition(void* condition) {
    return condition == nullptr ? EINVAL : pthread_cond_signal(nativeCondition(condition));
}

/// Later headers append these slots; they are filled where they are there.
template <class Table>
constexpr auto fillLater(Table& ft, int) -> decltype(ft.destroyCondition2, void()) {
    ft.destroyMutex2 = Slot<&destroyMutex>();
    ft.lockMutex2 = Slot<&lockMutex>();
    ft.unlockMutex2 = Slot<&unlockMutex>();
    ft.destroyCondition2 = Slot<&destroyCondition>();
}
template <class Table>
constexpr void fillLater(Table&, long) {}

constexpr void fillSynchronisation(CMPIBrokerExtFT& ft) {
    ft.newMutex = Slot<&newMutex, FaultKind::newMutex>();
    ft.destroyMutex = Slot<&destroyMutex>();
    ft.lockMutex = Slot<&lockMutex>();
    ft.unlockMutex = Slot<&unlockMutex>();
    ft.newCondition = Slot<&newCondition, FaultKind::newCondition>();
    ft.destroyCondition = Slot<&destroyCondition>();
    ft.condWait = Slot<&condWait>();
    ft.timedCondWait = Slot<&timedCondWait>();
    ft.signalCondition = Slot<&signalCondition>();
}

constexpr CMPIBrokerExtFT makeTable() {
    auto ft = emptyTable<CMPIBrokerExtFT>();
    ft.resolveFileName = Slot<&resolveFileName>();
    ft.newThread = Slot<&newThread, FaultKind::newThread>();
    ft.joinThread = Slot<&joinThread>();
    ft.exitThread = Slot<&exitThread>();
    ft.cancelThread = Slot<&cancelThread>();
    ft.threadSleep = Slot<&threadSleep>();
    ft.threadOnce = Slot<&threadOnce>();
    ft.createThreadKey = Slot<&createThreadKey, FaultKind::createThreadKey>();
    ft.destroyThreadKey = Slot<&destroyThreadKey>();
    ft.getThreadSpecific = Slot<&getThreadSpecific>();
    ft.setThreadSpecific = Slot<&setThreadSpecific>();
    fillSynchronisation(ft);
    fillLater(ft, 0);
    return ft;
}

} // namespace

const CMPIBrokerExtFT threadTable = makeTable();

} // namespace om
