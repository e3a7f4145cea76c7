// What the HTTP front decides before it runs a request: the path of a target, where an operation
// runs, and the connection and body-memory caps.
#include <gtest/gtest.h>

#include <utility>
#include <vector>

#include "BodyBudget.h"
#include "PeerLimiter.h"
#include "RequestRouting.h"

namespace ConfigurationService {
namespace {

TEST(FrontAdmission, TargetsInOriginAndAbsoluteFormNameTheirPath) {
    const std::pair<const char*, const char*> cases[] = {
        {"/Sundrel/a.ashx", "/Sundrel/a.ashx"},
        {"/Sundrel/a.ashx?x=1#f", "/Sundrel/a.ashx"},
        {"http://host:8771/Sundrel/a.ashx", "/Sundrel/a.ashx"},
        {"HTTPS://host/Sundrel/a.ashx?q", "/Sundrel/a.ashx"},
        {"http://host:8771", "/"},
        {"*", "*"},
        {"Sundrel/a.ashx", "Sundrel/a.ashx"},
        {"", ""},
    };
    for (const auto& c : cases) {
        EXPECT_EQ(RequestRouting::path(c.first), c.second) << c.first;
    }
}

TEST(FrontAdmission, OnlySmallReadsRunOnTheSocketThreads) {
    const std::pair<std::string, bool> cases[] = {
        {"<Retrieve><Host>h</Host></Retrieve>", true},
        {"\xEF\xBB\xBF<?xml version=\"1.0\"?><!-- a > b --><Exists/>", true},
        {"  <GetHostName></GetHostName>", true},
        {"<Store><Host>h</Host></Store>", false},
        {"<GetMasterHostName/>", false},  // a slave asks its master
        {"<!-- <Retrieve> --><Store/>", false},
        {"<!DOCTYPE x><Retrieve/>", false},
        {"<Retrieved/>", false},
        {"<Retrieve>" + std::string(RequestRouting::kQuickBodyBytes, ' ') + "</Retrieve>", false},
        {"", false},
        {"<", false},
    };
    for (const auto& c : cases) {
        EXPECT_EQ(RequestRouting::isQuick(c.first), c.second) << c.first.substr(0, 60);
    }
}

TEST(FrontAdmission, ConnectionsAreCappedPerPeerAndInAll) {
    PeerLimiter limiter(3, 2);
    std::vector<PeerLimiter::Slot> slots;
    slots.push_back(limiter.admit("10.0.0.1"));
    slots.push_back(limiter.admit("10.0.0.1"));
    EXPECT_FALSE(limiter.admit("10.0.0.1")) << "third from one peer";
    slots.push_back(limiter.admit("10.0.0.2"));
    EXPECT_FALSE(limiter.admit("10.0.0.3")) << "fourth in all";
    EXPECT_EQ(limiter.open(), 3u);
    slots.erase(slots.begin());  // a slot given back admits again
    EXPECT_TRUE(limiter.admit("10.0.0.1"));
    PeerLimiter::Slot moved = std::move(slots.front());
    slots.clear();
    EXPECT_EQ(limiter.open(), 1u);
}

TEST(FrontAdmission, BodiesShareOneBudget) {
    BodyBudget budget(100);
    BodyBudget::Grant first = budget.reserve(60);
    EXPECT_TRUE(first);
    EXPECT_FALSE(budget.reserve(41));
    BodyBudget::Grant second = budget.reserve(40);
    EXPECT_TRUE(second);
    EXPECT_FALSE(budget.reserve(static_cast<std::size_t>(-1)));
    first.release();
    EXPECT_EQ(budget.used(), 40u);
    EXPECT_TRUE(budget.reserve(60));  // given back at the end of the statement
    EXPECT_EQ(budget.used(), 40u);
}

}  // namespace
}  // namespace ConfigurationService
