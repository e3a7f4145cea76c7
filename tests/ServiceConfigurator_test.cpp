// The service-configurator text of a processes table, processed by ACE's real service
// configurator in this process: a small service module (tests/probe/echo_service.cpp) is loaded
// for the enabled services of the selected process, initialised with their arguments, and not
// for disabled services or unselected processes. Malformed directives are refused without harm.
#include <ace/Service_Config.h>
#include <ace/Service_Object.h>
#include <ace/Service_Repository.h>
#include <ace/Service_Types.h>
#include <gtest/gtest.h>

#include <string>

#include "Configuration/ProcessesAndServicesConfiguration.h"

namespace Configuration {
namespace {

using Process = ProcessesAndServicesConfiguration::Process;
using Service = ProcessesAndServicesConfiguration::Service;

ACE_CString dynamicEcho(const char* name, const char* arguments) {
    ACE_CString text = ACE_CString("dynamic ") + name + " Service_Object * " + ECHO_SERVICE_MODULE +
                       ":_make_" + name + "()";
    if (*arguments != '\0') {
        text += ACE_CString(" \"") + arguments + "\"";
    }
    return text;
}

// What the loaded service of that name reports, or "(not loaded)".
std::string loaded(const char* name) {
    const ACE_Service_Type* type = nullptr;
    if (ACE_Service_Repository::instance()->find(name, &type) != 0 || type == nullptr) {
        return "(not loaded)";
    }
    const auto* object = static_cast<const ACE_Service_Object*>(type->type()->object());
    ACE_TCHAR* text = nullptr;
    object->info(&text, 0);
    const std::string result = text;
    delete[] text;
    return result;
}

// A machine with the module's services in a selected and an unselected process; the removal of
// every echo service after each test keeps ACE's repository as it was.
class ServiceConfigurator : public ::testing::Test {
protected:
    ServiceConfigurator() {
        Process imaging("Imaging", "imaging.exe", ModuleTypes::kStorageServer);
        imaging.addService(Service("Echo one", dynamicEcho("EchoOne", "-Port 104 -Mode on")));
        imaging.addService(Service("Echo two", dynamicEcho("EchoTwo", "-Port 105"), 0));
        Process other("Other", "other.exe", ModuleTypes::kExportServer);
        other.setState(0);
        other.addService(Service("Echo three", dynamicEcho("EchoThree", "")));
        Process bare("Bare", "bare.exe", ModuleTypes::kWebServer);
        config.setProcesses({imaging, other, bare});
    }
    ~ServiceConfigurator() override {
        for (const char* name : {"EchoOne", "EchoTwo", "EchoThree", "Broken"}) {
            ACE_Service_Config::remove(name);
        }
    }

    ProcessesAndServicesConfiguration config;
};

TEST_F(ServiceConfigurator, TheEnabledServiceIsLoadedWithItsArgumentsTheOthersAreNot) {
    const ACE_CString directives = config.getServiceDirectives("Imaging");
    // What a process loads is exactly its part of the machine's service information.
    const std::string info = config.getServiceInfo().c_str();
    EXPECT_EQ("Imaging\r\n" + std::string(directives.c_str()) + "Bare\r\n", info);
    EXPECT_EQ(0, ACE_Service_Config::process_directive(directives.c_str()));
    EXPECT_EQ("initialised -Port 104 -Mode on", loaded("EchoOne"));
    EXPECT_EQ("(not loaded)", loaded("EchoTwo"));
    EXPECT_EQ("(not loaded)", loaded("EchoThree"));
}

TEST_F(ServiceConfigurator, AProcessWithoutServicesLoadsNothing) {
    const ACE_CString directives = config.getServiceDirectives("Bare");
    EXPECT_EQ(0u, directives.length());
    EXPECT_EQ(0, ACE_Service_Config::process_directive(directives.c_str()));
    EXPECT_EQ("(not loaded)", loaded("EchoOne"));
}

struct MalformedRow {
    const char* name;
    const char* definition;
    bool counted;  // the configurator counts it as an error (else it only logs a syntax error)
    const char* broken = "(not loaded)";  // what runs under the name Broken afterwards
};

// Directives an administrator could type wrong: the configurator refuses them (an unclosed
// argument string is counted, yet the service starts without its arguments: worth a look in
// configctl services before a restart), and it still loads a good directive afterwards.
const MalformedRow kMalformed[] = {
    {"MissingLibrary", "dynamic Broken Service_Object * NoSuchLibrary:_make_Broken() \"-x\"", true},
    {"MissingFactory", "dynamic Broken Service_Object * " ECHO_SERVICE_MODULE ":_make_Broken()",
     true},
    {"StaticUnknown", "static Broken", true},
    {"UnknownKeyword", "dynamo Broken Service_Object * " ECHO_SERVICE_MODULE ":_make_EchoTwo()",
     false},
    {"NoServiceName", "dynamic Service_Object * " ECHO_SERVICE_MODULE ":_make_EchoTwo()", false},
    {"UnclosedArguments",
     "dynamic Broken Service_Object * " ECHO_SERVICE_MODULE ":_make_EchoTwo() \"-x", true,
     "initialised"},
};

class MalformedDirectives : public ServiceConfigurator,
                            public testing::WithParamInterface<MalformedRow> {};

TEST_P(MalformedDirectives, LoadNothingAndLeaveTheConfiguratorUsable) {
    Process p("Typo", "typo.exe");
    p.addService(Service("Broken", GetParam().definition));
    config.setProcesses({p});
    const int errors =
        ACE_Service_Config::process_directive(config.getServiceDirectives("Typo").c_str());
    EXPECT_EQ(GetParam().counted, errors != 0) << errors;
    EXPECT_EQ(GetParam().broken, loaded("Broken"));
    EXPECT_EQ(0, ACE_Service_Config::process_directive(
                     (dynamicEcho("EchoOne", "-Port 104") + "\r\n").c_str()));
    EXPECT_EQ("initialised -Port 104", loaded("EchoOne"));
}

INSTANTIATE_TEST_SUITE_P(Rows, MalformedDirectives, testing::ValuesIn(kMalformed),
                         [](const testing::TestParamInfo<MalformedRow>& info) {
                             return info.param.name;
                         });

}  // namespace
}  // namespace Configuration
