#include "Quorvex/TextConversion.h"

#include <gtest/gtest.h>

#include <string>

namespace {

struct TextCase {
    std::string input;
    std::string expected;
};

std::string toAnsi(const std::string& utf8) {
    ACE_CString ansi;
    Quorvex::ConvertUTF8StringToAnsi(ACE_CString(utf8.data(), utf8.size()), ansi);
    return std::string(ansi.c_str(), ansi.length());
}

std::string fromXml(const std::string& xml) {
    ACE_CString text;
    Quorvex::ConvertXmlStringToString(ACE_CString(xml.data(), xml.size()), text);
    return std::string(text.c_str(), text.length());
}

TEST(TextConversionTest, Utf8ToAnsi) {
    const TextCase cases[] = {
        {"", ""},
        {"plain ASCII", "plain ASCII"},
        {"M\xC3\xBCller", "M\xFCller"},      // ü fits the code page
        {"\xC3\xA9t\xC3\xA9", "\xE9t\xE9"},  // é
        {"\xC3\xBF", "\xFF"},                // ÿ, the last code page character
        {"5 \xE2\x82\xAC", "5 ?"},           // € does not fit
        {"\xF0\x9F\x98\x80!", "?!"},         // a 4-byte character: one '?'
        {"a\xFF"
         "b",
         "a?b"},  // a byte that starts nothing
        {"a\x80\x80"
         "b",
         "a??b"},  // stray continuation bytes
        {"\xE2\x82"
         "A",
         "?A"},                   // truncated sequence, then ASCII
        {"end\xE2\x82", "end?"},  // truncated at the very end
        {"\xC0\xAF", "??"},       // overlong '/'
        {"\xED\xA0\x80", "???"},  // encoded surrogate
    };
    for (const TextCase& c : cases) {
        EXPECT_EQ(c.expected, toAnsi(c.input)) << c.input;
    }
}

// Regression: a converter that stopped at the first bad sequence lost the rest of the text.
TEST(TextConversionTest, Utf8ToAnsiKeepsGoingAfterManyFailures) {
    std::string input;
    std::string expected;
    for (int i = 0; i < 1000; ++i) {
        input += "\xE2\x82\xAC\xC3\xA4x";
        expected += "?\xE4x";
    }
    EXPECT_EQ(expected, toAnsi(input));
}

// Regression: input is converted in slices; a character cut by a slice border must not become '?'.
TEST(TextConversionTest, Utf8ToAnsiCharactersAtEveryOffset) {
    for (std::size_t offset = 0; offset < 300; ++offset) {
        const std::string pad(offset, 'a');
        EXPECT_EQ(pad + "\xE9?\xFF?", toAnsi(pad + "\xC3\xA9\xE2\x82\xAC\xC3\xBF\xF0\x9F\x98\x80"))
            << offset;
        EXPECT_EQ(pad + "?", toAnsi(pad + "\xF0\x9F\x98")) << offset;
    }
}

TEST(TextConversionTest, Utf8ToAnsiMayWriteIntoItsInput) {
    ACE_CString text = "caf\xC3\xA9";
    Quorvex::ConvertUTF8StringToAnsi(text, text);
    EXPECT_STREQ("caf\xE9", text.c_str());
}

TEST(TextConversionTest, XmlEntities) {
    const TextCase cases[] = {
        {"", ""},
        {"no entities", "no entities"},
        {"&lt;a&gt; &amp; &quot;b&quot; &apos;c&apos;", "<a> & \"b\" 'c'"},
        {"&#65;&#x42;&#X43;", "ABC"},
        {"&#233;&#xE9;&#255;", "\xE9\xE9\xFF"},
        {"&#0065;", "A"},
        {"&#256; &#x100; &#0; &#99999999999;", "&#256; &#x100; &#0; &#99999999999;"},
        {"&nbsp; &LT; &#; &#x; &#12a;", "&nbsp; &LT; &#; &#x; &#12a;"},
        {"AT&T", "AT&T"},
        {"a & b; c", "a & b; c"},
        {"&&lt;", "&<"},
        {"&amp;lt;", "&lt;"},
        {"trailing &", "trailing &"},
    };
    for (const TextCase& c : cases) {
        EXPECT_EQ(c.expected, fromXml(c.input)) << c.input;
    }
}

}  // namespace
