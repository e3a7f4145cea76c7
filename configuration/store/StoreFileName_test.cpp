// Safe file names for the directory store: reversible, and never able to leave the directory.
#include "StoreFileName.h"

#include <gtest/gtest.h>

#include <set>

namespace Configuration {
namespace {

const std::vector<std::string> kHostileNames = {"..\\..\\x",
                                                "../x",
                                                "..",
                                                ".",
                                                "/etc/passwd",
                                                "a/b/c",
                                                "BrimmetServer\\Location",
                                                "~tilde~",
                                                "%2E%2E",
                                                "semi;colon",
                                                std::string("\x80\xff\x01\x1f", 4),
                                                ".hidden",
                                                "___lock___",
                                                ".__temp__1"};

// Each name's file stays inside the directory, is an item file, and decodes back to the name.
TEST(StoreFileName, EncodedNamesStayInsideTheDirectoryAndDecodeBack) {
    for (const std::string& name : kHostileNames) {
        const std::string encoded = StoreFileName::encode(name);
        EXPECT_EQ(encoded.find('/'), std::string::npos) << name;
        EXPECT_EQ(encoded.find('\\'), std::string::npos) << name;
        EXPECT_NE(encoded[0], '.') << name;
        const std::string file = StoreFileName::item("host", name);
        EXPECT_TRUE(StoreFileName::isItemFile(file)) << name;
        EXPECT_EQ(file.find('/'), std::string::npos) << name;
        std::string back;
        ASSERT_TRUE(StoreFileName::decode(encoded, back)) << name;
        EXPECT_EQ(back, name);
    }
}

TEST(StoreFileName, DecodeRefusesMalformedText) {
    std::string out;
    for (const char* text : {"%4", "abc%", "%zz", "a/b", "a~b"}) {
        EXPECT_FALSE(StoreFileName::decode(text, out)) << text;
    }
}

// Guards against long names overflowing NAME_MAX or two long names sharing one file.
TEST(StoreFileName, LongNamesGetShortDistinctFileNames) {
    std::set<std::string> files;
    for (int i = 0; i < 50; ++i) {
        const std::string name = std::string(400, '\\') + std::to_string(i);
        const std::string file = StoreFileName::item("host", name);
        EXPECT_LE(file.size(), StoreFileName::kMaxLength);
        EXPECT_TRUE(StoreFileName::isItemFile(file));
        files.insert(file);
    }
    EXPECT_EQ(files.size(), 50u);
}

TEST(StoreFileName, ReservedAndTemporaryNamesAreNotItems) {
    for (const char* file :
         {"___lock___", "___registry___", ".__temp__12_3", ".__temp__host~name"}) {
        EXPECT_FALSE(StoreFileName::isItemFile(file)) << file;
    }
}

}  // namespace
}  // namespace Configuration
