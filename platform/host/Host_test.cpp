#include "Quorvex/Host.h"

#include <arpa/inet.h>
#include <gtest/gtest.h>

#include <cstdlib>
#include <string>

#include "Quorvex/Machine.h"
#include "testing/FakeMachine.h"

namespace {

using Quorvex::Testing::FakeMachine;

std::string str(const ACE_CString& s) {
    return std::string(s.c_str(), s.length());
}

TEST(HostTest, NamesComeFromTheCurrentMachine) {
    FakeMachine fake;
    fake.shortName = "orvel1";
    fake.domain = "site.local";
    Quorvex::ScopedMachine scope(fake);
    EXPECT_EQ("orvel1", str(Quorvex::GetHostName(false)));
    EXPECT_EQ("orvel1.site.local", str(Quorvex::GetHostName(true)));
    fake.domain = "";  // without a domain the fully qualified name is the short name
    EXPECT_EQ("orvel1", str(Quorvex::GetHostName(true)));
}

TEST(HostTest, LocalIPAddress) {
    FakeMachine fake;
    Quorvex::ScopedMachine scope(fake);
    ACE_CString address;
    EXPECT_EQ(0, Quorvex::GetLocalIPAddress(address));
    EXPECT_EQ("192.0.2.10", str(address));

    fake.ipAddress = "";
    address = "unchanged";
    EXPECT_NE(0, Quorvex::GetLocalIPAddress(address));
    EXPECT_EQ("unchanged", str(address));
}

TEST(HostTest, EnvironmentPrefersTheFakeThenInherits) {
    FakeMachine fake;
    fake.env["QUORVEX_TEST_ONLY_VAR"] = "fake value";
    fake.env["PATH"] = "fake path";
    Quorvex::ScopedMachine scope(fake);
    ACE_CString value;
    ASSERT_TRUE(Quorvex::GetEnvironmentVariable("QUORVEX_TEST_ONLY_VAR", value));
    EXPECT_EQ("fake value", str(value));
    ASSERT_TRUE(Quorvex::GetEnvironmentVariable("PATH", value));
    EXPECT_EQ("fake path", str(value));
    EXPECT_FALSE(Quorvex::GetEnvironmentVariable("QUORVEX_SURELY_UNSET_VARIABLE", value));

    fake.env.erase("PATH");
    ASSERT_NE(nullptr, std::getenv("PATH"));
    ASSERT_TRUE(Quorvex::GetEnvironmentVariable("PATH", value));
    EXPECT_EQ(std::getenv("PATH"), str(value));

    fake.inheritEnvironment = false;
    EXPECT_FALSE(Quorvex::GetEnvironmentVariable("PATH", value));
}

TEST(HostTest, RealMachineAnswers) {
    const ACE_CString shortName = Quorvex::GetHostName(false);
    ASSERT_GT(shortName.length(), 0u);
    EXPECT_EQ(ACE_CString::npos, shortName.find('.'));
    EXPECT_GT(Quorvex::GetHostName(true).length(), 0u);

    ACE_CString address;
    if (Quorvex::GetLocalIPAddress(address) == 0) {
        in_addr parsed{};
        EXPECT_EQ(1, inet_pton(AF_INET, address.c_str(), &parsed)) << address.c_str();
        EXPECT_NE(0, address.find("127.")) << address.c_str();
    }
}

struct NamePair {
    const char* a;
    const char* b;
    bool equivalent;
};

TEST(HostTest, NamesEquivalent) {
    const NamePair cases[] = {
        {"orvel1", "orvel1", true},
        {"orvel1", "ORVEL1", true},
        {"orvel1", "ORVEL1.site.local", true},
        {"Orvel1.Site.Local", "orvel1", true},
        {"orvel1.site.local", "ORVEL1.SITE.LOCAL", true},
        {"orvel1", "orvel2", false},
        {"orvel1", "orvel10.site.local", false},
        {"orvel1", "orvel.site.local", false},
        {"a.x", "a.y", false},
        {"orvel1", "", false},
        {"", "", false},
        {"10", "10.0.0.1", false},
        {"10.0.0.1", "10.0.0.1", true},
    };
    for (const NamePair& c : cases) {
        EXPECT_EQ(c.equivalent, Quorvex::HostNamesEquivalent(c.a, c.b)) << c.a << " / " << c.b;
        EXPECT_EQ(c.equivalent, Quorvex::HostNamesEquivalent(c.b, c.a)) << c.b << " / " << c.a;
    }
}

}  // namespace
