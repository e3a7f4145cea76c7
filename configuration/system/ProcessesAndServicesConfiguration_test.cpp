// The processes table's own logic: validation, the service-configurator text, the nested keys,
// the default table and the process-wide values. Keys, order and defaults of the document are the
// samples' job (ClassSamples).
#include <gtest/gtest.h>

#include <set>
#include <sstream>
#include <string>

#include "Configuration/ProcessesAndServicesConfiguration.h"
#include "ElementTestSupport.h"
#include "testing/LogCapture.h"

namespace Configuration {
namespace {

using Process = ProcessesAndServicesConfiguration::Process;
using Service = ProcessesAndServicesConfiguration::Service;

const char kExport[] = "dynamic KelExportService Service_Object * X:_make_KelExportService()";

Process process(const char* name, int state, std::vector<Service> services) {
    Process p(name);
    p.setState(state);
    p.setServices(services);
    return p;
}

ProcessesAndServicesConfiguration table(std::vector<Process> processes) {
    ProcessesAndServicesConfiguration config;
    config.setProcesses(processes);
    return config;
}

struct ValidityRow {
    const char* name;
    std::vector<Process> processes;
    const char* reason;  // null: valid
};

const ValidityRow kValidity[] = {
    {"EmptyTable", {}, "No process is selected"},
    {"NothingSelected", {process("A", 0, {}), process("B", 0, {})}, "No process is selected"},
    {"SelectedWithoutServices", {process("A", 0, {}), process("B", 7, {})}, nullptr},
    {"BothExportServicesInOneProcess",
     {process("A", 1, {Service("KelExport Service", kExport), Service("Qrscp KelExport Service")})},
     "KelExport and QRSCP KelExport may not run on the same server"},
    {"BothAcrossProcessesNamesIgnoringCase",
     {process("A", 1, {Service("kelexport service")}),
      process("B", 1, {Service("QRSCP KELEXPORT SERVICE")})},
     "KelExport and QRSCP KelExport may not run on the same server"},
    {"OneDisabled",
     {process("A", 1, {Service("KelExport Service"), Service("Qrscp KelExport Service", "", 0)})},
     nullptr},
    {"OneInAnUnselectedProcess",
     {process("A", 1, {Service("KelExport Service")}),
      process("B", 0, {Service("Qrscp KelExport Service")})},
     nullptr},
    {"QrscpExportAlone", {process("A", 1, {Service("Qrscp KelExport Service")})}, nullptr},
};

class Validity : public testing::TestWithParam<ValidityRow> {};

TEST_P(Validity, ReasonAndResult) {
    ACE_CString reason = "unchanged";
    const bool valid = table(GetParam().processes).isValid(reason);
    EXPECT_EQ(GetParam().reason == nullptr, valid);
    EXPECT_EQ(GetParam().reason == nullptr ? "unchanged" : GetParam().reason,
              std::string(reason.c_str()));
}

INSTANTIATE_TEST_SUITE_P(Table, Validity, testing::ValuesIn(kValidity),
                         [](const testing::TestParamInfo<ValidityRow>& info) {
                             return info.param.name;
                         });

TEST(ProcessesAndServices, ServiceInfoListsSelectedProcessesAndTheirEnabledServices) {
    ProcessesAndServicesConfiguration config;
    ASSERT_TRUE(config.readVesk(Testing::sampleDocument("ProcessesAndServicesConfiguration.xml")));
    config.addProcess(process("Idle", 0, {Service("Never", "static Never")}));
    config.addProcess(process("Bare", 2, {}));
    EXPECT_EQ(std::string("QuorvexWebServer\r\n"
                          "\tdynamic ViewerService Service_Object * QuorvexViewer:_make_"
                          "ViewerService() \"-Sessions 40\"\r\n"
                          "QuorvexReportServer\r\n"
                          "Bare\r\n"),
              config.getServiceInfo().c_str());
    EXPECT_EQ(std::string("\tdynamic ViewerService Service_Object * QuorvexViewer:_make_"
                          "ViewerService() \"-Sessions 40\"\r\n"),
              config.getServiceDirectives("QuorvexWebServer").c_str());
    EXPECT_EQ(0u, config.getServiceDirectives("Bare").length());
    EXPECT_EQ(0u, config.getServiceDirectives("Idle").length());
    EXPECT_EQ(0u, config.getServiceDirectives("quorvexwebserver").length());  // exact names
}

// Each key of a process and of a service left out in turn: the key keeps its default, the rest
// is read, and the document reads incomplete.
TEST(ProcessesAndServices, MissingNestedKeysKeepDefaultsAndMakeTheReadIncomplete) {
    const Vesk::Element sample = Testing::sampleDocument("ProcessesAndServicesConfiguration.xml");
    const Vesk::Element& web = *sample.getMultiElement().begin("Process");
    const Vesk::Element& viewer = *web.getMultiElement().begin("Service");
    for (const char* key : {"ServiceName", "State", "Definition"}) {
        Process p;
        ASSERT_TRUE(p.readVesk(web));
        Vesk::Element partialWeb =
            Testing::withChild(web, "Service", Testing::withoutChild(viewer, key));
        EXPECT_FALSE(p.readVesk(partialWeb)) << key;
        ASSERT_EQ(2u, p.getServices().size()) << key;  // both services are the partial one
        const Service& read = p.getServices()[0];
        EXPECT_EQ(std::string(key) == "State" ? 1 : 2, read.getState()) << key;
        EXPECT_EQ(std::string(key) == "ServiceName", read.getServiceName().length() == 0) << key;
        EXPECT_EQ(std::string(key) == "Definition", read.getDefinition().length() == 0) << key;
    }
    for (const char* key : {"ProcessName", "State", "ModuleType", "Singleton", "Executable"}) {
        Process p;
        EXPECT_FALSE(p.readVesk(Testing::withoutChild(web, key))) << key;
        EXPECT_EQ(2u, p.getServices().size()) << key;
        EXPECT_EQ(std::string(key) == "ModuleType" ? 0u : 5u, p.getModuleType()) << key;
        EXPECT_EQ(std::string(key) == "ProcessName", p.getProcessName().length() == 0) << key;
    }
    ProcessesAndServicesConfiguration withoutModuleType;
    EXPECT_TRUE(withoutModuleType.readVesk(Testing::withoutChild(sample, "ModuleType")));
    EXPECT_EQ(2u, withoutModuleType.getProcesses().size());
    ProcessesAndServicesConfiguration withoutProcesses;
    EXPECT_TRUE(withoutProcesses.readVesk(Testing::withoutChild(sample, "Process")));
    EXPECT_TRUE(withoutProcesses.getProcesses().empty());  // the default table is replaced
}

// Whether text is "static NAME" or "dynamic NAME Service_Object * LIBRARY:_make_NAME()" with
// optional arguments in one pair of double quotes.
bool isDirective(const std::string& text) {
    std::istringstream in(text);
    std::string word, name, kind, star, location, rest;
    in >> word >> name;
    if (word == "static") {
        return !name.empty() && (in >> std::ws).eof();
    }
    in >> kind >> star >> location;
    std::getline(in, rest);
    const auto colon = location.find(':');
    const bool arguments =
        rest.size() > 3 && rest.compare(0, 2, " \"") == 0 && rest.find('"', 2) == rest.size() - 1;
    return word == "dynamic" && kind == "Service_Object" && star == "*" &&
           colon != std::string::npos && colon > 0 &&
           location.substr(colon + 1) == "_make_" + name + "()" && (rest.empty() || arguments);
}

TEST(ProcessesAndServices, DefaultTableIsAValidSingleServer) {
    const ProcessesAndServicesConfiguration config;
    ACE_CString reason;
    EXPECT_TRUE(config.isValid(reason)) << reason.c_str();
    EXPECT_TRUE(config.isLocal());
    EXPECT_EQ(std::string("BrimmetServer\\ProcessesAndServices"), config.path().c_str());
    std::multiset<std::string> arguments;
    std::set<std::string> processNames;
    for (const Process& p : config.getProcesses()) {
        EXPECT_TRUE(processNames.insert(p.getProcessName().c_str()).second);
        EXPECT_NE(ModuleTypes::kNone, p.getModuleType()) << p.getProcessName().c_str();
        for (const Service& s : p.getServices()) {
            const std::string definition = s.getDefinition().c_str();
            EXPECT_TRUE(isDirective(definition)) << definition;
            const auto quote = definition.find('"');
            if (quote != std::string::npos) {
                arguments.insert(definition.substr(quote + 1, definition.size() - quote - 2));
            }
        }
    }
    for (const char* set :
         {"-ArchiveMode off", "-ArchiveMode on", "-ArchiveMode off -AutoDelete off",
          "-ArchiveMode off -AutoDelete all", "-ArchiveMode on -UpdateArchive on -AutoDelete off",
          "-ArchiveMode off -AutoDelete migrated-only", "-DuplicateMerge", "-QrscpMode on",
          "-ORBThreads 2 -ORBListenEndpoints iiop://:6465/ssl_port=7576 "
          "-ORBDottedDecimalAddresses 1",
          "-ORBThreads 5 -ORBListenEndpoints iiop://:6464/ssl_port=7575 "
          "-ORBDottedDecimalAddresses 1"}) {
        EXPECT_EQ(1u, arguments.count(set)) << set;
    }
    const std::string info = config.getServiceInfo().c_str();
    EXPECT_EQ(std::string::npos, info.find("QuorvexArchiveServer"));  // not selected
    EXPECT_EQ(std::string::npos, info.find("-QrscpMode on"));         // disabled
    EXPECT_NE(std::string::npos, info.find("\tstatic HeartbeatService\r\n"));
}

// Restores the process-wide values a test changed.
class ProcessWide : public testing::Test {
protected:
    ~ProcessWide() override {
        ProcessesAndServicesConfiguration::setModuleType(m_moduleType);
        ProcessesAndServicesConfiguration::setProcessName(m_name);
    }
    const unsigned int m_moduleType = ProcessesAndServicesConfiguration::getModuleType();
    const ACE_CString m_name = ProcessesAndServicesConfiguration::getProcessName();
};

TEST_F(ProcessWide, ModuleTypeAndProcessNameAreKeptForTheProcessAndNameNewDocuments) {
    ProcessesAndServicesConfiguration::setModuleType(ModuleTypes::kWebServer);
    ProcessesAndServicesConfiguration::setProcessName("QuorvexWebServer");
    EXPECT_EQ(ModuleTypes::kWebServer, ProcessesAndServicesConfiguration::getModuleType());
    EXPECT_EQ(std::string("QuorvexWebServer"),
              ProcessesAndServicesConfiguration::getProcessName().c_str());
    const ProcessesAndServicesConfiguration written;
    EXPECT_EQ(ModuleTypes::kWebServer, written.getDocumentModuleType());
    EXPECT_EQ(ACE_CString("5"),
              written.writeVesk()->getMultiElement().getElement("ModuleType").getSingle().value());
    // Reading a document does not change what the process is.
    ProcessesAndServicesConfiguration read;
    ASSERT_TRUE(read.readVesk(Testing::sampleDocument("ProcessesAndServicesConfiguration.xml")));
    EXPECT_EQ(ModuleTypes::kWebServer, ProcessesAndServicesConfiguration::getModuleType());
}

}  // namespace
}  // namespace Configuration
