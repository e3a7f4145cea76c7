// Queue names in direct format and storage chains: building, parsing, the element and text forms,
// and searching by host.
#include <gtest/gtest.h>

#include <cstring>

#include "Configuration/ChainUtils.h"
#include "Configuration/MSMQConfiguration.h"
#include "Quorvex/Host.h"
#include "StorageTestSupport.h"
#include "Vesk/MultiValue.h"
#include "Vesk/SingleValue.h"
#include "Vesk/XmlUtils.h"
#include "testing/LogCapture.h"

namespace Configuration {
namespace {

using ChainUtils::Chain;
using ChainUtils::Link;

Link queue(const char* host) {
    return Link(MSMQConfiguration::QuorvexInputQueueFromHost(host), ChainUtils::LiteralQueue, true);
}

TEST(QueueNames, BuiltFromHostAndName) {
    EXPECT_EQ(MSMQConfiguration::BuildQueue("qvx1", "q"), "DIRECT=OS:qvx1\\private$\\q");
    EXPECT_EQ(MSMQConfiguration::QuorvexInputQueueFromHost("qvx1"),
              "DIRECT=OS:qvx1\\private$\\quorvexin");
    EXPECT_EQ(MSMQConfiguration::QuorvexWorkListInputQueueFromHost("qvx1"),
              "DIRECT=OS:qvx1\\private$\\quorvexQueueMonitorIn");
    const ACE_CString normal = MSMQConfiguration::LocalQuorvexWorkFlowNormalPriorityQueueName();
    EXPECT_EQ(MSMQConfiguration::HostFromQueue(normal), Quorvex::GetHostName(false));
    EXPECT_EQ(normal.substring(normal.length() - 21), "quorvexWorkFlowNormal");
    EXPECT_EQ(MSMQConfiguration::LocalQuorvexWorkFlowLowPriorityQueueName(),
              MSMQConfiguration::BuildQueue(Quorvex::GetHostName(false), "quorvexWorkFlowLow"));
}

TEST(QueueNames, DirectFormatParsing) {
    struct Case {
        const char* queue;
        bool parses;
        const char* host;
        const char* name;
    };
    const Case cases[] = {
        {"DIRECT=OS:qvx1\\private$\\quorvexin", true, "qvx1", "private$\\quorvexin"},
        {"DIRECT=OS:\\private$\\q", true, "", "private$\\q"},
        {"a:b\\", true, "b", ""},
        {"DIRECT=TCP:10.0.0.1:80\\q", true, "10.0.0.1:80", "q"},  // first colon, first backslash
        {"no colon\\private$\\q", false, "", ""},
        {"DIRECT=OS:qvx1/private$/q", false, "", ""},
        {"\\private$:q", false, "", ""},  // the backslash before the colon
        {"", false, "", ""},
    };
    for (const Case& c : cases) {
        ACE_CString host = "untouched";
        ACE_CString name = "untouched";
        EXPECT_EQ(c.parses, MSMQConfiguration::ParseDirectFormattedMSMQ(c.queue, host, name))
            << c.queue;
        EXPECT_EQ(MSMQConfiguration::HostFromQueue(c.queue), c.host) << c.queue;
        if (c.parses) {
            EXPECT_EQ(name, c.name) << c.queue;
        } else {
            EXPECT_EQ(host, "untouched") << c.queue;
        }
    }
}

TEST(QueueNames, MachineQueuesDefaultToTheLocalHostAndReadFromTheSite) {
    MSMQConfiguration defaults;
    const ACE_CString& host = ConfigDoc::getLocalHostName();
    EXPECT_EQ(defaults.path(), "BrimmetServer\\Msmq");
    EXPECT_TRUE(defaults.isLocal());
    EXPECT_EQ(defaults.getLocalAdminQueue(), MSMQConfiguration::BuildQueue(host, "quorvexadmin"));
    EXPECT_EQ(defaults.getLocalInboundQueue(), MSMQConfiguration::BuildQueue(host, "quorvexin"));
    EXPECT_EQ(defaults.getLocalErrorQueue(), MSMQConfiguration::BuildQueue(host, "quorvexerror"));

    const Vesk::Element site = Testing::siteDocument("Msmq");
    MSMQConfiguration read;
    ASSERT_TRUE(read.readVesk(site));
    EXPECT_TRUE(read.getSendToLocalWorkListService());
    EXPECT_EQ(read.getResetQueueSecurity().size(), 2u);
    EXPECT_EQ(Vesk::XmlUtils::toString(site), Vesk::XmlUtils::toString(*read.writeVesk()));
    MSMQConfiguration missing;
    EXPECT_FALSE(missing.readVesk(Testing::withoutChild(site, "LocalErrorQueue")));
    EXPECT_EQ(missing.getLocalErrorQueue(), defaults.getLocalErrorQueue());
    EXPECT_TRUE(missing.readVesk(Testing::withoutChild(site, "ResetQueueSecurity")));
}

TEST(Chains, Keywords) {
    EXPECT_EQ(ChainUtils::ProcessingKeyword(), "");
    EXPECT_EQ(ChainUtils::PersistentKeyword(), "DIRECT=OS:__PERSISTENT__\\private$\\quorvexin");
    EXPECT_EQ(ChainUtils::PersistentMirrorKeyword(), "DIRECT=OS:__MIRROR__\\private$\\quorvexin");
    EXPECT_EQ(ChainUtils::CacheKeyword(), "DIRECT=OS:__CACHE__\\private$\\quorvexin");
    EXPECT_EQ(&ChainUtils::PersistentKeyword(), &ChainUtils::PersistentKeyword());
    EXPECT_TRUE(ChainUtils::isKeyword(ChainUtils::CacheKeyword()));
    EXPECT_FALSE(ChainUtils::isKeyword("DIRECT=OS:__persistent__\\private$\\quorvexin"));
    EXPECT_FALSE(ChainUtils::isKeyword(ChainUtils::ProcessingKeyword()));
}

TEST(Chains, TextForm) {
    struct Case {
        Chain chain;
        const char* text;
    };
    const Case cases[] = {
        {{}, "EMPTY CHAIN"},
        {{queue("a"), queue("b")}, "[a]->[b]"},
        {{Link(ChainUtils::PersistentKeyword(), ChainUtils::ActiveStack, true)},
         "[__PERSISTENT__]"},
        {{Link("", ChainUtils::Unresolved, true),
          Link("not a queue", ChainUtils::LiteralQueue, false), queue("c")},
         "[]->[]->[c]"},
    };
    for (const Case& c : cases) {
        EXPECT_EQ(ChainUtils::chainToString(c.chain), c.text);
    }
}

TEST(Chains, SearchByEquivalentHost) {
    Chain chain = {queue("qvx-main-01"), queue("qvx-mirror.hospital.example"), queue("cache")};
    EXPECT_EQ(ChainUtils::findHostInChain("QVX-MAIN-01", chain), chain.begin());
    EXPECT_EQ(ChainUtils::findHostInChain("qvx-mirror", chain), chain.begin() + 1);
    EXPECT_EQ(ChainUtils::findHostInChain("other", chain), chain.end());
    const Chain& constant = chain;
    EXPECT_EQ(ChainUtils::nextLink("qvx-main-01", constant), constant.begin() + 1);
    EXPECT_EQ(ChainUtils::nextLink("cache", constant), constant.end());  // the last hop
    EXPECT_EQ(ChainUtils::nextLink("unknown", constant), constant.end());
    // Another queue on the same host is the same place.
    EXPECT_TRUE(ChainUtils::isInChain(Link(MSMQConfiguration::BuildQueue("CACHE", "quorvexerror"),
                                           ChainUtils::LiteralQueue, false),
                                      chain));
    EXPECT_FALSE(ChainUtils::isInChain(queue("elsewhere"), chain));
    // Links without a host are never equal, not even to themselves.
    EXPECT_FALSE(Link() == Link());
}

Vesk::Element chainElement(const char* xml) {
    Vesk::Element tree;
    Vesk::XmlUtils::parse(xml, std::strlen(xml), tree);
    return tree;
}

TEST(Chains, ElementFormReadsWhatItWritesAndToleratesOddShapes) {
    const Chain chain = {
        Link(ChainUtils::PersistentKeyword(), ChainUtils::ActiveStack, true),
        Link(MSMQConfiguration::QuorvexInputQueueFromHost("c1"), ChainUtils::LiteralQueue, false)};
    Vesk::Element holder("Holder", -1);
    ChainUtils::addChainToVesk("MigrationChain", chain, holder.addMultiElement());
    Chain read = {queue("stale")};
    ASSERT_TRUE(ChainUtils::getChainFromVesk("MigrationChain", holder.getMultiElement(), read));
    ASSERT_EQ(read.size(), 2u);
    EXPECT_EQ(read[1].getDefinition(), chain[1].getDefinition());
    EXPECT_EQ(read[1].getDefinitionType(), ChainUtils::LiteralQueue);
    EXPECT_FALSE(read[1].getEnabled());

    struct Case {
        const char* xml;
        bool complete;
        std::size_t links;
    };
    const Case cases[] = {
        {"<e k='h'><l></l></e>", true, 0},                                    // absent
        {"<e k='h'><l><e k='MigrationChain'/></l></e>", true, 0},             // no value
        {"<e k='h'><l><e k='MigrationChain'><s>x</s></e></l></e>", true, 0},  // a single value
        {"<e k='h'><l><e k='MigrationChain'><m><s>x</s><l><e k='Definition'><s>d</s></e>"
         "<e k='DefinitionType'><s>4</s></e><e k='Enabled'><s>1</s></e></l></m></e></l></e>",
         true, 1},  // items that are not keyed lists are skipped
        {"<e k='h'><l><e k='MigrationChain'><m><l><e k='Definition'><s>d</s></e></l></m></e>"
         "</l></e>",
         false, 1},  // a link missing keys is kept, with its defaults
    };
    for (const Case& c : cases) {
        const Vesk::Element tree = chainElement(c.xml);
        Chain links = {queue("stale")};
        EXPECT_EQ(c.complete,
                  ChainUtils::getChainFromVesk("MigrationChain", tree.getMultiElement(), links))
            << c.xml;
        EXPECT_EQ(links.size(), c.links) << c.xml;
    }
    const Vesk::Element partial = chainElement(cases[4].xml);
    Chain links;
    ChainUtils::getChainFromVesk("MigrationChain", partial.getMultiElement(), links);
    EXPECT_EQ(links[0].getDefinitionType(), ChainUtils::Unresolved);
    EXPECT_TRUE(links[0].getEnabled());
}

}  // namespace
}  // namespace Configuration
