// The site's storage topology: reading the queue document, and the queries that combine it with
// the strategy and location documents of the example site at the moment they are asked.
#include <gtest/gtest.h>

#include <stdexcept>

#include "Configuration/MSMQCommonConfiguration.h"
#include "Configuration/MSMQConfiguration.h"
#include "StorageTestSupport.h"
#include "Vesk/SingleValue.h"
#include "testing/LogCapture.h"

namespace Configuration {
namespace {

const char kActive[] = "9B2E7C14-5D3A-4E8F-A1B6-2C7D8E9F0A1B";
const char kActiveMirror[] = "D1E2F3A4-B5C6-4D7E-8F90-A1B2C3D4E5F6";
const char kNewStack[] = "C4D5E6F7-0819-4A2B-8C3D-4E5F60718293";
const char kNoActiveStack[] =
    "MSMQCommonConfiguration::translateLinkDefinition: Unable to determine active stack based on "
    "strategy configuration. Please diagnose and use OrvelWeb to configure an active stack.";

class Topology : public ::testing::Test {
protected:
    Topology() { EXPECT_TRUE(msmq.readVesk(Testing::siteDocument("MsmqCommon"))); }

    // The strategy document with the active flags of its three stacks replaced.
    void setActiveFlags(const char* a, const char* b, const char* c) {
        Vesk::Element strategy = Testing::siteDocument("StrategyConfiguration");
        const char* flags[] = {a, b, c};
        int i = 0;
        for (Vesk::Element& stack :
             strategy.getMultiElement().getElement("AvailableStacks").getMultiElement()) {
            stack.getMultiElement().getElement("IsStackActive").getSingle().assign(flags[i++]);
        }
        site.put("BrimmetServer\\StrategyConfiguration", strategy);
    }
    // Main Hospital's chain replaced by the given definitions.
    void setMainChain(std::initializer_list<ACE_CString> definitions) {
        auto chains = msmq.getLocationMigrationChains();
        ChainUtils::Chain& chain = chains["Main Hospital"];
        chain.clear();
        for (const ACE_CString& definition : definitions) {
            chain.emplace_back(definition, ChainUtils::ActiveStack, true);
        }
        msmq.setLocationMigrationChains(chains);
    }

    Testing::MemoryTopology site = Testing::MemoryTopology::exampleSite();
    ScopedTopologySource scoped{site};
    MSMQCommonConfiguration msmq;
};

TEST_F(Topology, TheSiteDocumentReadsWhole) {
    EXPECT_EQ(msmq.path(), "BrimmetServer\\MsmqCommon");
    EXPECT_EQ(msmq.getLocationMigrationChains().size(), 3u);
    EXPECT_EQ(ChainUtils::chainToString(msmq.getLocationMigrationChains().at("Northfield")),
              "[qvx-north-01]->[__PERSISTENT__]->[__MIRROR__]");
    EXPECT_EQ(msmq.getPersistentTargets().size(), 2u);
    EXPECT_EQ(msmq.getRetiredPersistentTargets().size(), 1u);
    EXPECT_EQ(msmq.getMirrors().size(), 3u);
    EXPECT_EQ(msmq.getLegacyMirrorStackMappings().size(), 1u);
    EXPECT_EQ(msmq.getNumberOfMigrationThreads(), 24u);
    EXPECT_EQ(msmq.getTimeToLive(), 172800u);
    EXPECT_FALSE(msmq.writeVesk());  // never written
    MSMQCommonConfiguration copy = msmq;
    EXPECT_EQ(copy, msmq);
    copy.setMaxMigrationThreadsPerSource(9);
    EXPECT_NE(copy, msmq);
}

TEST_F(Topology, DefaultsBeforeAnythingIsRead) {
    MSMQCommonConfiguration defaults;
    const ACE_CString& host = ConfigDoc::getLocalHostName();
    EXPECT_EQ(defaults.getCalyraNormalPriorityQueue(),
              MSMQConfiguration::BuildQueue(host, "calyranorm"));
    EXPECT_EQ(defaults.getCalyraLowPriorityQueue(),
              MSMQConfiguration::BuildQueue(host, "calyralow"));
    EXPECT_EQ(defaults.getCalyraConvertinQueue(), MSMQConfiguration::BuildQueue(host, "convertin"));
    EXPECT_TRUE(defaults.getCalyraQueuesEnabled());
    EXPECT_EQ(defaults.getTimeToReach(), 86400u);
    EXPECT_EQ(defaults.getMaxMigrationThreadsPerSource(), 1u);
    EXPECT_EQ(defaults.getMigrationRequestPollingInterval(), 60u);
    EXPECT_EQ(defaults.getVerifyMigrationFrequency(), 720u);
}

// Broken documents: the read fails with the message the document deserves, and what was read
// before the failure stays.
TEST_F(Topology, BrokenChainsFailTheReadWithTheirMessage) {
    const Vesk::Element good = Testing::siteDocument("MsmqCommon");
    struct Case {
        Vesk::Element document;
        const char* logged;
    };
    Vesk::Element emptyChains = Testing::withChild(good, "LocationMigrationChains",
                                                   Vesk::Element("LocationMigrationChains", -1));
    auto chainItem = [](const char* inside) {
        Vesk::Element chains("LocationMigrationChains", -1);
        Vesk::Element& item =
            chains.addMultiElement().addElement(new Vesk::Element("LocationMigrationChain", -1));
        Vesk::MultiElementValue& keys = item.addMultiElement();
        if (std::string(inside) != "name") {
            keys.addElement(new Vesk::Element("LocationName", -1)).addSingle().assign("X");
        }
        if (std::string(inside) != "chain") {
            keys.addElement(new Vesk::Element("MigrationChain", -1));  // no value
        }
        return chains;
    };
    const Case cases[] = {
        {Testing::withoutChild(good, "LocationMigrationChains"),
         "No location migration chains element found"},
        {emptyChains, "No location migration chains element found"},
        {Testing::withChild(good, "LocationMigrationChains", chainItem("name")),
         "No location name was found for a location migration chain."},
        {Testing::withChild(good, "LocationMigrationChains", chainItem("chain")),
         "No migration chain element found for location migration chain."},
        {Testing::withChild(good, "LocationMigrationChains", chainItem("empty chain")),
         "No migration chain element found for location migration chain."},
    };
    for (const Case& c : cases) {
        Quorvex::Testing::LogCapture log;
        MSMQCommonConfiguration read;
        EXPECT_FALSE(read.readVesk(c.document)) << c.logged;
        EXPECT_TRUE(log.contains(LM_ERROR, std::string("MSMQCommonConfiguration::readVesk: Failed. "
                                                       "Standard Exception: ") +
                                               c.logged + "\n"))
            << c.logged;
        EXPECT_EQ(read.getNumberOfMigrationThreads(), 24u);  // read before the chains
        EXPECT_TRUE(read.getMirrors().empty());              // read after them
    }
    Quorvex::Testing::LogCapture log;
    Vesk::Element mirrorsNotAList("Mirrors", -1);
    mirrorsNotAList.addSingle().assign("x");
    MSMQCommonConfiguration read;
    EXPECT_FALSE(read.readVesk(Testing::withChild(good, "Mirrors", mirrorsNotAList)));
    EXPECT_TRUE(
        log.containsFragment("MSMQCommonConfiguration::getMirrorsFromVesk: Failed. "
                             "TrelException: "));
    EXPECT_EQ(read.getLegacyMirrorStackMappings().size(), 1u);  // the read went on
    MSMQCommonConfiguration withoutPairs;
    EXPECT_TRUE(withoutPairs.readVesk(Testing::withoutChild(good, "RetiredPersistentTargets")));
}

TEST_F(Topology, ActivePersistentStackAndItsMirrorResolveToQueues) {
    ACE_CString uid, prefix, suffix;
    ASSERT_TRUE(msmq.getActivePersistentStackUid(uid, prefix, suffix));
    EXPECT_EQ(prefix + uid + suffix, ACE_CString("DIRECT=OS:") + kActive + "\\private$\\quorvexin");
    ASSERT_TRUE(msmq.getActivePersistentMirrorStackUid(uid, prefix, suffix));
    EXPECT_EQ(prefix + uid + suffix,
              ACE_CString("DIRECT=OS:") + kActiveMirror + "\\private$\\quorvexin");
    ASSERT_TRUE(msmq.getMirrorStackUidForPersistentStack(kNewStack, uid, prefix, suffix));
    EXPECT_EQ(uid, "0F1E2D3C-4B5A-4978-8695-A4B3C2D1E0F9");

    // Switching the active stack in the strategy document changes the answer at once.
    setActiveFlags("0", "0", "1");
    ASSERT_TRUE(msmq.getActivePersistentStackUid(uid, prefix, suffix));
    EXPECT_EQ(uid, kNewStack);
}

TEST_F(Topology, KeywordsMatchInAnyCaseAndUnusableChainsFail) {
    ACE_CString uid, prefix, suffix;
    setMainChain({"direct=os:__persistent__\\PRIVATE$\\QUORVEXIN", "DIRECT=OS:__mirror__\\x"});
    ASSERT_TRUE(msmq.getActivePersistentStackUid(uid, prefix, suffix));
    EXPECT_EQ(prefix, "direct=os:");
    EXPECT_EQ(suffix, "\\PRIVATE$\\QUORVEXIN");
    EXPECT_FALSE(msmq.getActivePersistentMirrorStackUid(uid, prefix, suffix));  // not the keyword

    struct Case {
        std::vector<ACE_CString> chain;
        bool persistent;
        bool mirror;
    };
    const Case cases[] = {
        {{}, false, false},
        {{ChainUtils::PersistentKeyword()}, true, false},  // no second link
        {{"", ChainUtils::PersistentMirrorKeyword()}, false, true},
        {{ChainUtils::PersistentMirrorKeyword(), ChainUtils::PersistentKeyword()}, false, false},
    };
    for (const Case& c : cases) {
        setMainChain({});
        auto chains = msmq.getLocationMigrationChains();
        for (const ACE_CString& definition : c.chain) {
            chains["Main Hospital"].emplace_back(definition, ChainUtils::ActiveStack, true);
        }
        msmq.setLocationMigrationChains(chains);
        EXPECT_EQ(c.persistent, msmq.getActivePersistentStackUid(uid, prefix, suffix));
        EXPECT_EQ(c.mirror, msmq.getActivePersistentMirrorStackUid(uid, prefix, suffix));
    }
    site.documents.erase("BrimmetServer\\Location");  // no main location
    EXPECT_FALSE(msmq.getActivePersistentStackUid(uid, prefix, suffix));
}

TEST_F(Topology, NoActiveStackOrNoMirrorIsLogged) {
    ACE_CString uid, prefix, suffix;
    Quorvex::Testing::LogCapture log;
    setActiveFlags("0", "2", "0");  // 2 is not active
    EXPECT_FALSE(msmq.getActivePersistentStackUid(uid, prefix, suffix));
    EXPECT_TRUE(log.records().empty());  // silently
    EXPECT_FALSE(msmq.getActivePersistentMirrorStackUid(uid, prefix, suffix));
    EXPECT_TRUE(log.contains(
        LM_CRITICAL,
        "MSMQCommonConfiguration::getActivePersistentMirror: Unable to determine active stack "
        "based on strategy configuration. Please diagnose and use OrvelWeb to configure an active "
        "stack.\n"));

    log.clear();
    setActiveFlags("1", "1", "0");  // two active: the first wins, and the conflict is logged
    msmq.setMirrors({{kActive, kActiveMirror}});
    EXPECT_FALSE(msmq.getActivePersistentMirrorStackUid(uid, prefix, suffix));
    EXPECT_TRUE(log.contains(LM_DEBUG,
                             "MSMQCommonConfiguration::getActivePersistentMirror: Unable to "
                             "determine mirror for active stack "
                             "3F2504E0-4F89-11D3-9A0C-0305E82C3301.\n"));
    EXPECT_TRUE(log.containsFragment("There are more than 1 active stacks configured."));
}

TEST_F(Topology, TranslatesEachKindOfLink) {
    struct Case {
        ACE_CString definition;
        bool found;
        short type;
        const char* resolved;
    };
    const Case cases[] = {
        {ChainUtils::PersistentKeyword(), true, 1, kActive},
        {"DIRECT=OS:__Mirror__\\private$\\quorvexin", true, 1, kActiveMirror},
        {ChainUtils::CacheKeyword(), true, 3, "DIRECT=OS:qvx-cache-01\\private$\\quorvexin"},
        {"DIRECT=OS:qvx-north-01\\private$\\quorvexin", true, 4,
         "DIRECT=OS:qvx-north-01\\private$\\quorvexin"},
        {"anything at all", true, 4, "anything at all"},
    };
    for (const Case& c : cases) {
        short type = 0;
        ACE_CString resolved, prefix, suffix;
        EXPECT_EQ(c.found, msmq.translateLinkDefinitionWithStackUid(c.definition, type, resolved,
                                                                    prefix, suffix))
            << c.definition.c_str();
        EXPECT_EQ(type, c.type) << c.definition.c_str();
        EXPECT_EQ(resolved, c.resolved) << c.definition.c_str();
    }
    EXPECT_EQ(site.hostQueries, 0);

    msmq.setCacheMigrationTargets({"", "DIRECT=OS:qvx-cache-02\\private$\\quorvexin"});
    short type = 0;
    ACE_CString resolved;
    ACE_CString prefix, suffix;
    EXPECT_FALSE(msmq.translateLinkDefinitionWithStackUid(ChainUtils::CacheKeyword(), type,
                                                          resolved, prefix, suffix));
    EXPECT_EQ(type, 3);
    msmq.setMirrors({});
    EXPECT_FALSE(msmq.translateLinkDefinitionWithStackUid(ChainUtils::PersistentMirrorKeyword(),
                                                          type, resolved, prefix, suffix));
}

// Without an active stack: quietly false on a site without storage stacks, an error (with two
// deliberately different texts) on one with some, and false when the service cannot be asked.
TEST_F(Topology, WithoutAnActiveStackTheLocalServiceDecides) {
    setActiveFlags("0", "0", "0");
    short type = 0;
    ACE_CString resolved, prefix, suffix;
    for (const ACE_CString& keyword :
         {ChainUtils::PersistentKeyword(), ChainUtils::PersistentMirrorKeyword()}) {
        EXPECT_FALSE(
            msmq.translateLinkDefinitionWithStackUid(keyword, type, resolved, prefix, suffix));
    }
    site.unreachable = true;
    Quorvex::Testing::LogCapture quiet;
    EXPECT_FALSE(msmq.translateLinkDefinitionWithStackUid(ChainUtils::PersistentKeyword(), type,
                                                          resolved, prefix, suffix));
    EXPECT_TRUE(quiet.containsFragment("Unable to list the storage stack hosts: service"));

    site.unreachable = false;
    site.stackHosts = {"qvx-stack-01"};
    const std::pair<ACE_CString, std::string> expected[] = {
        {ChainUtils::PersistentKeyword(), kNoActiveStack},
        {ChainUtils::PersistentMirrorKeyword(), std::string(kNoActiveStack) + "\n"},
    };
    for (const auto& e : expected) {
        Quorvex::Testing::LogCapture log;
        try {
            msmq.translateLinkDefinitionWithStackUid(e.first, type, resolved, prefix, suffix);
            ADD_FAILURE() << "no exception for " << e.first.c_str();
        } catch (const std::exception& thrown) {
            EXPECT_EQ(thrown.what(), e.second);
        }
        EXPECT_TRUE(log.contains(LM_CRITICAL, std::string(kNoActiveStack) + "\n"));
    }
}

TEST_F(Topology, MirrorsCachesAndLegacyGuids) {
    ACE_CString found = "stale";
    EXPECT_FALSE(msmq.getMirrorStackForPersistentStack("9b2e7c14-5d3a-4e8f-a1b6-2c7d8e9f0a1b",
                                                       found));  // case matters
    EXPECT_EQ(found, "");
    EXPECT_TRUE(msmq.getPersistentForMirror("d1e2f3a4-b5c6-4d7e-8f90-a1b2c3d4e5f6", found));
    EXPECT_EQ(found, ACE_CString("DIRECT=OS:") + kActive + "\\private$\\quorvexin");
    EXPECT_TRUE(msmq.getPersistentForMirror("5A6B7C8D-9E0F-4A1B-8C2D-3E4F5A6B7C8D", found));
    EXPECT_EQ(found, "DIRECT=OS:3F2504E0-4F89-11D3-9A0C-0305E82C3301\\private$\\quorvexin");
    EXPECT_FALSE(msmq.getPersistentForMirror("nobody", found));
    EXPECT_TRUE(msmq.getActiveCache(found));
    EXPECT_EQ(found, "DIRECT=OS:qvx-cache-01\\private$\\quorvexin");
    EXPECT_EQ(msmq.GetNewMirrorStackID("77AA88BB-99CC-4DDE-8EFF-001122334455", "QVX-MIRROR-01"),
              kActiveMirror);
    EXPECT_EQ(msmq.GetNewMirrorStackID("77AA88BB-99CC-4DDE-8EFF-001122334455", "qvx-mirror-01"),
              "");
    msmq.setCacheMigrationTargets({});
    EXPECT_FALSE(msmq.getActiveCache(found));
}

TEST_F(Topology, SwitchOverRetiresTheCurrentPersistentTarget) {
    Quorvex::Testing::LogCapture log;
    const MSMQCommonConfiguration::QueuePair a{"a", "am"}, b{"b", "bm"}, c{"c", "cm"};
    msmq.setPersistentTargets({a, b, c, a});
    msmq.setRetiredPersistentTargets({});
    EXPECT_TRUE(msmq.switchPersistent());
    EXPECT_EQ(msmq.getPersistentTargets(), (MSMQCommonConfiguration::QueuePairs{b, c}));
    EXPECT_EQ(msmq.getRetiredPersistentTargets(), (MSMQCommonConfiguration::QueuePairs{a}));
    msmq.setPersistentTargets({c});
    EXPECT_FALSE(msmq.switchPersistent());
    EXPECT_EQ(msmq.getPersistentTargets().size(), 1u);
    EXPECT_TRUE(log.contains(LM_CRITICAL,
                             "MSMQCommonConfiguration::switchPersistent: Unable to persistent "
                             "switchover, no future persistents specified in list.\n"));
    msmq.addMirror(a);
    msmq.addMirror(a);
    msmq.removeMirror(a);
    EXPECT_EQ(msmq.getMirrors().size(), 3u);
}

}  // namespace
}  // namespace Configuration
