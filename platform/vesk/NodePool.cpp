// Chunks are aligned to their size, so a block finds its chunk by masking its address. A chunk's
// live count holds the blocks not yet freed plus kOpen while a thread still cuts from it; the owner
// counts the blocks it cuts locally and settles them when it moves to another chunk. Frees of one
// thread into the same chunk are added up locally and settled with one atomic subtraction when the
// thread frees into another chunk (or ends), which keeps tearing down a tree cheap.
#include "NodePool.h"

#include <pthread.h>

#include <atomic>
#include <cstdint>
#include <mutex>
#include <new>
#include <vector>

namespace Vesk {

namespace {

// Hands a block back to operator delete, with its size where the compiler offers that (then the
// sanitizers check it).
void deleteBlock(void* block, std::size_t size) noexcept {
#if defined(__cpp_sized_deallocation)
    ::operator delete(block, size);
#else
    static_cast<void>(size);
    ::operator delete(block);
#endif
}

}  // namespace

#ifndef VESK_NODE_POOL_PASS_THROUGH
namespace {

constexpr std::size_t kChunkBytes = 16 * 1024;
constexpr std::size_t kHeaderBytes = 64;  // the chunk header gets a cache line of its own
constexpr std::size_t kSlabChunks = 16;   // chunks taken from operator new at once
constexpr std::size_t kAlign = 16;
constexpr std::uint32_t kOpen = 1u << 30;

static_assert(NodePool::kMaxBlock <= kChunkBytes - kHeaderBytes, "a block must fit a chunk");

struct Chunk {
    std::atomic<std::uint32_t> live;  // blocks not yet freed, plus kOpen while being cut from
    Chunk* next;                      // the next chunk of the empty list
};

Chunk* chunkOf(void* block) {
    return reinterpret_cast<Chunk*>(reinterpret_cast<std::uintptr_t>(block) & ~(kChunkBytes - 1));
}

// Where blocks are cut from: the rest of one chunk.
struct Cutter {
    Chunk* chunk;
    char* cursor;
    char* end;
    std::uint32_t cut;  // blocks cut from chunk so far
};

void* cutBlock(Cutter& cutter, std::size_t size) {
    if (size > static_cast<std::size_t>(cutter.end - cutter.cursor)) {
        return nullptr;
    }
    void* block = cutter.cursor;
    cutter.cursor += size;
    ++cutter.cut;
    return block;
}

void openChunk(Cutter& cutter, Chunk* chunk) {
    chunk->live.store(kOpen, std::memory_order_relaxed);
    char* base = reinterpret_cast<char*>(chunk);
    cutter = Cutter{chunk, base + kHeaderBytes, base + kChunkBytes, 0};
}

void release(Chunk* chunk, std::uint32_t count) noexcept;

// Stops cutting from the cutter's chunk (if any).
void closeChunk(Cutter& cutter) noexcept {
    if (cutter.chunk != nullptr) {
        release(cutter.chunk, kOpen - cutter.cut);
    }
    cutter = Cutter{};
}

// The empty chunks, shared by all threads, and the cutter of threads that have ended.
class Depot {
public:
    Chunk* takeEmpty() {
        std::lock_guard<std::mutex> lock(m_mutex);
        return takeEmptyLocked();
    }

    void giveEmpty(Chunk* chunk) noexcept {
        std::lock_guard<std::mutex> lock(m_mutex);
        chunk->next = m_empty;
        m_empty = chunk;
    }

    // A block for a thread whose own cutter is gone (it runs its thread-exit destructors).
    void* allocateShared(std::size_t size) {
        Cutter full{};
        void* block = nullptr;
        {
            std::lock_guard<std::mutex> lock(m_mutex);
            block = cutBlock(m_shared, size);
            if (block == nullptr) {
                Chunk* chunk = takeEmptyLocked();
                full = m_shared;
                openChunk(m_shared, chunk);
                block = cutBlock(m_shared, size);
            }
        }
        closeChunk(full);  // outside the lock: the chunk may come back to this depot
        return block;
    }

    void lock() { m_mutex.lock(); }
    void unlock() { m_mutex.unlock(); }

private:
    Chunk* takeEmptyLocked() {
        if (m_empty == nullptr) {
            addSlab();
        }
        Chunk* chunk = m_empty;
        m_empty = chunk->next;
        return chunk;
    }

    void addSlab() {
        m_slabs.push_back(nullptr);  // room first: a failure below then loses nothing
        const std::size_t bytes = kSlabChunks * kChunkBytes;
        char* slab = static_cast<char*>(::operator new(bytes, std::align_val_t(kChunkBytes)));
        m_slabs.back() = slab;
        for (std::size_t i = kSlabChunks; i-- > 0;) {
            Chunk* chunk = ::new (slab + i * kChunkBytes) Chunk{{0}, m_empty};
            m_empty = chunk;
        }
    }

    std::mutex m_mutex;
    Chunk* m_empty = nullptr;
    Cutter m_shared{};
    std::vector<char*> m_slabs;  // every slab taken: chunks are never given back
};

Depot* makeDepot();

// Created on first use and never destroyed: blocks may be freed during static destruction.
Depot& depot() {
    static Depot* const instance = makeDepot();
    return *instance;
}

// Held across fork() so that the child never inherits it locked by a thread it does not have.
Depot* makeDepot() {
    Depot* created = new Depot;
    ::pthread_atfork([] { depot().lock(); }, [] { depot().unlock(); }, [] { depot().unlock(); });
    return created;
}

void release(Chunk* chunk, std::uint32_t count) noexcept {
    if (chunk->live.fetch_sub(count, std::memory_order_acq_rel) == count) {
        depot().giveEmpty(chunk);
    }
}

enum class ThreadState : unsigned char { Unarmed, Active, Ended };

// Trivially constructed and destroyed, so that reaching it needs no initialisation check.
struct ThreadPool {
    Cutter cutter;
    Chunk* freedChunk;    // the chunk of the frees not yet settled
    std::uint32_t freed;  // how many
    ThreadState state;
};

thread_local ThreadPool t_pool;

void settleFrees() noexcept {
    if (t_pool.freedChunk != nullptr) {
        release(t_pool.freedChunk, t_pool.freed);
        t_pool.freedChunk = nullptr;
        t_pool.freed = 0;
    }
}

// Settles the thread's chunk and frees when the thread ends; later calls of the thread go through
// the depot.
struct ExitFlush {
    bool armed = false;
    ~ExitFlush() {
        t_pool.state = ThreadState::Ended;
        settleFrees();
        closeChunk(t_pool.cutter);
    }
};

thread_local ExitFlush t_exitFlush;

void arm() noexcept {
    t_pool.state = ThreadState::Active;
    t_exitFlush.armed = true;  // constructs it, which registers its destructor
}

void* allocateSlow(std::size_t size) {
    if (t_pool.state == ThreadState::Unarmed) {
        arm();
    }
    if (t_pool.state == ThreadState::Ended) {
        return depot().allocateShared(size);
    }
    closeChunk(t_pool.cutter);
    openChunk(t_pool.cutter, depot().takeEmpty());
    return cutBlock(t_pool.cutter, size);
}

void deallocateSlow(Chunk* chunk) noexcept {
    if (t_pool.state == ThreadState::Unarmed) {
        arm();
    }
    if (t_pool.state == ThreadState::Ended) {
        release(chunk, 1);
        return;
    }
    settleFrees();
    t_pool.freedChunk = chunk;
    t_pool.freed = 1;
}

}  // namespace
#endif

void* NodePool::allocate(std::size_t size) {
#ifdef VESK_NODE_POOL_PASS_THROUGH
    return ::operator new(size);
#else
    if (size > kMaxBlock) {
        return ::operator new(size);
    }
    size = size == 0 ? kAlign : (size + kAlign - 1) & ~(kAlign - 1);
    void* block = cutBlock(t_pool.cutter, size);
    return block != nullptr ? block : allocateSlow(size);
#endif
}

void NodePool::deallocate(void* block, std::size_t size) noexcept {
#ifdef VESK_NODE_POOL_PASS_THROUGH
    deleteBlock(block, size);
#else
    if (block == nullptr) {
        return;
    }
    if (size > kMaxBlock) {
        deleteBlock(block, size);
        return;
    }
    Chunk* chunk = chunkOf(block);
    if (chunk == t_pool.freedChunk) {
        ++t_pool.freed;
        return;
    }
    deallocateSlow(chunk);
#endif
}

}  // namespace Vesk
