// The kept Base64 texts: the same text for the same bytes, a new one for new bytes, and never more
// than the budget held, the texts of dropped documents going first.
#include "Base64Cache.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <thread>
#include <vector>

#include "Quorvex/Base64Coder.h"

namespace ConfigurationService {
namespace {

std::shared_ptr<const std::string> bytesOf(std::size_t size, char seed) {
    auto bytes = std::make_shared<std::string>(size, seed);
    for (std::size_t i = 0; i < size; i += 7) {
        (*bytes)[i] = static_cast<char>(seed + i);
    }
    return bytes;
}

std::string coder(const std::string& bytes) {
    return Base64Coder::Encode(reinterpret_cast<const unsigned char*>(bytes.data()), bytes.size())
        .c_str();
}

TEST(Base64Cache, SameBytesShareOneTextAndNewBytesGetTheirOwn) {
    Base64Cache cache(1 << 20);
    const auto first = bytesOf(3000, 'a');
    const auto text = cache.text(first);
    EXPECT_EQ(*text, coder(*first));
    EXPECT_EQ(cache.text(first), text);
    const auto second = bytesOf(3000, 'b');
    EXPECT_EQ(*cache.text(second), coder(*second));
    EXPECT_EQ(cache.heldBytes(), 2 * text->size());
}

// Each row: documents of that size, kept alive or dropped after use; what may stay held.
TEST(Base64Cache, HoldsNoMoreThanItsBudget) {
    struct Row {
        std::size_t size;
        bool keepBytes;
    };
    const std::size_t budget = 64 * 1024;
    for (const Row& row : {Row{10000, true}, Row{10000, false}, Row{100000, true}}) {
        Base64Cache cache(budget);
        std::vector<std::shared_ptr<const std::string>> kept;
        for (int i = 0; i < 20; ++i) {
            auto bytes = bytesOf(row.size, static_cast<char>('a' + i));
            EXPECT_EQ(*cache.text(bytes), coder(*bytes)) << row.size << " " << i;
            if (row.keepBytes) {
                kept.push_back(bytes);
            }
            EXPECT_LE(cache.heldBytes(), budget) << row.size << " " << i;
        }
        if (!row.keepBytes) {
            // Only the last document's text can still be held.
            EXPECT_LE(cache.heldBytes(), (row.size + 2) / 3 * 4) << row.size;
        }
    }
}

// Readers on several threads get the same text (run under ThreadSanitizer in CI).
TEST(Base64Cache, ConcurrentReadersAgree) {
    Base64Cache cache(1 << 20);
    const auto bytes = bytesOf(50000, 'x');
    const std::string expected = coder(*bytes);
    std::vector<std::thread> threads;
    std::vector<int> wrong(4, 0);
    for (int t = 0; t < 4; ++t) {
        threads.emplace_back([&, t] {
            for (int i = 0; i < 200; ++i) {
                wrong[t] += *cache.text(bytes) == expected ? 0 : 1;
            }
        });
    }
    for (auto& thread : threads) {
        thread.join();
    }
    EXPECT_EQ(wrong, std::vector<int>(4, 0));
}

}  // namespace
}  // namespace ConfigurationService
