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

// The RFC 4648 test vectors, the last two letters of the alphabet, and zero bytes.
TEST(Base64Coder, KnownVectors) {
    const std::pair<std::string, std::string> vectors[] = {{"", ""},
                                                           {"f", "Zg=="},
                                                           {"fo", "Zm8="},
                                                           {"foo", "Zm9v"},
                                                           {"foob", "Zm9vYg=="},
                                                           {"fooba", "Zm9vYmE="},
                                                           {"foobar", "Zm9vYmFy"},
                                                           {"\xfb\xff\xbf", "+/+/"},
                                                           {std::string("\0\0\0", 3), "AAAA"}};
    for (const auto& v : vectors) {
        EXPECT_EQ(v.second, encode(v.first));
        EXPECT_EQ(v.first, decode(v.second));
    }
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

// Lengths not a multiple of 4; whitespace and line breaks; characters outside the alphabet and
// NUL; misplaced padding; bits set under the padding.
TEST(Base64Coder, RejectsEveryKindOfInvalidText) {
    using namespace std::string_literals;
    for (const std::string& text :
         {"Z"s,          "Zg"s,    "Zg="s,    "Zm9vY"s, "Zm9v\n"s, "Zm9v\r\nYmFy"s,
          " Zm9v"s,      "Zm 9v"s, "Zm9v\t"s, "Zm-v"s,  "Zm_v"s,   "Zm9."s,
          "Z\xC3\xA9v"s, "Zm\0v"s, "=Zm9"s,   "Z=m9"s,  "Zm=v"s,   "Zg==Zg=="s,
          "Z==="s,       "===="s,  "Zh=="s,   "Zm9="s}) {
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
