#include "Quorvex/Paths.h"

#include <gtest/gtest.h>

#include <string>

namespace {

struct PathCase {
    const char* input;
    const char* expected;
};

struct JoinCase {
    const char* a;
    const char* b;
    const char* expected;
};

std::string str(const ACE_CString& s) {
    return std::string(s.c_str(), s.length());
}

TEST(PathsTest, DriveElement) {
    const PathCase cases[] = {
        {"C:\\a\\b", "C:\\"},
        {"c:\\", "c:\\"},
        {"C:", "C:\\"},
        {"D:/data/x", "D:/"},
        {"\\\\server\\share\\a\\b", "\\\\server\\share\\"},
        {"\\\\server\\share", "\\\\server\\share\\"},
        {"/usr/bin/server", "/"},
        {"\\Quorvex", "\\"},
        {"relative\\path", ""},
        {"", ""},
    };
    for (const PathCase& c : cases) {
        EXPECT_EQ(c.expected, str(Quorvex::getDriveElement(c.input))) << c.input;
    }
}

TEST(PathsTest, AllButLastElement) {
    const PathCase cases[] = {
        {"C:\\a\\b\\", "C:\\a"},
        {"C:\\a\\b", "C:\\a"},
        {"c:\\Quorvex\\stack\\", "c:\\Quorvex"},
        {"C:\\a\\\\b\\\\", "C:\\a"},
        {"C:\\a", "C:"},
        {"C:\\", "C:"},
        {"C:", "C:"},
        {"\\\\server\\share\\a", "\\\\server\\share"},
        {"\\\\server\\share\\", "\\\\server\\share"},
        {"/usr/bin", "/usr"},
        {"a\\b", "a"},
        {"a", ""},
        {"", ""},
    };
    for (const PathCase& c : cases) {
        EXPECT_EQ(c.expected, str(Quorvex::getAllButLastPathElement(c.input))) << c.input;
    }
}

TEST(PathsTest, Concat) {
    const JoinCase cases[] = {
        {"C:\\", "Quorvex\\MultiStack\\", "C:\\Quorvex\\MultiStack\\"},
        {"C:\\a", "b", "C:\\a\\b"},
        {"C:\\a\\\\", "\\\\b", "C:\\a\\b"},
        {"C:", "b", "C:\\b"},
        {"/", "b", "\\b"},
        {"a", "", "a"},
        {"", "b", "b"},
        {"", "", ""},
    };
    for (const JoinCase& c : cases) {
        EXPECT_EQ(c.expected, str(Quorvex::concatPath(c.a, c.b))) << c.a << " + " << c.b;
    }
}

TEST(PathsTest, Normalize) {
    const PathCase cases[] = {
        {"C:\\Quorvex\\MultiStack\\", "C:\\Quorvex\\MultiStack\\"},
        {"C:/a/b", "C:\\a\\b"},
        {"C:\\a\\\\b\\\\\\", "C:\\a\\b\\"},
        {"C:\\a\\.\\b\\..\\c", "C:\\a\\c"},
        {"C:\\a\\..", "C:\\"},
        {"C:\\..\\..\\a", "C:\\a"},
        {"C:\\a\\b\\.", "C:\\a\\b"},
        {"C:..\\a", "C:..\\a"},
        {"\\\\server\\share\\a\\..\\..\\b", "\\\\server\\share\\b"},
        {"//server//share/a", "\\\\server\\share\\a"},
        {"\\\\\\server\\share", "\\\\server\\share"},
        {"/usr//lib/", "\\usr\\lib\\"},
        {"a\\..\\..\\b", "..\\b"},
        {"a\\..", "."},
        {".", "."},
        {"", ""},
    };
    for (const PathCase& c : cases) {
        EXPECT_EQ(c.expected, str(Quorvex::normalizePath(c.input))) << c.input;
    }
}

}  // namespace
