// The embedded directory store: exact bytes and names, times, persistence, locking, recovery.
#include "repository/DirectoryStore.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
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

std::vector<std::string> filesIn(const std::string& dir) {
    std::vector<std::string> names;
    for (const auto& entry : std::filesystem::directory_iterator(dir)) {
        names.push_back(entry.path().filename().string());
    }
    return names;
}

TEST(DirectoryStore, KeepsBytesExactlyAndHostsWithoutCase) {
    ScratchDir dir;
    DirectoryStore store(dir.path().c_str());
    const std::string binary("\0\x01\xff<&>\n", 7);
    put(store, "Orvel1", "BrimmetServer\\Location", binary);
    EXPECT_EQ(bytesOf(store, "ORVEL1", "BrimmetServer\\Location"), binary);
    EXPECT_EQ(bytesOf(store, "orvel1", "brimmetserver\\location"), "<missing>");
    put(store, "orvel1", "BrimmetServer\\Location", "second");
    EXPECT_EQ(store.size(), 1u);
    EXPECT_EQ(store.list("OrVeL1")[0].host, "orvel1");  // the spelling of the last store
}

TEST(DirectoryStore, ListsOneHostOrAllHostsWithExactNames) {
    ScratchDir dir;
    DirectoryStore store(dir.path().c_str());
    put(store, "a", "X\\One", "1");
    put(store, "a", "X\\Two", "2");
    put(store, "b", "X\\One", "3");
    const std::vector<StoredItem> ofA = store.list("A");
    ASSERT_EQ(ofA.size(), 2u);
    EXPECT_EQ(ofA[0].name, "X\\One");
    EXPECT_EQ(ofA[1].name, "X\\Two");
    EXPECT_EQ(store.list(DirectoryStore::kAllHosts).size(), 3u);
    EXPECT_TRUE(store.list("c").empty());
}

TEST(DirectoryStore, GivenTimesAreKeptAndOwnTimesAlwaysAdvance) {
    ScratchDir dir;
    DirectoryStore store(dir.path().c_str());
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

TEST(DirectoryStore, ReopenedStoreHasEveryItemTimeAndRegistration) {
    ScratchDir dir;
    std::int64_t time = 0;
    {
        DirectoryStore store(dir.path().c_str());
        put(store, "Host", "A\\B", "payload");
        time = store.list("host")[0].lastModifiedMs;
        put(store, "host", "gone", "x");
        EXPECT_TRUE(store.remove("HOST", "gone"));
        store.registerService("Slave1", "Storage", "127.0.0.1:9000");
        store.registerService("slave2", "Query", "");
        EXPECT_TRUE(store.unregisterService("SLAVE2", "Query"));
        store.setSetting("Persistent", "Stack 2");
    }
    DirectoryStore store(dir.path().c_str());
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

TEST(DirectoryStore, SecondStoreOnTheSameDirectoryIsRefused) {
    ScratchDir dir;
    DirectoryStore first(dir.path().c_str());
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

TEST(DirectoryStore, RefusesEmptyNamesNulAndTheWildcardHost) {
    ScratchDir dir;
    DirectoryStore store(dir.path().c_str());
    EXPECT_THROW(put(store, "", "n", "x"), std::invalid_argument);
    EXPECT_THROW(put(store, "h", "", "x"), std::invalid_argument);
    EXPECT_THROW(put(store, "*", "n", "x"), std::invalid_argument);
    EXPECT_THROW(store.store("h", ACE_CString("a\0b", 3), "x", 1), std::invalid_argument);
    EXPECT_EQ(store.size(), 0u);
}

// Guards against leftovers of a killed writer being read as items or piling up.
TEST(DirectoryStore, TemporaryAndForeignFilesAreNeverItems) {
    ScratchDir dir;
    {
        DirectoryStore store(dir.path().c_str());
        put(store, "h", "kept", "good");
    }
    std::ofstream(dir.file(".__temp__99_1")) << "QVXITEM1\n1\nh\ntorn\n100\npartial";
    std::ofstream(dir.file("h~torn")) << "QVXITEM1\n1\nh\ntorn\n100\npartial";
    std::ofstream(dir.file("h~other")) << "QVXITEM1\n1\nh\nkept\n4\nfake";
    DirectoryStore store(dir.path().c_str());
    EXPECT_FALSE(std::filesystem::exists(dir.file(".__temp__99_1")));
    ASSERT_EQ(store.size(), 1u);
    EXPECT_EQ(bytesOf(store, "h", "kept"), "good");
}

// Guards against a reused temporary file keeping the tail of a longer earlier version.
TEST(DirectoryStore, RewritesThatShrinkOrGrowKeepExactBytes) {
    ScratchDir dir;
    const std::vector<std::string> versions = {std::string(10000, 'a'), "b", std::string(5000, 'c'),
                                               "dd", std::string(5000, 'e')};
    for (const std::string& version : versions) {
        {
            DirectoryStore store(dir.path().c_str());
            for (int i = 0; i < 3; ++i) {
                put(store, "h", "doc", std::string(7000, 'x'));
                put(store, "h", "other", version);
                put(store, "h", "doc", version);
            }
            EXPECT_EQ(bytesOf(store, "h", "doc"), version);
        }
        DirectoryStore store(dir.path().c_str());
        EXPECT_EQ(bytesOf(store, "h", "doc"), version);
        EXPECT_EQ(bytesOf(store, "h", "other"), version);
    }
}

TEST(DirectoryStore, ConcurrentStoresAllLandOnDisk) {
    ScratchDir dir;
    {
        DirectoryStore store(dir.path().c_str());
        std::vector<std::thread> threads;
        for (int t = 0; t < 4; ++t) {
            threads.emplace_back([&store, t] {
                for (int i = 0; i < 25; ++i) {
                    const std::string name = "doc" + std::to_string(i);
                    const std::string data = std::to_string(t) + ":" + std::to_string(i);
                    put(store, ("host" + std::to_string(t)).c_str(), name.c_str(), data);
                    put(store, "shared", "same", data);
                }
            });
        }
        for (std::thread& thread : threads) {
            thread.join();
        }
    }
    DirectoryStore store(dir.path().c_str());
    EXPECT_EQ(store.size(), 101u);
    EXPECT_EQ(bytesOf(store, "host3", "doc24"), "3:24");
    EXPECT_NE(bytesOf(store, "shared", "same"), "<missing>");
}

TEST(DirectoryStore, VeryLongNamesRoundTrip) {
    ScratchDir dir;
    const std::string longName = std::string(300, 'N') + "\\" + std::string(300, '%');
    {
        DirectoryStore store(dir.path().c_str());
        put(store, "h", longName.c_str(), "long");
    }
    DirectoryStore store(dir.path().c_str());
    EXPECT_EQ(bytesOf(store, "h", longName.c_str()), "long");
    EXPECT_EQ(store.list("h")[0].name, longName.c_str());
}

}  // namespace
}  // namespace Configuration
