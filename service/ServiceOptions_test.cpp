// Command-line options of the service.
#include "ServiceOptions.h"

#include <gtest/gtest.h>

#include <stdexcept>

namespace ConfigurationService {
namespace {

TEST(ServiceOptions, ReadsEveryOptionInBothForms) {
    const ServiceOptions options =
        ServiceOptions::parse({"--port=0", "--store-dir", "/s", "--host-name", "Slave1", "--master",
                               "10.0.0.1:81", "--event-dir", "/e", "--max-body-bytes", "4096",
                               "--threads", "8", "--log-level", "debug"});
    EXPECT_EQ(options.port, 0);
    EXPECT_EQ(options.storeDirectory, "/s");
    EXPECT_EQ(options.hostName, "Slave1");
    EXPECT_EQ(options.masterAddress, "10.0.0.1:81");
    EXPECT_EQ(options.eventDirectory, "/e");
    EXPECT_EQ(options.maxBodyBytes, 4096u);
    EXPECT_EQ(options.threads, 8);
    EXPECT_EQ(options.logLevel, "debug");
}

TEST(ServiceOptions, RefusesBadOptionsWithOneLine) {
    EXPECT_THROW(ServiceOptions::parse({"--port", "70000"}), std::invalid_argument);
    EXPECT_THROW(ServiceOptions::parse({"--port"}), std::invalid_argument);
    EXPECT_THROW(ServiceOptions::parse({"--threads", "x"}), std::invalid_argument);
    EXPECT_THROW(ServiceOptions::parse({"--log-level", "loud"}), std::invalid_argument);
    EXPECT_THROW(ServiceOptions::parse({"--frobnicate"}), std::invalid_argument);
}

TEST(ServiceOptions, HelpListsEveryOption) {
    const std::string usage = ServiceOptions::usage("configuration-service");
    for (const char* option : {"--bind", "--port", "--port-file", "--store-dir", "--host-name",
                               "--master", "--master-name", "--event-dir", "--max-body-bytes",
                               "--threads", "--keep-alive", "--log-level", "--help"}) {
        EXPECT_NE(usage.find(option), std::string::npos) << option;
    }
    EXPECT_TRUE(ServiceOptions::parse({"--help"}).help);
}

}  // namespace
}  // namespace ConfigurationService
