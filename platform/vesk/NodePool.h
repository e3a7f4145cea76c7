// NodePool: the memory of element-tree nodes (elements, and values allocated on their own).
//
// Each thread cuts its blocks one after the other from a 16 KiB chunk, so a tree built at once lies
// in consecutive memory and costs a pointer bump per node. A chunk counts the blocks still in use
// and goes back to a shared list of empty chunks when the last one is freed (by any thread); chunks
// are kept for reuse, never given back to the system. The price of that simplicity: a block that
// outlives the rest of its chunk keeps the whole chunk in use until it is freed.
//
// Blocks larger than kMaxBlock go to operator new. Thread-safe: any thread may free any block.
// Built with AddressSanitizer, every call goes straight to operator new/delete so that the
// sanitizer sees each node as an allocation of its own (leaks, use after free).
#pragma once

#include <cstddef>

#if defined(__SANITIZE_ADDRESS__)
#define VESK_NODE_POOL_PASS_THROUGH 1
#elif defined(__has_feature)
#if __has_feature(address_sanitizer)
#define VESK_NODE_POOL_PASS_THROUGH 1
#endif
#endif

namespace Vesk {

class NodePool {
public:
    static constexpr std::size_t kMaxBlock = 256;
#ifdef VESK_NODE_POOL_PASS_THROUGH
    static constexpr bool kRecycles = false;
#else
    static constexpr bool kRecycles = true;  // freed memory is reused by later blocks
#endif

    // A block of at least size bytes, aligned to 16 bytes; bad_alloc when memory is exhausted.
    static void* allocate(std::size_t size);
    // Gives back a block that allocate() returned for the same size.
    static void deallocate(void* block, std::size_t size) noexcept;
};

}  // namespace Vesk
