// The embedded directory store: exact bytes and names, times, persistence, locking, recovery.
#include "Store/DirectoryStore.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <memory>
#include <stdexcept>
#include <thread>

#include "testing/ScratchDir.h"

namespace Configuration {
namespace {

using Quorvex::Testing::ScratchDir;

std::string bytesOf(const DirectoryStore& store, const char* host, const char* name) {
    StoredItem item;
    if (!store.retrieve(host, name, item)) {
        return "<missing>";
    }
    return *item.bytes;
}

void put(DirectoryStore& store, const char* host, const char* name, const std::string& data,
         std::int64_t time = DirectoryStore::kNow) {
    store.store(host, name, data.data(), data.size(), time);
}

// A scratch directory and the store on it; open() closes the previous store first, as a restart.
class DirectoryStoreTest : public ::testing::Test {
protected:
    DirectoryStore& open() {
        m_store.reset();
        m_store = std::make_unique<DirectoryStore>(dir.path().c_str());
        return *m_store;
    }

    ScratchDir dir;

private:
    std::unique_ptr<DirectoryStore> m_store;
};

std::vector<std::string> filesIn(const std::string& dir) {
    std::vector<std::string> names;
    for (const auto& entry : std::filesystem::directory_iterator(dir)) {
        names.push_back(entry.path().filename().string());
    }
    return names;
}

TEST_F(DirectoryStoreTest, KeepsBytesExactlyAndHostsWithoutCase) {
    DirectoryStore& store = open();
    const std::string binary("\0\x01\xff<&>\n", 7);
    put(store, "Orvel1", "BrimmetServer\\Location", binary);
    EXPECT_EQ(bytesOf(store, "ORVEL1", "BrimmetServer\\Location"), binary);
    EXPECT_EQ(bytesOf(store, "orvel1", "brimmetserver\\location"), "<missing>");
    put(store, "orvel1", "BrimmetServer\\Location", "second");
    EXPECT_EQ(store.size(), 1u);
    EXPECT_EQ(store.list("OrVeL1")[0].host, "orvel1");  // the spelling of the last store
}

TEST_F(DirectoryStoreTest, ListsOneHostOrAllHostsWithExactNames) {
    DirectoryStore& store = open();
    put(store, "a", "X\\One", "1");
    put(store, "a", "X\\Two", "2");
    put(store, "b", "X\\One", "3");
    // Hosts whose keys sort right next to "a"'s items.
    for (const char* neighbour : {"ab", "a\x01", "a-", "`"}) {
        put(store, neighbour, "X\\One", "4");
    }
    const std::vector<StoredItem> ofA = store.list("A");
    ASSERT_EQ(ofA.size(), 2u);
    EXPECT_EQ(ofA[0].name, "X\\One");
    EXPECT_EQ(ofA[1].name, "X\\Two");
    std::vector<std::string> read;
    store.read("A", [&read](const std::vector<const StoredItem*>& items) {
        for (const StoredItem* item : items) {
            read.push_back(item->name.c_str());
        }
    });
    EXPECT_EQ(read, (std::vector<std::string>{"X\\One", "X\\Two"}));
    EXPECT_EQ(store.list(DirectoryStore::kAllHosts).size(), 7u);
    EXPECT_TRUE(store.list("c").empty());
}

TEST_F(DirectoryStoreTest, GivenTimesAreKeptAndOwnTimesAlwaysAdvance) {
    DirectoryStore& store = open();
    put(store, "h", "fixed", "x", 1267679167089);
    StoredItem item;
    ASSERT_TRUE(store.retrieve("h", "fixed", item));
    EXPECT_EQ(item.lastModifiedMs, 1267679167089);
    std::int64_t previous = 0;
    for (int i = 0; i < 20; ++i) {
        const std::int64_t now = store.store("h", "n", "x", 1);
        EXPECT_GT(now, previous);
        previous = now;
    }
}

TEST_F(DirectoryStoreTest, ReopenedStoreHasEveryItemTimeAndRegistration) {
    DirectoryStore& first = open();
    put(first, "Host", "A\\B", "payload");
    const std::int64_t time = first.list("host")[0].lastModifiedMs;
    put(first, "host", "gone", "x");
    EXPECT_TRUE(first.remove("HOST", "gone"));
    first.registerService("Slave1", "Storage", "127.0.0.1:9000");
    first.registerService("slave2", "Query", "");
    EXPECT_TRUE(first.unregisterService("SLAVE2", "Query"));
    first.setSetting("Persistent", "Stack 2");

    DirectoryStore& store = open();
    EXPECT_EQ(bytesOf(store, "host", "A\\B"), "payload");
    EXPECT_EQ(store.list("host")[0].lastModifiedMs, time);
    EXPECT_EQ(store.list("host")[0].host, "Host");
    EXPECT_FALSE(store.exists("host", "gone"));
    ASSERT_EQ(store.services().size(), 1u);
    EXPECT_EQ(store.services()[0].host, "Slave1");
    EXPECT_EQ(store.services()[0].connection, "127.0.0.1:9000");
    ACE_CString value;
    ASSERT_TRUE(store.setting("Persistent", value));
    EXPECT_EQ(value, "Stack 2");
}

TEST_F(DirectoryStoreTest, SecondStoreOnTheSameDirectoryIsRefused) {
    open();
    EXPECT_THROW(DirectoryStore second(dir.path().c_str()), std::runtime_error);
}

TEST(DirectoryStore, NamesThatLookLikePathsStayInsideTheDirectory) {
    ScratchDir dir;
    const std::string inner = dir.file("store");
    DirectoryStore store(inner.c_str());
    put(store, "..", "..\\..\\x", "a");
    put(store, "../h", "../x", "b");
    put(store, "h", "/etc/x", "c");
    EXPECT_EQ(filesIn(dir.path()), std::vector<std::string>{"store"});
    EXPECT_EQ(bytesOf(store, "..", "..\\..\\x"), "a");
    EXPECT_EQ(bytesOf(store, "../h", "../x"), "b");
    EXPECT_EQ(bytesOf(store, "h", "/etc/x"), "c");
}

TEST_F(DirectoryStoreTest, RefusesEmptyNamesNulAndTheWildcardHost) {
    DirectoryStore& store = open();
    EXPECT_THROW(put(store, "", "n", "x"), std::invalid_argument);
    EXPECT_THROW(put(store, "h", "", "x"), std::invalid_argument);
    EXPECT_THROW(put(store, "*", "n", "x"), std::invalid_argument);
    EXPECT_THROW(store.store("h", ACE_CString("a\0b", 3), "x", 1), std::invalid_argument);
    EXPECT_EQ(store.size(), 0u);
}

// Guards against leftovers of a killed writer being read as items or piling up.
TEST_F(DirectoryStoreTest, TemporaryAndForeignFilesAreNeverItems) {
    put(open(), "h", "kept", "good");
    std::ofstream(dir.file(".__temp__99_1")) << "QVXITEM1\n1\nh\ntorn\n100\npartial";
    std::ofstream(dir.file("h~torn")) << "QVXITEM1\n1\nh\ntorn\n100\npartial";
    std::ofstream(dir.file("h~other")) << "QVXITEM1\n1\nh\nkept\n4\nfake";
    DirectoryStore& store = open();
    EXPECT_FALSE(std::filesystem::exists(dir.file(".__temp__99_1")));
    ASSERT_EQ(store.size(), 1u);
    EXPECT_EQ(bytesOf(store, "h", "kept"), "good");
}

// Guards against a reused temporary file keeping the tail of a longer earlier version.
TEST_F(DirectoryStoreTest, RewritesThatShrinkOrGrowKeepExactBytes) {
    const std::vector<std::string> versions = {std::string(10000, 'a'), "b", std::string(5000, 'c'),
                                               "dd", std::string(5000, 'e')};
    for (const std::string& version : versions) {
        DirectoryStore& store = open();
        for (int i = 0; i < 3; ++i) {
            put(store, "h", "doc", std::string(7000, 'x'));
            put(store, "h", "other", version);
            put(store, "h", "doc", version);
        }
        EXPECT_EQ(bytesOf(store, "h", "doc"), version);
        DirectoryStore& reopened = open();
        EXPECT_EQ(bytesOf(reopened, "h", "doc"), version);
        EXPECT_EQ(bytesOf(reopened, "h", "other"), version);
    }
}

TEST_F(DirectoryStoreTest, ConcurrentStoresAllLandOnDisk) {
    DirectoryStore& writing = open();
    std::vector<std::thread> threads;
    for (int t = 0; t < 4; ++t) {
        threads.emplace_back([&writing, t] {
            for (int i = 0; i < 25; ++i) {
                const std::string name = "doc" + std::to_string(i);
                const std::string data = std::to_string(t) + ":" + std::to_string(i);
                put(writing, ("host" + std::to_string(t)).c_str(), name.c_str(), data);
                put(writing, "shared", "same", data);
            }
        });
    }
    for (std::thread& thread : threads) {
        thread.join();
    }
    DirectoryStore& store = open();
    EXPECT_EQ(store.size(), 101u);
    EXPECT_EQ(bytesOf(store, "host3", "doc24"), "3:24");
    EXPECT_NE(bytesOf(store, "shared", "same"), "<missing>");
}

TEST_F(DirectoryStoreTest, VeryLongNamesRoundTrip) {
    const std::string longName = std::string(300, 'N') + "\\" + std::string(300, '%');
    put(open(), "h", longName.c_str(), "long");
    DirectoryStore& store = open();
    EXPECT_EQ(bytesOf(store, "h", longName.c_str()), "long");
    EXPECT_EQ(store.list("h")[0].name, longName.c_str());
}

}  // namespace
}  // namespace Configuration
