#include "Quorvex/Base64Coder.h"

#include <gtest/gtest.h>

#include <random>
#include <stdexcept>
#include <string>

namespace {

std::string encode(const std::string& bytes) {
    const ACE_CString text =
        Base64Coder::Encode(reinterpret_cast<const unsigned char*>(bytes.data()), bytes.size());
    return std::string(text.c_str(), text.length());
}

std::string decode(const std::string& text) {
    std::size_t len = 99;
    const Quorvex::ByteArray bytes = Base64Coder::Decode(text.data(), text.size(), len);
    return std::string(reinterpret_cast<const char*>(bytes.get()), len);
}

TEST(Base64Coder, Rfc4648Vectors) {
    const std::pair<const char*, const char*> vectors[] = {{"", ""},
                                                           {"f", "Zg=="},
                                                           {"fo", "Zm8="},
                                                           {"foo", "Zm9v"},
                                                           {"foob", "Zm9vYg=="},
                                                           {"fooba", "Zm9vYmE="},
                                                           {"foobar", "Zm9vYmFy"}};
    for (const auto& v : vectors) {
        EXPECT_EQ(v.second, encode(v.first));
        EXPECT_EQ(v.first, decode(v.second));
    }
}

TEST(Base64Coder, WholeAlphabetAndEveryByteValue) {
    std::string all;
    for (int i = 0; i < 256; ++i) {
        all += static_cast<char>(i);
    }
    EXPECT_EQ(all, decode(encode(all)));
    EXPECT_EQ("+/+/", encode("\xfb\xff\xbf"));
    EXPECT_EQ(std::string("\0\0\0", 3), decode("AAAA"));
}

TEST(Base64Coder, RandomRoundTrips) {
    std::mt19937 gen(42);
    for (std::size_t len = 0; len < 200; ++len) {
        std::string bytes(len, '\0');
        for (auto& c : bytes) {
            c = static_cast<char>(gen());
        }
        const std::string text = encode(bytes);
        EXPECT_EQ((len + 2) / 3 * 4, text.size());
        EXPECT_EQ(bytes, decode(text));
    }
}

TEST(Base64Coder, DecodeTakesAnAceString) {
    std::size_t len = 0;
    const Quorvex::ByteArray bytes = Base64Coder::Decode(ACE_CString("Zm9vYmE="), len);
    EXPECT_EQ("fooba", std::string(reinterpret_cast<const char*>(bytes.get()), len));
}

TEST(Base64Coder, RejectsEveryKindOfInvalidText) {
    const std::string invalid[] = {
        "Z",
        "Zg",
        "Zg=",
        "Zm9vY",  // length not a multiple of 4
        "Zm9v\n",
        "Zm9v\r\nYmFy",
        " Zm9v",
        "Zm 9v",
        "Zm9v\t",  // whitespace, line breaks
        "Zm-v",
        "Zm_v",
        "Zm9.",
        "Z\xC3\xA9v",             // outside the alphabet
        std::string("Zm\0v", 4),  // embedded NUL
        "=Zm9",
        "Z=m9",
        "Zm=v",
        "Zg==Zg==",
        "Z===",
        "====",  // misplaced padding
        "Zh==",
        "Zm9=",  // bits set under the padding
    };
    for (const std::string& text : invalid) {
        std::size_t len = 0;
        try {
            Base64Coder::Decode(text.data(), text.size(), len);
            ADD_FAILURE() << "accepted \"" << text << "\"";
        } catch (const std::invalid_argument& e) {
            EXPECT_EQ(0, std::string(e.what()).rfind("Base64Coder::Decode: ", 0)) << e.what();
        }
    }
}

TEST(Base64Coder, ErrorNamesTheOffendingCharacter) {
    std::size_t len = 0;
    try {
        Base64Coder::Decode("Zm9vYm E", 8, len);
        FAIL() << "no exception";
    } catch (const std::invalid_argument& e) {
        EXPECT_STREQ("Base64Coder::Decode: invalid character 0x20 at offset 6", e.what());
    }
}

}  // namespace
