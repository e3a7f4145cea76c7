// JSON string literals: what a script's JSON parser must get back unchanged.
#include "JsonText.h"

#include <gtest/gtest.h>

namespace Configctl {
namespace {

TEST(JsonText, EscapesQuotesControlsAndLatin1) {
    const struct {
        std::string text;
        std::string json;
    } kCases[] = {
        {"", "\"\""},
        {"BrimmetServer\\OrvelSystem", "\"BrimmetServer\\\\OrvelSystem\""},
        {"say \"hi\"", "\"say \\\"hi\\\"\""},
        {"a\nb\tc\x01", "\"a\\nb\\tc\\u0001\""},
        {"M\xfcller", "\"M\\u00fcller\""},
        {"\x7f", "\"\\u007f\""},
    };
    for (const auto& c : kCases) {
        EXPECT_EQ(jsonString(c.text), c.json) << c.text;
    }
}

}  // namespace
}  // namespace Configctl
