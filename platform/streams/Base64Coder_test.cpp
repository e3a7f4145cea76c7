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

// A large document decodes the same in one piece (the one-pass road) and wrapped in 76-character
// lines (the blank-skipping road), and a bad character near its end is still found.
TEST(Base64Coder, LargeTextsDecodeAlikeWrappedOrNot) {
    std::mt19937 gen(7);
    for (const std::size_t len : {std::size_t{65536}, std::size_t{65537}, std::size_t{65538}}) {
        std::string bytes(len, '\0');
        for (auto& c : bytes) {
            c = static_cast<char>(gen());
        }
        const std::string text = encode(bytes);
        std::string wrapped;
        for (std::size_t i = 0; i < text.size(); i += 76) {
            wrapped += text.substr(i, 76) + "\r\n";
        }
        EXPECT_EQ(bytes, decode(text));
        EXPECT_EQ(bytes, decode(wrapped));
        std::string broken = text;
        broken[text.size() - 5] = '*';
        EXPECT_THROW(decode(broken), std::invalid_argument);
    }
}

// Wrapped or spaced-out text, as some services and proxies send it: the blanks and line breaks go,
// wherever they stand, even inside the padding.
TEST(Base64Coder, SkipsBlanksAndLineBreaks) {
    using namespace std::string_literals;
    const std::pair<std::string, std::string> cases[] = {{"Zm9v\n", "foo"},
                                                         {"Zm9v\r\nYmFy\r\n", "foobar"},
                                                         {" Zm9v", "foo"},
                                                         {"Zm 9v", "foo"},
                                                         {"Zm9v\t", "foo"},
                                                         {"Zm9vYg\n==", "foob"},
                                                         {"Zm9vYmE\r\n=", "fooba"},
                                                         {"Zg=\n=", "f"},
                                                         {" \t\r\n", ""},
                                                         {"\n\nZ m 9 v Y m F y\n\n", "foobar"},
                                                         {"AAAA\nAAAA"s, "\0\0\0\0\0\0"s}};
    for (const auto& c : cases) {
        EXPECT_EQ(c.second, decode(c.first)) << c.first;
    }
}

// Lengths not a multiple of 4 (blanks not counted); characters outside the alphabet, other
// control characters and NUL; misplaced padding; bits set under the padding.
TEST(Base64Coder, RejectsEveryKindOfInvalidText) {
    using namespace std::string_literals;
    for (const std::string& text :
         {"Z"s,          "Zg"s,     "Zg="s,     "Zm9vY"s, "Zm9\nvY"s, "Z g"s,
          "Zm9v\v"s,     "Zm9v\f"s, "Zm\xA0v"s, "Zm-v"s,  "Zm_v"s,    "Zm9."s,
          "Z\xC3\xA9v"s, "Zm\0v"s,  "=Zm9"s,    "Z=m9"s,  "Zm=v"s,    "Zg==Zg=="s,
          "Zg==\nZg=="s, "Z==="s,   "===="s,    "Zh=="s,  "Zm9="s,    "Zh\r\n=="s}) {
        std::size_t len = 0;
        try {
            Base64Coder::Decode(text.data(), text.size(), len);
            ADD_FAILURE() << "accepted \"" << text << "\"";
        } catch (const std::invalid_argument& e) {
            EXPECT_EQ(0, std::string(e.what()).rfind("Base64Coder::Decode: ", 0)) << e.what();
        }
    }
}

// Offsets are those of the text as given, blanks counted.
TEST(Base64Coder, ErrorNamesTheOffendingCharacter) {
    const std::pair<std::string, std::string> cases[] = {
        {"Zm9vYm-E", "invalid character 0x2D at offset 6"},
        {"Zm9v\r\nYm-E", "invalid character 0x2D at offset 8"},
        {"Zm9v\r\nY=mE", "misplaced padding 0x3D at offset 7"},
        {"Zm9v\r\nZh\r\n==", "non-zero bits before the padding at offset 7"},
        {"Zm9vYmE", "length 7 is not a multiple of 4"},
        {"Zm9vYm E", "length 7 without blanks is not a multiple of 4"}};
    for (const auto& c : cases) {
        std::size_t len = 0;
        try {
            Base64Coder::Decode(c.first.data(), c.first.size(), len);
            ADD_FAILURE() << "accepted " << c.first;
        } catch (const std::invalid_argument& e) {
            EXPECT_EQ("Base64Coder::Decode: " + c.second, e.what());
        }
    }
}

}  // namespace
