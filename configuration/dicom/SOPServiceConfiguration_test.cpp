// Resolution of the SOP service document: every template and service of
// tests/data/dicom/Resolution.xml resolves to what its description states; the order effects of
// reading (reading twice appends, failures of one list leave the others resolved); hostile
// documents read without a crash.
#include <gtest/gtest.h>

#include <map>
#include <random>
#include <set>
#include <string>

#include "Configuration/SOPServiceConfiguration.h"
#include "DicomTestSupport.h"
#include "testing/LogCapture.h"

namespace Configuration {
namespace {

using Testing::child;
using Testing::describe;
using Testing::text;

const Vesk::Element& resolutionCases() {
    static const Vesk::Element tree = Testing::dicomDocument("Resolution.xml");
    return tree;
}

TEST(SOPServiceResolution, EveryServiceResolvesAsItsDescriptionStates) {
    SOPServiceConfiguration config;
    ASSERT_TRUE(config.readVesk(resolutionCases()));
    const auto& services = config.getSOPServiceList().getSOPServices();
    ASSERT_EQ(services.size(), 33u);
    for (const SOPService& service : services) {
        EXPECT_EQ(service.getDescription().c_str(), describe(service)) << service.getName().c_str();
    }
}

TEST(SOPServiceResolution, EveryTemplateResolvesAsItsDescriptionStates) {
    SOPServiceConfiguration config;
    ASSERT_TRUE(config.readVesk(resolutionCases()));
    const auto& templates =
        config.getTemplateTransferSyntaxLists().getTemplateTransferSyntaxLists();
    ASSERT_EQ(templates.size(), 7u);
    for (const TemplateTransferSyntaxList& entry : templates) {
        EXPECT_EQ(entry.getDescription().c_str(), describe(entry.getTransferSyntaxList()))
            << entry.getName().c_str();
    }
}

// Every resolved entry carries the last master-table row with its number.
TEST(SOPServiceResolution, EntriesCarryTheLastRowOfTheirNumber) {
    SOPServiceConfiguration config;
    ASSERT_TRUE(config.readVesk(resolutionCases()));
    std::map<int, SupportedTransferSyntax> lastRow;
    for (const auto& row : config.getSupportedTransferSyntaxList().getSupportedTransferSyntaxes()) {
        lastRow[row.getNr()] = row;
    }
    std::size_t entries = 0;
    for (const SOPService& service : config.getSOPServiceList().getSOPServices()) {
        for (const TransferSyntax& entry : service.getTransferSyntaxList().getTransferSyntaxes()) {
            EXPECT_EQ(entry.getSupportedTransferSyntax(), lastRow.at(entry.getNr()));
            EXPECT_EQ(entry.getUID(), lastRow.at(entry.getNr()).getUID());
            ++entries;
        }
    }
    EXPECT_EQ(entries, 37u);
    EXPECT_EQ(lastRow.at(7).getUID(), "1.2.840.10008.1.2.4.80");
}

// Nothing is cleared: the second read appends a second copy of every list and resolves every
// template and service again, the first copies growing once more.
TEST(SOPServiceResolution, ReadingTwiceAppends) {
    SOPServiceConfiguration config;
    ASSERT_TRUE(config.readVesk(resolutionCases()));
    ASSERT_TRUE(config.readVesk(resolutionCases()));
    EXPECT_EQ(config.getSupportedTransferSyntaxList().getSupportedTransferSyntaxes().size(), 18u);
    const auto& templates =
        config.getTemplateTransferSyntaxLists().getTemplateTransferSyntaxLists();
    ASSERT_EQ(templates.size(), 14u);
    EXPECT_EQ(describe(templates[0].getTransferSyntaxList()), "2+ 1+ 2+ 1+");
    EXPECT_EQ(describe(templates[7].getTransferSyntaxList()), "2+ 1+");
    const auto& services = config.getSOPServiceList().getSOPServices();
    ASSERT_EQ(services.size(), 66u);
    // The first service took "Uncompressed" twice: once as read first, once as resolved again.
    EXPECT_EQ(describe(services[0]),
              "type=IMAGE enabled=1 template=Uncompressed: 2+ 1+ 2+ 1+ 2+ 1+");
    EXPECT_EQ(describe(services[33]), "type=IMAGE enabled=1 template=Uncompressed: 2+ 1+ 2+ 1+");
}

// A broken list logs its own failure and makes the read incomplete; the other lists are read and
// resolved all the same.
TEST(SOPServiceResolution, ABrokenListLogsItsClassAndTheRestResolves) {
    const struct {
        const char* key;
        const char* logged;
    } kBroken[] = {
        {"SupportedTxList", "SupportedTransferSyntaxList::readVesk: Failed. Standard Exception: "},
        {"TemplateTxLists", "TemplateTransferSyntaxLists::readVesk: Failed. Standard Exception: "},
        {"SOPServiceList", "SOPServiceList::readVesk: Failed. Standard Exception: "},
        {"FilterTagList", "FilterTagList::readVesk: Failed. Standard Exception: "},
    };
    for (const auto& broken : kBroken) {
        Vesk::Element notAList(broken.key, -1);
        notAList.addSingle().assign("text");
        Quorvex::Testing::LogCapture log;
        SOPServiceConfiguration config;
        EXPECT_FALSE(config.readVesk(Testing::withChild(resolutionCases(), broken.key, notAList)));
        ASSERT_EQ(log.records().size(), 1u) << broken.key;
        EXPECT_EQ(log.records()[0].text.rfind(broken.logged, 0), 0u) << log.records()[0].text;
        EXPECT_EQ(log.records()[0].priority, LM_ERROR);
        const bool servicesRead = std::string(broken.key) != "SOPServiceList";
        EXPECT_EQ(config.getSOPServiceList().getSOPServices().size(), servicesRead ? 33u : 0u);
    }
}

TEST(SOPServiceResolution, AServiceThatFailsToReadIsKeptAndLogged) {
    Vesk::Element tree("SOPServiceConfiguration", -1);
    Vesk::MultiElementValue& services = child(tree.addMultiElement(), "SOPServiceList");
    services.addElement("SOPService", {}, -1).addSingle().assign("not a service");
    Vesk::MultiElementValue& service = child(services, "SOPService");
    text(service, "Name", "no UID");
    text(service, "ObjectType", "SR");
    Quorvex::Testing::LogCapture log;
    SOPServiceConfiguration config;
    EXPECT_FALSE(config.readVesk(tree));
    EXPECT_TRUE(log.containsFragment("SOPService::readVesk: Failed. Standard Exception: "));
    const auto& read = config.getSOPServiceList().getSOPServices();
    ASSERT_EQ(read.size(), 2u);
    EXPECT_EQ(read[0], SOPService());
    EXPECT_EQ(read[1].getName(), "no UID");
    EXPECT_EQ(read[1].getObjectType(), SOPObjectTypeSR);
}

// A document made to hurt: many services, rows with repeated and extreme numbers, templates
// naming themselves, texts of random bytes. It reads without a crash, and every list holds each
// number at most once and only numbers of the table.
TEST(SOPServiceHostile, ManyServicesAndRandomTextsReadWithinTheirInvariants) {
    std::mt19937 random(20110517);
    const auto randomText = [&random](std::size_t length) {
        std::string value;
        for (std::size_t i = 0; i < length; ++i) {
            const char kAlphabet[] = "0123456789,; -aZ\xb2\xb9\xff";
            value += kAlphabet[random() % (sizeof kAlphabet - 1)];
        }
        return value;
    };
    Vesk::Element tree("SOPServiceConfiguration", -1);
    Vesk::MultiElementValue& root = tree.addMultiElement();
    Vesk::MultiElementValue& rows = child(root, "SupportedTxList");
    const int kNumbers[] = {0, 1, 2, 3, 7, 7, 12, 99, 2147483647, -2147483647 - 1, -1};
    for (int nr : kNumbers) {
        Vesk::MultiElementValue& row = child(rows, "SupportedTx");
        text(row, "TxNr", std::to_string(nr));
        text(row, "TxUID", randomText(20));
        text(row, "TxName", randomText(10));
    }
    Vesk::MultiElementValue& templates = child(root, "TemplateTxLists");
    for (int i = 0; i < 200; ++i) {
        Vesk::MultiElementValue& entry = child(templates, "TemplateTxList");
        text(entry, "TemplateName", "T" + std::to_string(i % 50));
        text(entry, "Additional", i % 3 == 0 ? "1" : "0");
        text(entry, "TxList", i % 7 == 0 ? "T" + std::to_string(i % 50) : randomText(i % 40));
    }
    Vesk::MultiElementValue& services = child(root, "SOPServiceList");
    constexpr int kServices = 100000;
    for (int i = 0; i < kServices; ++i) {
        Vesk::MultiElementValue& service = child(services, "SOPService");
        text(service, "UID", randomText(8));
        text(service, "Name", randomText(4));
        text(service, "ObjectType", randomText(3));
        text(service, "Additional", i % 2 == 0 ? "1" : "0");
        text(service, "TxListDefault",
             i % 4 == 0 ? "T" + std::to_string(i % 60) : randomText(random() % 24));
        if (i % 3 == 0) {
            text(service, "TxList", randomText(random() % 12));
        }
    }
    text(services, "SOPService", "a text, not a service");

    Quorvex::Testing::LogCapture log;
    SOPServiceConfiguration config;
    EXPECT_FALSE(config.readVesk(tree));  // "ReleaseDate" and the like are missing
    // the text that is no service
    EXPECT_TRUE(log.onlyStartsWith("SOPService::readVesk: Failed. Standard Exception: "));
    const auto& read = config.getSOPServiceList().getSOPServices();
    ASSERT_EQ(read.size(), kServices + 1u);
    const std::set<int> table(std::begin(kNumbers), std::end(kNumbers));
    for (const SOPService& service : read) {
        std::set<int> seen;
        for (const TransferSyntax& entry : service.getTransferSyntaxList().getTransferSyntaxes()) {
            EXPECT_TRUE(seen.insert(entry.getNr()).second) << describe(service);
            EXPECT_EQ(table.count(entry.getNr()), 1u);
        }
    }
}

}  // namespace
}  // namespace Configuration
