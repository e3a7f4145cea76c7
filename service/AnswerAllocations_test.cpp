// Large answers are built in one buffer of their final size: allocations made on the answering
// thread are counted while "Retrieve" and "ListItems" run against a real store, and the Base64
// written into answers is checked against the library's coder at every chunk boundary.
#include <gtest/gtest.h>
#include <stdlib.h>

#include <atomic>
#include <cstdlib>
#include <new>
#include <string>

#include "Answer.h"
#include "ChangeNotifier.h"
#include "ItemOperations.h"
#include "MasterLink.h"
#include "Quorvex/Base64Coder.h"
#include "Store/DirectoryStore.h"
#include "testing/ScratchDir.h"

// The replaced allocation functions below take from malloc and give back to free by design; g++
// sees free() reached from delete expressions once it inlines them.
#pragma GCC diagnostic ignored "-Wmismatched-new-delete"

namespace {

// Allocations on the counting thread while counting is on: how many, how many of at least
// kLargeBytes.
thread_local bool t_counting = false;
thread_local std::size_t t_allocations = 0;
thread_local std::size_t t_large = 0;
constexpr std::size_t kLargeBytes = 256 * 1024;

void* countedAllocation(std::size_t size) {
    if (t_counting) {
        ++t_allocations;
        t_large += size >= kLargeBytes ? 1 : 0;
    }
    if (void* p = std::malloc(size == 0 ? 1 : size)) {
        return p;
    }
    throw std::bad_alloc();
}

}  // namespace

void* operator new(std::size_t size) {
    return countedAllocation(size);
}

void* operator new[](std::size_t size) {
    return countedAllocation(size);
}

// Every form that frees with operator delete is replaced together, so that a sanitizer's own
// operator new never meets this free().
void* operator new(std::size_t size, const std::nothrow_t&) noexcept {
    try {
        return countedAllocation(size);
    } catch (const std::bad_alloc&) {
        return nullptr;
    }
}

void* operator new[](std::size_t size, const std::nothrow_t&) noexcept {
    return operator new(size, std::nothrow);
}

void operator delete(void* p, const std::nothrow_t&) noexcept {
    std::free(p);
}

void operator delete[](void* p, const std::nothrow_t&) noexcept {
    std::free(p);
}

void operator delete(void* p) noexcept {
    std::free(p);
}

void operator delete[](void* p) noexcept {
    std::free(p);
}

void operator delete(void* p, std::size_t) noexcept {
    std::free(p);
}

void operator delete[](void* p, std::size_t) noexcept {
    std::free(p);
}

namespace ConfigurationService {
namespace {

struct Counted {
    std::size_t allocations = 0;
    std::size_t large = 0;
};

// Runs f with the counting on.
template <typename F>
Counted counting(F f) {
    t_allocations = 0;
    t_large = 0;
    t_counting = true;
    f();
    t_counting = false;
    return Counted{t_allocations, t_large};
}

class AnswerAllocations : public ::testing::Test {
protected:
    AnswerAllocations()
        : m_eventsHere(::setenv("QUORVEX_EVENT_DIR", m_scratch.path().c_str(), 1) == 0),
          m_store(m_scratch.file("store").c_str()),
          m_master("TestHost", "", ""),
          m_context{m_store, m_master, m_changes, "TestHost"},
          m_operations(m_context) {
        m_operations.registerInto(m_table);
    }

    Reply run(std::string body, Counted* counted = nullptr) {
        const Request request = Request::parse(body);
        const Operations::Entry* entry = m_table.find(request.operation());
        Reply reply;
        const Counted c = counting([&] { reply = entry->handler(request); });
        if (counted != nullptr) {
            *counted = c;
        }
        return reply;
    }

    Quorvex::Testing::ScratchDir m_scratch;
    bool m_eventsHere;  // the change event lives in the scratch directory
    Configuration::DirectoryStore m_store;
    MasterLink m_master;
    ChangeNotifier m_changes;
    ServiceContext m_context;
    ItemOperations m_operations;
    Operations m_table;
};

std::string bytesOf(std::size_t size) {
    std::string bytes(size, '\0');
    for (std::size_t i = 0; i < size; ++i) {
        bytes[i] = static_cast<char>((i * 131 + i / 251) & 0xff);
    }
    return bytes;
}

std::string retrieveBody(const std::string& name) {
    return "<Retrieve><Host>h</Host><ConfigurationName>" + name + "</ConfigurationName></Retrieve>";
}

std::string answeredBase64(const std::string& body) {
    const std::string open = "<Configuration>";
    const std::size_t at = body.find(open) + open.size();
    return body.substr(at, body.find("</Configuration>") - at);
}

std::string coderBase64(const std::string& bytes) {
    return Base64Coder::Encode(reinterpret_cast<const unsigned char*>(bytes.data()), bytes.size())
        .c_str();
}

// Sizes around the encoder's chunk (3 KiB of bytes), its padding cases and the size from which
// texts are kept; a document stored again is answered with its new text, never a kept one.
TEST_F(AnswerAllocations, RetrieveAnswersTheSameBase64AsTheCoderAtEverySize) {
    for (std::size_t size :
         {0u, 1u, 2u, 3u, 4u, 1023u, 1024u, 3071u, 3072u, 3073u, 6146u, 100000u}) {
        const std::string name = "Doc" + std::to_string(size);
        for (int version = 0; version < 2; ++version) {
            std::string bytes = bytesOf(size);
            if (version == 1 && size > 0) {
                bytes[size / 2] = static_cast<char>(bytes[size / 2] ^ 0x55);
            }
            m_store.store("h", name.c_str(), bytes.data(), bytes.size());
            for (int read = 0; read < 2; ++read) {
                EXPECT_EQ(answeredBase64(run(retrieveBody(name)).text()), coderBase64(bytes))
                    << size << " version " << version << " read " << read;
            }
        }
    }
}

// A large document's Base64 text is made once and then shared by every answer: no answer-sized
// block per retrieve, no temporary, and the answer's own part sized exactly.
TEST_F(AnswerAllocations, RetrieveOfOneMebibyteEncodesOnceAndThenAllocatesNoAnswerSizedBlock) {
    const std::string bytes = bytesOf(1 << 20);
    m_store.store("h", "Big", bytes.data(), bytes.size());
    Counted first;
    Counted second;
    const Reply one = run(retrieveBody("Big"), &first);
    const Reply two = run(retrieveBody("Big"), &second);
    ASSERT_EQ(two.status, 200);
    EXPECT_EQ(first.large, 1u);
    EXPECT_EQ(second.large, 0u);
    EXPECT_EQ(one.shared, two.shared);
    EXPECT_EQ(two.text(), one.text());
    EXPECT_EQ(two.text().compare(two.size() - 35, 35, "</Configuration></RetrieveResponse>"), 0)
        << two.text().substr(two.size() - 35);
}

// Thousands of items: a fixed number of allocations, not a few per item, and the answer sized
// exactly (names with characters that are escaped included).
TEST_F(AnswerAllocations, ListItemsAllocatesNothingPerItem) {
    const int kItems = 1000;
    for (int i = 0; i < kItems; ++i) {
        const std::string name = "BrimmetServer\\Item<" + std::to_string(i) + ">&";
        m_store.store("h", name.c_str(), "x", 1);
    }
    m_store.store("other", "Elsewhere", "x", 1);
    Counted counted;
    const Reply reply = run("<ListItems><Host>h</Host></ListItems>", &counted);
    ASSERT_EQ(reply.status, 200);
    EXPECT_LT(counted.allocations, 20u);
    EXPECT_EQ(reply.body.capacity(), reply.body.size());
    std::size_t items = 0;
    for (std::size_t at = 0; (at = reply.body.find("<ConfigurationItem>", at)) != std::string::npos;
         ++at) {
        ++items;
    }
    EXPECT_EQ(items, static_cast<std::size_t>(kItems));
    EXPECT_NE(reply.body.find("Item&lt;7&gt;&amp;"), std::string::npos);
}

}  // namespace
}  // namespace ConfigurationService
