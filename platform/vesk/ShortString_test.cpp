// ShortString: short strings live inside the object, long ones on the heap, and every way of
// changing or moving one keeps the bytes right.
#include <gtest/gtest.h>

#include <string>
#include <utility>

#include "Vesk/ShortString.h"

namespace Vesk {
namespace {

bool heldInside(const ShortString& s) {
    const char* bytes = s.str().c_str();
    const char* object = reinterpret_cast<const char*>(&s);
    return bytes >= object && bytes < object + sizeof s;
}

std::string text(const ShortString& s) {
    return std::string(s.str().c_str(), s.str().length());
}

TEST(VeskShortString, ShortStringsStayInsideLongOnesGoToTheHeap) {
    const std::string shortest(ShortString::kInline - 1, 's');
    const std::string longest(ShortString::kInline, 'l');
    ShortString s((shortest + "beyond len").c_str(), shortest.size());
    EXPECT_TRUE(heldInside(s));
    EXPECT_EQ(shortest, text(s));
    EXPECT_EQ('\0', s.str().c_str()[shortest.size()]);
    s.assign(longest.c_str());
    EXPECT_FALSE(heldInside(s));
    EXPECT_EQ(longest, text(s));
    s.assign("back");
    EXPECT_TRUE(heldInside(s));
    EXPECT_EQ("back", text(s));
    s.clear();
    EXPECT_TRUE(s.str().empty());
}

// Guards against reading the old bytes after they were overwritten or freed.
TEST(VeskShortString, AssigningFromItselfOrAPartOfItselfKeepsTheBytes) {
    const std::string tail(40, 't');
    ShortString s(("head-" + tail).c_str());
    s.assign(s.str().c_str() + 5, 40);  // long part of a heap string
    EXPECT_EQ(tail, text(s));
    s.assign(s.str().c_str() + 30, 10);  // short part of a heap string
    EXPECT_EQ(std::string(10, 't'), text(s));
    s.assign(s.str().c_str() + 2, 5);  // part of an inner string
    EXPECT_EQ(std::string(5, 't'), text(s));
    s.assign(s.str());
    EXPECT_EQ(std::string(5, 't'), text(s));
}

// Copies and moves through Element are covered with the element tree; these are the cases it
// cannot reach.
TEST(VeskShortString, CopiesOwnTheirBytesAndSelfAssignmentKeepsThem) {
    for (const std::string& value : {std::string("short"), std::string(50, 'x')}) {
        ShortString source(value.c_str());
        ShortString copy(source);
        source.assign("changed");
        EXPECT_EQ(value, text(copy));
        ShortString target(std::string(60, 'o').c_str());
        target = std::move(copy);  // frees the target's heap bytes
        EXPECT_TRUE(copy.str().empty());
        target = target;
        EXPECT_EQ(value, text(target));
    }
}

// Guards against a copy taken from str() pointing into the ShortString it came from.
TEST(VeskShortString, AnAceCopyOfTheStringOutlivesIt) {
    ACE_CString copy;
    {
        const ShortString s("kept");
        copy = s.str();
        ACE_CString constructed(s.str());
        EXPECT_NE(s.str().c_str(), constructed.c_str());
    }
    EXPECT_STREQ("kept", copy.c_str());
}

}  // namespace
}  // namespace Vesk
