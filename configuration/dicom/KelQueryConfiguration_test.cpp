// The query module's document: the pooling number, which archives a read keeps, the query model
// read like atoi, and the prefetch section it holds.
#include <gtest/gtest.h>

#include "Configuration/KelQueryConfiguration.h"
#include "DicomTestSupport.h"
#include "testing/LogCapture.h"

namespace Configuration {
namespace {

using Testing::sampleDocument;
using Testing::withChild;
using Testing::withoutChild;

Vesk::Element single(const char* key, const char* text) {
    Vesk::Element e(key, -1);
    e.addSingle().assign(text);
    return e;
}

TEST(KelQuery, PoolingIsANumber) {
    KelQueryConfiguration config;
    EXPECT_EQ(1u, config.getConnectionPoolingEnabled());
    ASSERT_TRUE(config.readVesk(sampleDocument("KelQueryConfiguration.xml")));
    EXPECT_EQ(2u, config.getConnectionPoolingEnabled());
}

TEST(KelQuery, TheQueryModelReadsLikeAtoi) {
    const std::pair<const char*, int> kModels[] = {{"3", 3},   {"7x", 7}, {" 12", 12},
                                                   {"abc", 0}, {"", 0},   {"-2", -2}};
    for (const auto& [text, model] : kModels) {
        KelQueryRemoteSCPConfiguration archive;
        EXPECT_TRUE(archive.readVesk(withChild(sampleDocument("KelQueryRemoteSCPConfiguration.xml"),
                                               "QueryModel", single("QueryModel", text))));
        EXPECT_EQ(model, archive.getQueryModel()) << text;
    }
}

TEST(KelQuery, AnArchiveLackingAKeyIsDropped) {
    Vesk::Element tree = sampleDocument("KelQueryConfiguration.xml");
    Vesk::MultiElementValue& archives =
        tree.getMultiElement().getElement("Archives").getMultiElement();
    archives.addElement(withoutChild(*archives.begin(), "MergeArkCompatibility"));
    Quorvex::Testing::LogCapture log;
    KelQueryConfiguration config;
    EXPECT_FALSE(config.readVesk(tree));
    EXPECT_EQ(1u, config.getArchives().size());
    EXPECT_TRUE(log.records().empty());  // a missing own key is not logged
    archives.addElement(withoutChild(*archives.begin(), "QueryModel"));
    EXPECT_FALSE(config.readVesk(tree));
    EXPECT_EQ(1u, config.getArchives().size());
    // a missing query model is
    EXPECT_TRUE(log.onlyStartsWith(
        "KelQueryRemoteSCPConfiguration::readVesk: Failed. Standard Exception: "));
}

TEST(KelQuery, ThePrefetchSectionIsOptional) {
    KelQueryConfiguration config;
    ASSERT_TRUE(config.readVesk(sampleDocument("KelQueryConfiguration.xml")));
    EXPECT_TRUE(config.getPrefetchConfiguration().getPrefetchEnabled());
    EXPECT_EQ(7u, config.getPrefetchConfiguration().getPrefetchDaysBefore());
    EXPECT_TRUE(
        config.readVesk(withoutChild(sampleDocument("KelQueryConfiguration.xml"), "Prefetch")));
    EXPECT_TRUE(config.getPrefetchConfiguration().getPrefetchEnabled());  // kept
    const PrefetchConfiguration__ defaults;
    EXPECT_FALSE(defaults.getPrefetchEnabled());
    EXPECT_TRUE(defaults.getPrefetchOutsideNormalBusinessHours());
    EXPECT_EQ(2u, defaults.getPrefetchDaysBefore());
    EXPECT_EQ(5u, defaults.getPrefetchMaxRetries());
}

}  // namespace
}  // namespace Configuration
