// Command-line options of the service.
#include "ServiceOptions.h"

#include <gtest/gtest.h>

#include <stdexcept>

namespace ConfigurationService {
namespace {

TEST(ServiceOptions, ReadsEveryOptionInBothForms) {
    const ServiceOptions options = ServiceOptions::parse({"--port=0",
                                                          "--store-dir",
                                                          "/s",
                                                          "--host-name",
                                                          "Slave1",
                                                          "--master",
                                                          "10.0.0.1:81",
                                                          "--event-dir",
                                                          "/e",
                                                          "--max-body-bytes",
                                                          "4096",
                                                          "--threads",
                                                          "8",
                                                          "--log-level",
                                                          "debug",
                                                          "--io-threads",
                                                          "3",
                                                          "--request-timeout=7",
                                                          "--max-connections",
                                                          "50",
                                                          "--max-connections-per-peer",
                                                          "20",
                                                          "--max-body-memory",
                                                          "8192"});
    EXPECT_EQ(options.port, 0);
    EXPECT_EQ(options.storeDirectory, "/s");
    EXPECT_EQ(options.hostName, "Slave1");
    EXPECT_EQ(options.masterAddress, "10.0.0.1:81");
    EXPECT_EQ(options.eventDirectory, "/e");
    EXPECT_EQ(options.maxBodyBytes, 4096u);
    EXPECT_EQ(options.threads, 8);
    EXPECT_EQ(options.logLevel, "debug");
    EXPECT_EQ(options.ioThreads, 3);
    EXPECT_EQ(options.requestTimeoutSeconds, 7);
    EXPECT_EQ(options.maxConnections, 50);
    EXPECT_EQ(options.maxConnectionsPerPeer, 20);
    EXPECT_EQ(options.maxBodyMemory, 8192u);
}

TEST(ServiceOptions, RefusesBadOptionsWithOneLine) {
    EXPECT_THROW(ServiceOptions::parse({"--port", "70000"}), std::invalid_argument);
    EXPECT_THROW(ServiceOptions::parse({"--port"}), std::invalid_argument);
    EXPECT_THROW(ServiceOptions::parse({"--threads", "x"}), std::invalid_argument);
    EXPECT_THROW(ServiceOptions::parse({"--max-connections-per-peer", "0"}), std::invalid_argument);
    EXPECT_THROW(ServiceOptions::parse({"--request-timeout", "0"}), std::invalid_argument);
    EXPECT_THROW(ServiceOptions::parse({"--log-level", "loud"}), std::invalid_argument);
    EXPECT_THROW(ServiceOptions::parse({"--frobnicate"}), std::invalid_argument);
}

TEST(ServiceOptions, HelpListsEveryOption) {
    const std::string usage = ServiceOptions::usage("configuration-service");
    for (const char* option :
         {"--bind", "--port", "--port-file", "--store-dir", "--host-name", "--master",
          "--master-name", "--event-dir", "--max-body-bytes", "--threads", "--keep-alive",
          "--log-level", "--help", "--io-threads", "--request-timeout", "--max-connections",
          "--max-connections-per-peer", "--max-body-memory"}) {
        EXPECT_NE(usage.find(option), std::string::npos) << option;
    }
    EXPECT_TRUE(ServiceOptions::parse({"--help"}).help);
}

}  // namespace
}  // namespace ConfigurationService
