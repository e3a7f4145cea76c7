// Every configuration class against its sample documents in tests/data/classes: NAME.xml holds a
// value for every key (all different from the defaults), NAME.defaults.xml is what a default
// object writes. A new class adds its two samples and one row to kClasses. A read-only class
// (readOnlyRow: its writeVesk refuses with "NAME::writeVesk - Not supported.") has a defaults
// sample that reads complete into a default object; its keys without a fixed default (one that
// another key gives, or whose presence matters) are left out of it. A row's fatal keys are those
// whose absence is a logged failure that ends the read (withFatalKeys).
#include <gtest/gtest.h>

#include <functional>
#include <memory>
#include <set>
#include <string>

#include "Configuration/AnonParam.h"
#include "Configuration/ApplicationLocationConfiguration.h"
#include "Configuration/AutoExportConfiguration.h"
#include "Configuration/DMWLTarget.h"
#include "Configuration/DicomClientConfiguration.h"
#include "Configuration/KelArchiveConfiguration.h"
#include "Configuration/KelExportGlobalConfiguration.h"
#include "Configuration/KelExportLocalConfiguration.h"
#include "Configuration/KelExportRemoteConfigurations.h"
#include "Configuration/KelExportRemoteScp.h"
#include "Configuration/KelExportWebService.h"
#include "Configuration/KelQueryConfiguration.h"
#include "Configuration/LegacyMirrorStackMapping.h"
#include "Configuration/LocationConfiguration.h"
#include "Configuration/LocationMigrationChain.h"
#include "Configuration/OrvelSystemCommonConfiguration.h"
#include "Configuration/OrvelSystemConfiguration.h"
#include "Configuration/ProcessesAndServicesConfiguration.h"
#include "Configuration/QrscpConfiguration.h"
#include "Configuration/RulesConfiguration.h"
#include "Configuration/SOPServiceConfiguration.h"
#include "Configuration/SSCPConfiguration.h"
#include "Configuration/ServerInfo.h"
#include "Configuration/StorageCommitConfiguration.h"
#include "Configuration/StrategyConfiguration.h"
#include "ElementTestSupport.h"
#include "Vesk/XmlUtils.h"
#include "testing/FakeMachine.h"
#include "testing/LogCapture.h"

namespace Configuration {
namespace {

const char kFailed[] = "::readVesk: Failed. Standard Exception: ";
const char kPartialDefaults[] = "::readVesk: Failed - Using partial defaults. Standard Exception: ";

struct ClassRow {
    std::string name;                    // the class: its samples' stem and its log name
    const char* failureForm;             // what its read-failure log line says after the name
    std::set<std::string> optionalKeys;  // keys whose absence does not make the read incomplete
    std::function<std::unique_ptr<Vesk::Serializable>()> make;
    std::function<bool(const Vesk::Serializable&, const Vesk::Serializable&)> equal;
    bool writes = true;                 // false: writeVesk refuses
    std::string refusal;                // what writeVesk refuses with, when it does
    std::set<std::string> fatalKeys;    // absent: a logged failure that ends the read
    std::set<std::string> emptiedKeys;  // lists whose absence empties a non-empty default
};

template <class T>
ClassRow row(const char* name, const char* failureForm, std::set<std::string> optionalKeys = {}) {
    return ClassRow{name,
                    failureForm,
                    std::move(optionalKeys),
                    [] { return std::make_unique<T>(); },
                    [](const Vesk::Serializable& a, const Vesk::Serializable& b) {
                        return dynamic_cast<const T&>(a) == dynamic_cast<const T&>(b);
                    },
                    true,
                    "",
                    {},
                    {}};
}

template <class T>
ClassRow readOnlyRow(const char* name, std::set<std::string> optionalKeys = {},
                     const char* refusal = nullptr) {
    ClassRow r = row<T>(name, kFailed, std::move(optionalKeys));
    r.writes = false;
    r.refusal = refusal != nullptr ? refusal : name + std::string("::writeVesk - Not supported.");
    return r;
}

ClassRow withFatalKeys(ClassRow r, std::set<std::string> fatalKeys) {
    r.fatalKeys = std::move(fatalKeys);
    return r;
}

ClassRow withEmptiedKeys(ClassRow r, std::set<std::string> emptiedKeys) {
    r.emptiedKeys = std::move(emptiedKeys);
    return r;
}

const ClassRow kClasses[] = {
    row<AnonParam>("AnonParam", kFailed),
    row<RestartConfiguration__>("RestartConfiguration__", kPartialDefaults),
    row<VariationPointConfiguration__>("VariationPointConfiguration__", kPartialDefaults),
    row<StackConfiguration__>("StackConfiguration__", kPartialDefaults),
    row<OrvelSystemConfiguration>("OrvelSystemConfiguration", kPartialDefaults, {"CORBAEndpoints"}),
    readOnlyRow<SupportedTransferSyntax>("SupportedTransferSyntax", {"TxDescription"}),
    readOnlyRow<SupportedTransferSyntaxList>("SupportedTransferSyntaxList", {"SupportedTx"}),
    readOnlyRow<TemplateTransferSyntaxList>("TemplateTransferSyntaxList",
                                            {"TemplateDescription", "Additional", "TxList"}),
    readOnlyRow<TemplateTransferSyntaxLists>("TemplateTransferSyntaxLists", {"TemplateTxList"}),
    readOnlyRow<SOPService>("SOPService", {"Description", "Additional", "EnabledDefault", "Enabled",
                                           "TxListDefault", "TxList"}),
    readOnlyRow<SOPServiceList>("SOPServiceList", {"SOPService"}),
    readOnlyRow<FilterTag>("FilterTag", {"TagName", "SOPClassUID", "SOPClassName", "Additional"}),
    readOnlyRow<FilterTagList>("FilterTagList", {"FilterTag"}),
    readOnlyRow<SOPServiceConfiguration>(
        "SOPServiceConfiguration",
        {"SupportedTxList", "TemplateTxLists", "SOPServiceList", "FilterTagList"}),
    row<SOPClass>("SOPClass", kFailed),
    row<DMWLTarget>("DMWLTarget", kFailed),
    row<DicomClientConfiguration>("DicomClientConfiguration", kFailed),
    row<RemoteSCPConfiguration>("RemoteSCPConfiguration", kFailed),
    withFatalKeys(row<StorageCommitScpConfiguration>("StorageCommitScpConfiguration", kFailed),
                  {"RemoteScp"}),
    withFatalKeys(
        row<StorageCommitRemoteSCPConfiguration>("StorageCommitRemoteSCPConfiguration", kFailed),
        {"RemoteScp"}),
    withFatalKeys(row<StorageCommitConfiguration>("StorageCommitConfiguration", kFailed),
                  {"StorageCommitRemoteConfigurations"}),
    withFatalKeys(
        row<KelExportRemoteScp>("KelExportRemoteScp", kFailed,
                                {"ForwardImages", "ForwardMPPS", "StorageCommitScpConfiguration"}),
        {"RemoteScp"}),
    row<ServerDicomSource>("ServerDicomSource", kFailed),
    row<SSCPConfiguration>("SSCPConfiguration",
                           "::readVesk: Failed - using partial defaults. Standard Exception: "),
    row<QrscpConfiguration>("QrscpConfiguration", kFailed),
    row<KelExportDatabaseConfiguration>("KelExportDatabaseConfiguration", kFailed),
    withFatalKeys(row<KelExportGlobalConfiguration>("KelExportGlobalConfiguration", kFailed),
                  {"AnonymizationParams"}),
    row<KelExportLocalConfiguration>("KelExportLocalConfiguration", kFailed),
    withFatalKeys(row<KelExportRemoteConfigurations>("KelExportRemoteConfigurations", kFailed),
                  {"KelExportRemoteSCPs"}),
    row<KelExportWebService>("KelExportWebService", kFailed),
    readOnlyRow<Destination>("Destination", {},
                             "Criterion::writeVesk - Class cannot be serialized."),
    readOnlyRow<AutoExportRule>("AutoExportRule", {},
                                "AutoExportRule::writeVesk - Class cannot be serialized."),
    withFatalKeys(readOnlyRow<AutoExportConfiguration>(
                      "AutoExportConfiguration", {},
                      "AutoExportConfiguration::writeVesk - Class cannot be serialized."),
                  {"AutoExportRules"}),
    withFatalKeys(row<KelQueryRemoteSCPConfiguration>("KelQueryRemoteSCPConfiguration", kFailed),
                  {"RemoteScp", "QueryModel"}),
    row<PrefetchConfiguration__>("PrefetchConfiguration__", kFailed),
    withFatalKeys(row<KelQueryConfiguration>("KelQueryConfiguration", kFailed, {"Prefetch"}),
                  {"Archives"}),
    row<LegacyMirrorStackMapping>("LegacyMirrorStackMapping", kFailed),
    row<Strategy>("Strategy", kFailed),
    row<StrategyStack>("StrategyStack", kFailed),
    row<StrategyConfiguration>("StrategyConfiguration", kFailed),
    row<MigrationRule>("MigrationRule", kPartialDefaults, {"Filter"}),
    row<RegistrationRule>("RegistrationRule", kPartialDefaults),
    row<LocationMigrationFilter>("LocationMigrationFilter", kFailed, {"MigrationRule"}),
    row<LocationMigrationChain>("LocationMigrationChain", kFailed, {"MigrationChain"}),
    row<RulesConfiguration>("RulesConfiguration", kFailed),
    row<TivoliServerInfo>("TivoliServerInfo", kFailed),
    row<TivoliNodeInfo>("TivoliNodeInfo", kFailed),
    row<ArchiveLocalNodeInfo>("ArchiveLocalNodeInfo", kFailed),
    row<ArchiveNodeStackInfo>("ArchiveNodeStackInfo", kFailed),
    withFatalKeys(row<KelArchiveConfiguration>("KelArchiveConfiguration", kFailed),
                  {"TivoliServers"}),
    row<LocationProfile>("LocationProfile", kFailed,
                         {"LocalServers", "CollectIpFilters", "MergeTraceLevels"}),
    row<LocationConfiguration>("LocationConfiguration", kFailed),
    withEmptiedKeys(row<ProcessesAndServicesConfiguration>("ProcessesAndServicesConfiguration",
                                                           kFailed, {"ModuleType", "Process"}),
                    {"Process"}),
    row<OrvelSystemCommonConfiguration>("OrvelSystemCommonConfiguration", kFailed),
    row<SolutionDefinition>("SolutionDefinition", kPartialDefaults),
    row<ProductDefinition>("ProductDefinition", kPartialDefaults),
    row<ProductDefinitions>("ProductDefinitions", kFailed, {"ProductDefinition"}),
    row<ApplicationDefinition>("ApplicationDefinition", kPartialDefaults),
    row<ApplicationDefinitions>("ApplicationDefinitions", kPartialDefaults,
                                {"ApplicationDefinition"}),
    row<ApplicationLocationConfiguration>("ApplicationLocationConfiguration", kFailed),
    row<ServerInfo>("ServerInfo", kFailed,
                    {"MasterAddress", "Version", "StoreDirectory", "ItemCount",
                     "RegisteredServices", "StartTime", "UptimeSeconds", "Port"}),
};

// The children of element with that key, in order.
std::vector<Vesk::Element> childrenWith(const Vesk::Element& element, const ACE_CString& key) {
    std::vector<Vesk::Element> found;
    for (const Vesk::Element& child : element.getMultiElement()) {
        if (child.key() == key) {
            found.push_back(child);
        }
    }
    return found;
}

// Samples were written on a machine with drives C: and D: (the stack section's defaults).
class ClassSamples : public testing::TestWithParam<ClassRow> {
protected:
    ClassSamples() { m_machine.drives = {"C:\\", "D:\\"}; }
    const ClassRow& c() const { return GetParam(); }

    Quorvex::Testing::FakeMachine m_machine;
    Quorvex::ScopedMachine m_scoped{m_machine};
    const Vesk::Element m_sample = Testing::sampleDocument(GetParam().name + ".xml");
};

// A read-only class refuses to write with its fixed text.
void expectWriteRefused(const ClassRow& c, const Vesk::Serializable& object) {
    try {
        object.writeVesk();
        ADD_FAILURE() << c.name << " wrote itself";
    } catch (const std::exception& e) {
        EXPECT_EQ(c.refusal, e.what());
    }
}

TEST_P(ClassSamples, SampleReadsCompleteAndWritesBackUnchanged) {
    auto object = c().make();
    ASSERT_TRUE(object->readVesk(m_sample));
    if (!c().writes) {
        EXPECT_FALSE(c().equal(*object, *c().make()));
        expectWriteRefused(c(), *object);
        return;
    }
    EXPECT_EQ(Vesk::XmlUtils::toString(m_sample), Vesk::XmlUtils::toString(*object->writeVesk()));
    auto again = c().make();
    EXPECT_TRUE(again->readVesk(*object->writeVesk()));
    EXPECT_TRUE(c().equal(*again, *object));
    EXPECT_FALSE(c().equal(*object, *c().make()));  // the sample differs from the defaults
}

TEST_P(ClassSamples, DefaultObjectWritesTheDefaultsSample) {
    if (!c().writes) {
        auto object = c().make();
        EXPECT_TRUE(object->readVesk(Testing::sampleDocument(c().name + ".defaults.xml")));
        EXPECT_TRUE(c().equal(*object, *c().make()));
        expectWriteRefused(c(), *c().make());
        return;
    }
    EXPECT_EQ(Vesk::XmlUtils::toString(Testing::sampleDocument(c().name + ".defaults.xml")),
              Vesk::XmlUtils::toString(*c().make()->writeVesk()));
}

// A read-only class without the key left: equal to one read from the sample whose left key holds
// what the defaults sample holds.
void expectReadOnlyKeepsDefault(const ClassRow& c, const Vesk::Element& sample,
                                const Vesk::Serializable& object, const ACE_CString& left) {
    Vesk::Element expected = Testing::withoutChild(sample, left.c_str());
    const Vesk::Element defaults = Testing::sampleDocument(c.name + ".defaults.xml");
    for (const Vesk::Element& child : childrenWith(defaults, left)) {
        expected.getMultiElement().addElement(child);
    }
    auto reference = c.make();
    reference->readVesk(expected);
    EXPECT_TRUE(c.equal(object, *reference)) << "without " << left.c_str();
}

// Without a fatal key the read fails with the class's logged failure.
void expectFatal(const ClassRow& c, const Vesk::Element& partial, const ACE_CString& left) {
    Quorvex::Testing::LogCapture log;
    EXPECT_FALSE(c.make()->readVesk(partial)) << left.c_str();
    ASSERT_EQ(1u, log.records().size()) << left.c_str();
    EXPECT_EQ(0u, log.records()[0].text.rfind(c.name + c.failureForm, 0)) << left.c_str();
}

// Each key left out in turn: it keeps its default, every other key is still read, and the read
// reports the document incomplete unless the key is optional.
TEST_P(ClassSamples, EachMissingKeyKeepsItsDefaultAndTheRestIsRead) {
    const Quorvex::auto_ptr<Vesk::Element> defaults =
        c().writes ? c().make()->writeVesk() : Quorvex::auto_ptr<Vesk::Element>();
    std::vector<ACE_CString> keys;
    for (const Vesk::Element& child : m_sample.getMultiElement()) {
        if (keys.empty() || keys.back() != child.key()) {
            keys.push_back(child.key());
        }
    }
    for (const ACE_CString& left : keys) {
        Vesk::Element partial(m_sample.key(), -1);
        Vesk::MultiElementValue& children = partial.addMultiElement();
        for (const Vesk::Element& other : m_sample.getMultiElement()) {
            if (other.key() != left) {
                children.addElement(other);
            }
        }
        auto object = c().make();
        if (c().fatalKeys.count(left.c_str()) == 1) {
            expectFatal(c(), partial, left);
            continue;
        }
        EXPECT_EQ(c().optionalKeys.count(left.c_str()) == 1, object->readVesk(partial))
            << left.c_str();
        if (!c().writes) {
            expectReadOnlyKeepsDefault(c(), m_sample, *object, left);
            continue;
        }
        const Quorvex::auto_ptr<Vesk::Element> written = object->writeVesk();
        std::size_t expectedCount = 0;
        Vesk::Element emptied(m_sample.key(), -1);
        emptied.addMultiElement();
        for (const ACE_CString& key : keys) {
            const bool empties = key == left && c().emptiedKeys.count(left.c_str()) == 1;
            const Vesk::Element& expected = empties ? emptied : key == left ? *defaults : m_sample;
            expectedCount += childrenWith(expected, key).size();
            EXPECT_EQ(childrenWith(expected, key), childrenWith(*written, key))
                << "without " << left.c_str() << ", key " << key.c_str();
        }
        EXPECT_EQ(expectedCount, written->getMultiElement().size()) << left.c_str();
    }
}

TEST_P(ClassSamples, ElementOfAnotherKindLogsTheClassFailureAndKeepsDefaults) {
    Quorvex::Testing::LogCapture log;
    Vesk::Element notAList(m_sample.key(), -1);
    notAList.insertAttributes(m_sample.attributes());  // a rule's name, say, is still there
    notAList.addSingle().assign("text");
    auto object = c().make();
    EXPECT_FALSE(object->readVesk(notAList));
    EXPECT_TRUE(c().equal(*object, *c().make()));
    ASSERT_EQ(1u, log.records().size());
    EXPECT_EQ(LM_ERROR, log.records()[0].priority);
    EXPECT_EQ(0u, log.records()[0].text.rfind(c().name + c().failureForm, 0))
        << log.records()[0].text;
}

INSTANTIATE_TEST_SUITE_P(Classes, ClassSamples, testing::ValuesIn(kClasses),
                         [](const testing::TestParamInfo<ClassRow>& info) {
                             return info.param.name;
                         });

}  // namespace
}  // namespace Configuration
