// JSON text: what a script's JSON parser must get back unchanged.
#include "JsonText.h"

#include <gtest/gtest.h>

#include <functional>
#include <sstream>

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

// Commas between members and elements at every depth, the line break after the outermost value.
TEST(JsonText, WriterSeparatesMembersAtEveryDepth) {
    const struct {
        std::function<void(JsonWriter&)> write;
        std::string json;
    } kCases[] = {
        {[](JsonWriter& j) { j.beginArray().endArray(); }, "[]\n"},
        {[](JsonWriter& j) { j.value("a\\b"); }, "\"a\\\\b\"\n"},
        {[](JsonWriter& j) { j.beginArray().value(1).value(true).null().optional("").endArray(); },
         "[1,true,null,null]\n"},
        {[](JsonWriter& j) {
             j.beginObject().field("n", -2).key("l").beginArray().beginObject().endObject();
             j.beginArray().value("x").endArray().endArray().field("b", false).endObject();
         },
         "{\"n\":-2,\"l\":[{},[\"x\"]],\"b\":false}\n"},
        {[](JsonWriter& j) { j.beginObject().field("s", ACE_CString("M\xfcller")).endObject(); },
         "{\"s\":\"M\\u00fcller\"}\n"},
    };
    for (const auto& c : kCases) {
        std::ostringstream out;
        JsonWriter writer(out);
        c.write(writer);
        EXPECT_EQ(out.str(), c.json);
    }
}

}  // namespace
}  // namespace Configctl
