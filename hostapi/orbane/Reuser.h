#pragma once

#include <cstddef>

namespace Orbane {

// The host's pooled allocator. Blocks are grouped in size classes of 16
// bytes up to 1 KiB; a freed block goes on its class's free list and is handed
// out again before new memory is taken. Larger blocks go straight to the heap.
// Used from the UI thread only, like everything that allocates controls.
class Reuser
{
public:
    static void *operator new(std::size_t size) noexcept;
    static void operator delete(void *block, std::size_t size) noexcept;

    // How many freed blocks of this size class wait for reuse.
    static std::size_t FreeBlocks(std::size_t size) noexcept;
    // The size class a request of `size` bytes is served from (0: none, heap).
    static std::size_t ClassSize(std::size_t size) noexcept;
    // Returns every waiting block to the heap.
    static void Trim() noexcept;
};

} // namespace Orbane
