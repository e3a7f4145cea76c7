// Safe file names for the directory store: reversible, and never able to leave the directory.
#include "repository/StoreFileName.h"

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

TEST(StoreFileName, EncodedNamesStayInsideTheDirectory) {
    for (const std::string& name : kHostileNames) {
        const std::string encoded = StoreFileName::encode(name);
        EXPECT_EQ(encoded.find('/'), std::string::npos) << name;
        EXPECT_EQ(encoded.find('\\'), std::string::npos) << name;
        EXPECT_NE(encoded[0], '.') << name;
        const std::string file = StoreFileName::item("host", name);
        EXPECT_TRUE(StoreFileName::isItemFile(file)) << name;
        EXPECT_EQ(file.find('/'), std::string::npos) << name;
    }
}

TEST(StoreFileName, DecodeReversesEncode) {
    for (const std::string& name : kHostileNames) {
        std::string back;
        ASSERT_TRUE(StoreFileName::decode(StoreFileName::encode(name), back)) << name;
        EXPECT_EQ(back, name);
    }
}

TEST(StoreFileName, DecodeRefusesMalformedText) {
    std::string out;
    EXPECT_FALSE(StoreFileName::decode("%4", out));
    EXPECT_FALSE(StoreFileName::decode("abc%", out));
    EXPECT_FALSE(StoreFileName::decode("%zz", out));
    EXPECT_FALSE(StoreFileName::decode("a/b", out));
    EXPECT_FALSE(StoreFileName::decode("a~b", out));
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
    EXPECT_FALSE(StoreFileName::isItemFile("___lock___"));
    EXPECT_FALSE(StoreFileName::isItemFile("___registry___"));
    EXPECT_FALSE(StoreFileName::isItemFile(".__temp__12_3"));
    EXPECT_FALSE(StoreFileName::isItemFile(".__temp__host~name"));
}

}  // namespace
}  // namespace Configuration
