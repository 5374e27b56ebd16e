#include "orbane/Reuser.h"

#include <sanitizer/asan_interface.h>

#include <cstdlib>

namespace Orbane {

namespace {

constexpr std::size_t kGrain = 16;
constexpr std::size_t kLargest = 1024;
constexpr std::size_t kClasses = kLargest / kGrain;

// A waiting block keeps the link to the next one in its first bytes.
struct FreeBlock
{
    FreeBlock *next;
};

struct Pool
{
    FreeBlock *head = nullptr;
    std::size_t count = 0;
};

// Plain static storage: the pools must outlive every object of every library,
// and blocks still waiting at exit stay reachable from here.
Pool gPools[kClasses];

std::size_t PoolIndex(std::size_t classSize)
{
    return classSize / kGrain - 1;
}

void *Pop(Pool &pool, std::size_t classSize)
{
    FreeBlock *block = pool.head;
    ASAN_UNPOISON_MEMORY_REGION(block + 1, classSize - sizeof(FreeBlock));
    pool.head = block->next;
    --pool.count;
    return block;
}

void Push(Pool &pool, void *memory, std::size_t classSize)
{
    FreeBlock *block = static_cast<FreeBlock *>(memory);
    block->next = pool.head;
    pool.head = block;
    ++pool.count;
    // A waiting block is off limits, so a use after delete still trips ASan.
    // The link stays readable: leak checks skip poisoned memory and would
    // lose the rest of the list.
    ASAN_POISON_MEMORY_REGION(block + 1, classSize - sizeof(FreeBlock));
}

} // namespace

std::size_t Reuser::ClassSize(std::size_t size) noexcept
{
    if (size > kLargest)
        return 0;
    return size == 0 ? kGrain : (size + kGrain - 1) / kGrain * kGrain;
}

void *Reuser::operator new(std::size_t size) noexcept
{
    const std::size_t classSize = ClassSize(size);
    if (classSize == 0)
        return std::malloc(size);
    Pool &pool = gPools[PoolIndex(classSize)];
    return pool.head ? Pop(pool, classSize) : std::malloc(classSize);
}

void Reuser::operator delete(void *block, std::size_t size) noexcept
{
    if (!block)
        return;
    const std::size_t classSize = ClassSize(size);
    if (classSize == 0)
        std::free(block);
    else
        Push(gPools[PoolIndex(classSize)], block, classSize);
}

std::size_t Reuser::FreeBlocks(std::size_t size) noexcept
{
    const std::size_t classSize = ClassSize(size);
    return classSize ? gPools[PoolIndex(classSize)].count : 0;
}

void Reuser::Trim() noexcept
{
    for (std::size_t i = 0; i < kClasses; ++i) {
        Pool &pool = gPools[i];
        const std::size_t classSize = (i + 1) * kGrain;
        while (pool.head)
            std::free(Pop(pool, classSize));
    }
}

} // namespace Orbane
