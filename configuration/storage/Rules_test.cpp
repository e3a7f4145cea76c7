// Routing rules by sender: normalised keys, the example site's rules, and the tables consulted
// from several threads while another re-reads the document.
#include <gtest/gtest.h>

#include <atomic>
#include <thread>
#include <vector>

#include "Configuration/RulesConfiguration.h"
#include "StorageTestSupport.h"

namespace Configuration {
namespace {

TEST(Rules, KeysAreUpperCasedAndNothingElse) {
    EXPECT_EQ(RulesConfiguration::normalizeKey("ct_Main-1 "), "CT_MAIN-1 ");
    EXPECT_EQ(RulesConfiguration::normalizeKey(""), "");
    RulesConfiguration rules;
    EXPECT_EQ(rules.findRegistrationRule("ANY"), nullptr);  // empty table
    EXPECT_TRUE(rules.addRegistrationRule(RegistrationRule("mr_room", true, false, true, "")));
    EXPECT_FALSE(rules.addRegistrationRule(RegistrationRule("MR_ROOM", false, true, false, "")));
    for (const char* title : {"mr_room", "MR_ROOM", "Mr_RoOm"}) {
        std::unique_ptr<RegistrationRule> found = rules.findRegistrationRule(title);
        ASSERT_NE(found, nullptr) << title;
        EXPECT_TRUE(found->CalyraNormSelected());  // the first one added stays
        EXPECT_EQ(found->key(), "mr_room");
    }
    EXPECT_EQ(rules.findRegistrationRule("MR_ROOM "), nullptr);
    EXPECT_EQ(rules.findRegistrationRule(""), nullptr);
    EXPECT_TRUE(rules.removeRegistrationRule(RegistrationRule("Mr_Room", false, false, false, "")));
    EXPECT_FALSE(rules.hasRegistrationRules());
    EXPECT_FALSE(
        rules.removeRegistrationRule(RegistrationRule("mr_room", false, false, false, "")));
}

TEST(Rules, TheSiteRoutesEachSender) {
    RulesConfiguration rules;
    ASSERT_TRUE(rules.readVesk(Testing::siteDocument("RoutingRules")));
    std::vector<RegistrationRule> all;
    rules.getRegistrationRules(all);
    EXPECT_EQ(all.size(), 12u);
    EXPECT_EQ(rules.findRegistrationRule("mr_main_2")->otherQueue(),
              "DIRECT=OS:ris01\\private$\\risin");
    EXPECT_EQ(ChainUtils::chainToString(rules.findDefaultMigrationRule("mg_main")->filter()),
              "[__PERSISTENT__]->[__MIRROR__]");
    EXPECT_EQ(rules.findDefaultMigrationRule("CR_NORTH"), nullptr);
    EXPECT_EQ(ChainUtils::chainToString(
                  rules.findLocationMigrationRule("Northfield", "cr_north")->filter()),
              "[qvx-north-01]->[__PERSISTENT__]");
    EXPECT_EQ(rules.findLocationMigrationRule("northfield", "CR_NORTH"), nullptr);
    EXPECT_EQ(rules.getLocationNames(),
              (std::vector<ACE_CString>{"Eastside Clinic", "Northfield"}));
    RulesConfiguration copy(rules);
    EXPECT_EQ(copy, rules);
    copy.addRegistrationRule(RegistrationRule("NEW", false, false, false, ""));
    EXPECT_NE(copy, rules);
    copy = rules;
    EXPECT_EQ(copy, rules);
}

TEST(Rules, EmptyAndHugeTitlesAreOrdinaryKeys) {
    RulesConfiguration rules;
    const ACE_CString huge(std::string(100000, 'a').c_str());
    EXPECT_TRUE(rules.addRegistrationRule(RegistrationRule("", true, false, false, "")));
    EXPECT_TRUE(rules.addRegistrationRule(RegistrationRule(huge, false, true, false, "")));
    EXPECT_TRUE(rules.findRegistrationRule("")->CalyraNormSelected());
    EXPECT_TRUE(
        rules.findRegistrationRule(RulesConfiguration::normalizeKey(huge))->CalyraLowSelected());
    RulesConfiguration again;
    EXPECT_TRUE(again.readVesk(*rules.writeVesk()));
    EXPECT_EQ(again, rules);
}

// Readers on three threads look up every sender while a fourth re-reads the document; each
// re-read swaps whole tables in, so a reader never sees a sender without its rule.
TEST(Rules, LookupsWhileTheDocumentIsReRead) {
    const Vesk::Element site = Testing::siteDocument("RoutingRules");
    RulesConfiguration rules;
    ASSERT_TRUE(rules.readVesk(site));
    std::vector<RegistrationRule> senders;
    rules.getRegistrationRules(senders);
    std::atomic<int> misses{0};
    std::atomic<bool> done{false};
    std::vector<std::thread> readers;
    for (int t = 0; t < 3; ++t) {
        readers.emplace_back([&] {
            for (int round = 0; round < 200 && !done; ++round) {
                for (const RegistrationRule& sender : senders) {
                    misses += rules.findRegistrationRule(sender.key()) == nullptr ? 1 : 0;
                }
                misses += rules.findDefaultMigrationRule("CT_MAIN_1") == nullptr ? 1 : 0;
                misses += rules.findLocationMigrationRule("Northfield", "US_NORTH") == nullptr;
            }
        });
    }
    for (int i = 0; i < 50; ++i) {
        EXPECT_TRUE(rules.readVesk(site));
    }
    done = true;
    for (std::thread& reader : readers) {
        reader.join();
    }
    EXPECT_EQ(misses, 0);
}

}  // namespace
}  // namespace Configuration
