// ConfigDoc bookkeeping and the stored form of documents.
#include "DocumentCodec.h"

#include <gtest/gtest.h>
#include <zlib.h>
#include <pugixml.hpp>

#include <cstring>
#include <map>

#include "Configuration/DocumentNames.h"
#include "Configuration/StoredForm.h"
#include "Quorvex/Machine.h"
#include "model/TestDocument.h"
#include "testing/FakeMachine.h"

namespace Configuration {
namespace {

using TestDoc = Testing::TestDocument;

// An in-memory store keyed by path: (bytes, timestamp); a store answers storeResult.
struct MemoryStore {
    std::map<std::string, std::pair<std::string, BDateTime>> items;
    int storeResult = 0;

    DocumentCodec::StoreFunction store() {
        return [this](const ACE_CString&, const ACE_CString& path, const unsigned char* b,
                      std::size_t n, const BDateTime& ts) {
            if (storeResult == 0) {
                items[path.c_str()] = {std::string(reinterpret_cast<const char*>(b), n), ts};
            }
            return storeResult;
        };
    }
    DocumentCodec::RetrieveFunction retrieve() {
        return [this](const ACE_CString&, const ACE_CString& path, Quorvex::ByteArray& b,
                      std::size_t& n, BDateTime& ts) {
            const auto it = items.find(path.c_str());
            if (it == items.end()) {
                return -1;
            }
            n = it->second.first.size();
            b.reset(new unsigned char[n]);
            std::memcpy(b.get(), it->second.first.data(), n);
            ts = it->second.second;
            return 0;
        };
    }
    // The bytes of the only stored item.
    std::string& bytes() { return items.begin()->second.first; }
};

class DocumentCodecTest : public ::testing::Test {
protected:
    Quorvex::Testing::FakeMachine machine;
    Quorvex::ScopedMachine scoped{machine};
    MemoryStore store;
};

TEST(ConfigDocBasics, FreshDocumentStrictNewerAndTheRegistryPrefix) {
    TestDoc a, b;
    EXPECT_EQ(a.version(), 0);
    b.timestamp(BDateTime("2010-03-04T05:06:07.089"));
    a.timestamp(BDateTime("2010-03-04T05:06:07.089"));
    EXPECT_FALSE(a.isNewer(b));
    a.timestamp(BDateTime("2010-03-04T05:06:07.090"));
    EXPECT_TRUE(a.isNewer(b));
    EXPECT_FALSE(b.isNewer(a));
    EXPECT_EQ(&ConfigDoc::getConfigurationRegistryPath(),
              &ConfigDoc::getConfigurationRegistryPath());  // one object
    EXPECT_EQ(a.path(), "BrimmetServer\\TestDoc");
    EXPECT_EQ(ACE_CString(DocumentNames::kHeartbeat), "Heartbeat");
}

TEST_F(DocumentCodecTest, WriteThenReadGivesEqualDocumentWithTheWriteTimestamp) {
    TestDoc written;
    written.name = "x<&>\"'\xE9";
    written.param.setTag("0010,0010");
    ASSERT_TRUE(DocumentCodec::writeItem("TestDoc", written, store.store()));
    EXPECT_EQ(written.timestamp(), BDateTime::Now());
    machine.advanceMilliseconds(60000);
    TestDoc read;
    EXPECT_EQ(DocumentCodec::readItem("TestDoc", read, store.retrieve()), 0);
    EXPECT_TRUE(read == written);
    EXPECT_EQ(read.timestamp(), written.timestamp());
}

TEST_F(DocumentCodecTest, StoredBytesInflateWithPlainZlibToXmlAStandardParserAccepts) {
    TestDoc doc;
    DocumentCodec::writeItem("TestDoc", doc, store.store());
    const std::string& bytes = store.bytes();
    std::vector<unsigned char> text(1 << 16);
    uLongf len = text.size();
    ASSERT_EQ(
        uncompress(text.data(), &len, reinterpret_cast<const Bytef*>(bytes.data()), bytes.size()),
        Z_OK);
    pugi::xml_document parsed;
    EXPECT_TRUE(parsed.load_buffer(text.data(), len));
}

TEST_F(DocumentCodecTest, FailedStoreReturnsNullButKeepsTheNewTimestamp) {
    store.storeResult = -1;
    TestDoc doc;
    EXPECT_FALSE(DocumentCodec::writeItem("TestDoc", doc, store.store()));
    EXPECT_EQ(doc.timestamp(), BDateTime::Now());
}

TEST_F(DocumentCodecTest, MissingKeyThrowsErrorParsingNamingThePath) {
    TestDoc written;
    DocumentCodec::writeItem("TestDoc", written, store.store());
    Vesk::Element partial("TestDoc", -1);  // lacks "Name"
    partial.addMultiElement().addElement("Size", {}, -1).addSingle().assign("77");
    store.bytes() = StoredForm::encode(partial);
    TestDoc read;
    try {
        DocumentCodec::readItem("TestDoc", read, store.retrieve());
        FAIL() << "no exception";
    } catch (const std::exception& e) {
        EXPECT_STREQ(e.what(),
                     "ConfigurationRepository::ReadItem: Error parsing configuration: "
                     "BrimmetServer\\TestDoc\n");
    }
    EXPECT_EQ(read.size, 77u);  // the keys that were there were read
}

TEST_F(DocumentCodecTest, MissingItemIsMinusOneAndCorruptBytesThrow) {
    TestDoc doc;
    EXPECT_EQ(DocumentCodec::readItem("TestDoc", doc, store.retrieve()), -1);
    DocumentCodec::writeItem("TestDoc", doc, store.store());
    store.bytes().resize(store.bytes().size() / 2);
    EXPECT_THROW(DocumentCodec::readItem("TestDoc", doc, store.retrieve()), std::exception);
}

}  // namespace
}  // namespace Configuration
