#include "objectmanager/broker/Memory.h"

#include "objectmanager/broker/Args.h"
#include "objectmanager/broker/Array.h"
#include "objectmanager/broker/Broker.h"
#include "objectmanager/broker/DateTime.h"
#include "objectmanager/broker/Instance.h"
#include "objectmanager/broker/ObjectPath.h"
#include "objectmanager/broker/String.h"

#include <cstdint>
#include <cstdlib>

namespace om {

/// Stands before the memory that the provider gets, which stays aligned for any type.
struct alignas(std::max_align_t) MemoryBlocks::Block {
    Block* previous;
    Block* next;
};

namespace {

/// No object is larger; asking for more is a mistake in a calculation.
constexpr std::size_t mostBytes = PTRDIFF_MAX / 2;

} // namespace

MemoryBlocks::~MemoryBlocks() {
    while (first != nullptr) {
        Block* next = first->next;
        std::free(first);
        first = next;
    }
}

void MemoryBlocks::link(Block* block) {
    const std::lock_guard lock(mutex);
    block->previous = nullptr;
    block->next = first;
    if (first != nullptr) first->previous = block;
    first = block;
}

void MemoryBlocks::unlink(Block* block) {
    const std::lock_guard lock(mutex);
    (block->previous == nullptr ? first : block->previous->next) = block->next;
    if (block->next != nullptr) block->next->previous = block->previous;
}

void* MemoryBlocks::allocate(std::size_t size) {
    if (size > mostBytes) return nullptr;
    auto* block = static_cast<Block*>(std::malloc(sizeof(Block) + size));
    if (block == nullptr) return nullptr;
    link(block);
    return block + 1;
}

void* MemoryBlocks::allocateZeroed(std::size_t count, std::size_t size) {
    std::size_t total = 0;
    if (__builtin_mul_overflow(count, size, &total)) return nullptr;
    void* pointer = allocate(total);
    if (pointer != nullptr) std::memset(pointer, 0, total);
    return pointer;
}

void* MemoryBlocks::resize(void* pointer, std::size_t size) {
    if (pointer == nullptr) return allocate(size);
    if (size > mostBytes) return nullptr;
    Block* old = static_cast<Block*>(pointer) - 1;
    unlink(old);
    auto* block = static_cast<Block*>(std::realloc(old, sizeof(Block) + size));
    link(block == nullptr ? old : block);
    return block == nullptr ? nullptr : block + 1;
}

void MemoryBlocks::free(void* pointer) {
    if (pointer == nullptr) return;
    Block* block = static_cast<Block*>(pointer) - 1;
    unlink(block);
    std::free(block);
}

namespace {

/// A place in the list of a call's objects.
class Mark final : public Managed {
public:
    using Managed::Managed;
    explicit Mark(Broker& broker) : Managed(broker) {}

private:
    void clear() noexcept override {}
};

Call& presentCall() {
    Call* call = Call::current();
    if (call == nullptr) throw Failure{CMPI_RC_ERR_FAILED};
    return *call;
}

void* mark(const CMPIBroker* broker, CMPIStatus*) {
    presentCall();
    Managed& place = make<Mark>(open(broker));
    return &place;
}

CMPIStatus releaseToMark(const CMPIBroker* broker, const void* place) {
    open(broker);
    Arena& arena = presentCall().arena();
    const auto* object = static_cast<const Managed*>(place);
    if (object == nullptr || !arena.holds(object)) throw Failure{CMPI_RC_ERR_INVALID_HANDLE};
    arena.endBackTo(object);
    return status(CMPI_RC_OK);
}

void* allocate(const CMPIBroker* broker, std::size_t size) {
    return open(broker).memory.allocate(size);
}

void* allocateZeroed(const CMPIBroker* broker, std::size_t count, std::size_t size) {
    return open(broker).memory.allocateZeroed(count, size);
}

void* resize(const CMPIBroker* broker, void* pointer, std::size_t size) {
    return open(broker).memory.resize(pointer, size);
}

char* duplicate(const CMPIBroker* broker, const char* chars) {
    Broker& owner = open(broker);
    const std::size_t size = std::strlen(text(chars)) + 1;
    void* copy = owner.memory.allocate(size);
    return copy == nullptr ? nullptr : static_cast<char*>(std::memcpy(copy, chars, size));
}

void freeBlock(const CMPIBroker* broker, void* pointer) {
    open(broker).memory.free(pointer);
}

template <class T>
void freeObject(const CMPIBroker* broker, const typename T::Handle* handle) {
    open(broker);
    open<T>(handle).release();
}

// There are no select expressions.
void freeSelectExp(const CMPIBroker* broker, const CMPISelectExp*) {
    open(broker);
}

/// Later headers append this slot; it is filled where it is there.
template <class Table>
constexpr auto fillLater(Table& ft, int) -> decltype(ft.freeChars, void()) {
    ft.freeChars = Slot<&freeBlock>();
}
template <class Table>
constexpr void fillLater(Table&, long) {}

constexpr CMPIBrokerMemFT makeTable() {
    auto ft = emptyTable<CMPIBrokerMemFT>();
    ft.mark = Slot<&mark, FaultKind::mark>();
    ft.release = Slot<&releaseToMark>();
    ft.cmpiMalloc = Slot<&allocate, FaultKind::cmpiMalloc>();
    ft.cmpiCalloc = Slot<&allocateZeroed, FaultKind::cmpiCalloc>();
    ft.cmpiRealloc = Slot<&resize, FaultKind::cmpiRealloc>();
    ft.cmpiStrDup = Slot<&duplicate, FaultKind::cmpiStrDup>();
    ft.cmpiFree = Slot<&freeBlock>();
    ft.freeInstance = Slot<&freeObject<InstanceObject>>();
    ft.freeObjectPath = Slot<&freeObject<PathObject>>();
    ft.freeArgs = Slot<&freeObject<ArgsObject>>();
    ft.freeString = Slot<&freeObject<StringObject>>();
    ft.freeArray = Slot<&freeObject<ArrayObject>>();
    ft.freeDateTime = Slot<&freeObject<DateTimeObject>>();
    ft.freeSelectExp = Slot<&freeSelectExp>();
    fillLater(ft, 0);
    return ft;
}

} // namespace

const CMPIBrokerMemFT memoryTable = makeTable();

} // namespace om
