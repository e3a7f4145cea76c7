// Which stack is active, and where a host is: the strategy and location documents' own logic.
#include <gtest/gtest.h>

#include "Configuration/LocationConfiguration.h"
#include "Configuration/StrategyConfiguration.h"
#include "StorageTestSupport.h"
#include "testing/LogCapture.h"

namespace Configuration {
namespace {

StrategyConfiguration withStacks(std::initializer_list<std::pair<const char*, int>> stacks) {
    std::vector<StrategyStack> list;
    for (const auto& s : stacks) {
        StrategyStack stack;
        stack.setStackUid(s.first);
        stack.setIsStackActive(s.second);
        list.push_back(stack);
    }
    StrategyConfiguration strategy;
    strategy.setAvailableStacks(list);
    return strategy;
}

TEST(Strategies, OnlyAFlagOfExactlyOneMakesAStackActive) {
    struct Case {
        StrategyConfiguration strategy;
        bool found;
        const char* active;
        bool conflictLogged;
    };
    const Case cases[] = {
        {withStacks({}), false, "untouched", false},
        {withStacks({{"A", 0}, {"B", 2}, {"C", -1}}), false, "untouched", false},
        {withStacks({{"A", 0}, {"B", 1}}), true, "B", false},
        {withStacks({{"A", 1}, {"B", 1}, {"C", 1}}), true, "A", true},
    };
    for (const Case& c : cases) {
        Quorvex::Testing::LogCapture log;
        StrategyStack stack;
        stack.setStackUid("untouched");
        EXPECT_EQ(c.found, c.strategy.TryGetActiveStack(stack));
        EXPECT_EQ(stack.getStackUid(), c.active);
        EXPECT_EQ(c.conflictLogged ? 1u : 0u, log.records().size());
        if (c.conflictLogged) {
            EXPECT_TRUE(log.contains(
                LM_CRITICAL,
                "StrategyConfiguration::TryGetActiveStack: There are more than 1 active stacks "
                "configured. Please diagnose and use OrvelWeb to reconcile which stack is the "
                "correct active stack.\n"));
        }
    }
    EXPECT_TRUE(withStacks({{"A", 0}}).IsActiveStack(""));  // none active: "" is
    EXPECT_FALSE(withStacks({{"A", 1}}).IsActiveStack(""));
    EXPECT_TRUE(withStacks({{"A", 1}}).IsActiveStack("A"));
    EXPECT_FALSE(withStacks({{"A", 1}}).IsActiveStack("a"));
}

TEST(Strategies, AStackThatCannotBeReadIsDroppedAndItsNeighboursKept) {
    const Vesk::Element site = Testing::siteDocument("StrategyConfiguration");
    Vesk::Element broken(site);
    Vesk::MultiElementValue& stacks =
        broken.getMultiElement().getElement("AvailableStacks").getMultiElement();
    Vesk::Element& second = *std::next(stacks.begin());
    second = Testing::withoutChild(second, "StackUid");
    StrategyConfiguration strategy;
    EXPECT_FALSE(strategy.readVesk(broken));
    ASSERT_EQ(strategy.getAvailableStacks().size(), 2u);
    EXPECT_EQ(strategy.getAvailableStacks()[1].getStackUid(),
              "C4D5E6F7-0819-4A2B-8C3D-4E5F60718293");
    EXPECT_EQ(strategy.getAvailableStrategies().size(), 2u);
}

class Locations : public ::testing::Test {
protected:
    Locations() { EXPECT_TRUE(site.readVesk(Testing::siteDocument("Location"))); }
    LocationConfiguration site;
};

TEST_F(Locations, LookUps) {
    ASSERT_NE(site.getMainCalyraProfile(), nullptr);
    EXPECT_EQ(site.getMainCalyraProfile()->getProfileName(), "Main Hospital");
    EXPECT_EQ(site.getLocationProfileByServer("QVX-EAST-01")->getProfileName(), "Eastside Clinic");
    EXPECT_EQ(site.getLocationProfileByServer("qvx-east-01.hospital.example"), nullptr);
    EXPECT_EQ(site.getLocationProfileByName("northfield"), nullptr);
    const LocationProfile* east = site.getLocationProfileByName("Eastside Clinic");
    ASSERT_NE(east, nullptr);
    EXPECT_TRUE(east->IsRemoteWANAccess() && east->IsWAN() && east->IsCompressionEnabled());
    EXPECT_TRUE(east->getEnableForwarding());
    EXPECT_EQ(east->getForwardDestinations().size(), 1u);
    EXPECT_TRUE(east->hasFilter("10.40.1.11"));
    EXPECT_FALSE(east->hasFilter("10.40.1.1"));
    EXPECT_TRUE(site.getMainCalyraProfile()->hasFilter("anything"));  // no filters: all

    LocationProfile second = *site.getMainCalyraProfile();
    second.setProfileName("Second Main");
    second.addLocalServer("qvx-east-01");
    EXPECT_EQ(site.AddNewProfile(second), 1);
    EXPECT_EQ(site.getMainCalyraProfile()->getProfileName(), "Main Hospital");  // the first
    EXPECT_EQ(site.getLocationProfileByServer("qvx-east-01")->getProfileName(), "Eastside Clinic");
    site.removeLocationProfile("Main Hospital");
    EXPECT_EQ(site.getMainCalyraProfile()->getProfileName(), "Second Main");
    site.ClearAll();
    EXPECT_EQ(site.getMainCalyraProfile(), nullptr);
}

TEST_F(Locations, ServersCompareWithoutCase) {
    LocationProfile profile;
    profile.addLocalServer("Qvx-A");
    profile.addLocalServer("qvx-a");
    EXPECT_TRUE(profile.hasServer("QVX-A"));
    profile.removeLocalServer("QVX-A");
    EXPECT_EQ(profile.getLocalServers(), std::vector<ACE_CString>{"qvx-a"});
    profile.removeAllServers();
    EXPECT_FALSE(profile.hasServer("qvx-a"));
}

TEST_F(Locations, WhereAHostIsSeenFromEachLocation) {
    const LocationProfile* main = site.getLocationProfileByName("Main Hospital");
    const LocationProfile* north = site.getLocationProfileByName("Northfield");
    const LocationProfile* east = site.getLocationProfileByName("Eastside Clinic");
    LocationProfile otherWan = *east;
    otherWan.setProfileName("Westside");
    otherWan.removeAllServers();
    otherWan.addLocalServer("qvx-west-01");
    site.AddNewProfile(otherWan);
    LocationProfile oddNetwork = *main;
    oddNetwork.setNetworkAffiliation(static_cast<LocationProfile::NetworkAffiliation>(5));
    struct Case {
        const LocationProfile* from;
        const char* host;
        LocationConfiguration::HostLocation where;
    };
    const Case cases[] = {
        {main, "qvx-north-01", LocationConfiguration::SameNetwork},
        {main, "qvx-east-01", LocationConfiguration::OtherNetwork},
        {north, "QVX-MAIN-02", LocationConfiguration::SameNetwork},
        {east, "qvx-main-01", LocationConfiguration::OtherNetwork},
        {east, "qvx-east-01", LocationConfiguration::SameNetwork},
        {east, "qvx-west-01", LocationConfiguration::OtherWanLocation},
        {main, "unknown-host", LocationConfiguration::UnknownLocation},
        {&oddNetwork, "qvx-main-01", LocationConfiguration::UnknownLocation},
        {nullptr, "qvx-main-01", LocationConfiguration::UnknownLocation},
    };
    for (const Case& c : cases) {
        EXPECT_EQ(c.where, site.MapHostToLocationProfile(c.from, c.host)) << c.host;
    }
}

}  // namespace
}  // namespace Configuration
