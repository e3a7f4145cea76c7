// NodePool: blocks are aligned and never overlap, freed memory comes back, and blocks may be freed
// by any thread, also by threads that end holding frees not yet settled.
#include "NodePool.h"

#include <gtest/gtest.h>

#include <atomic>
#include <cstdint>
#include <cstring>
#include <set>
#include <thread>
#include <vector>

namespace Vesk {
namespace {

struct Block {
    unsigned char* bytes;
    std::size_t size;
};

// Blocks of every size up to a little beyond the pooled ones, each filled with its own pattern.
std::vector<Block> allocateMany(std::size_t count) {
    std::vector<Block> blocks;
    for (std::size_t i = 0; i < count; ++i) {
        const std::size_t size = i % (NodePool::kMaxBlock + 32) + 1;
        auto* bytes = static_cast<unsigned char*>(NodePool::allocate(size));
        std::memset(bytes, static_cast<int>(i & 0xFF), size);
        blocks.push_back(Block{bytes, size});
    }
    return blocks;
}

// Whether every block is 16-byte aligned and still holds its pattern (an overlap would have
// overwritten one).
bool intact(const std::vector<Block>& blocks) {
    for (std::size_t i = 0; i < blocks.size(); ++i) {
        if (reinterpret_cast<std::uintptr_t>(blocks[i].bytes) % 16 != 0) {
            return false;
        }
        for (std::size_t j = 0; j < blocks[i].size; ++j) {
            if (blocks[i].bytes[j] != static_cast<unsigned char>(i & 0xFF)) {
                return false;
            }
        }
    }
    return true;
}

void freeAll(const std::vector<Block>& blocks) {
    for (const Block& block : blocks) {
        NodePool::deallocate(block.bytes, block.size);
    }
}

TEST(VeskNodePool, FreedMemoryIsReused) {
    if (!NodePool::kRecycles) {
        GTEST_SKIP() << "the pool hands every block to operator new in this build";
    }
    const std::size_t kCount = 20000;
    const std::size_t kSize = 64;
    std::size_t reused = 0;
    std::thread([&] {
        std::set<void*> first;
        for (std::size_t i = 0; i < kCount; ++i) {
            first.insert(NodePool::allocate(kSize));
        }
        for (void* block : first) {
            NodePool::deallocate(block, kSize);
        }
        std::vector<void*> again;
        for (std::size_t i = 0; i < kCount; ++i) {
            again.push_back(NodePool::allocate(kSize));
            reused += first.count(again.back());
        }
        for (void* block : again) {
            NodePool::deallocate(block, kSize);
        }
    }).join();
    EXPECT_GT(reused, kCount * 9 / 10);
}

// Guards against lost or double-counted frees when blocks cross threads and threads end.
TEST(VeskNodePool, BlocksFreedByOtherThreadsAndEndingThreads) {
    for (int round = 0; round < 20; ++round) {
        std::vector<Block> blocks;
        std::thread maker([&] { blocks = allocateMany(3000); });
        maker.join();  // ends with its chunk still open
        std::vector<Block> mine = allocateMany(500);
        std::thread breaker([&] {
            ASSERT_TRUE(intact(blocks));
            freeAll(blocks);  // ends with frees not yet settled
        });
        breaker.join();
        EXPECT_TRUE(intact(mine));
        freeAll(mine);
    }
}

TEST(VeskNodePool, ThreadsAllocateAndFreeAtTheSameTime) {
    std::atomic<int> sound{0};
    std::vector<std::thread> threads;
    for (int t = 0; t < 4; ++t) {
        threads.emplace_back([&sound] {
            for (int round = 0; round < 10; ++round) {
                const std::vector<Block> blocks = allocateMany(2000);
                sound += intact(blocks) ? 1 : 0;
                freeAll(blocks);
            }
        });
    }
    for (std::thread& thread : threads) {
        thread.join();
    }
    EXPECT_EQ(40, sound);
}

}  // namespace
}  // namespace Vesk
