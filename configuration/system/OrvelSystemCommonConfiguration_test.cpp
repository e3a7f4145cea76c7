// The site-wide settings' own logic: host defaults from the local address (with the fall-back),
// the signed decimals and the flags' text form.
#include <gtest/gtest.h>

#include "Configuration/OrvelSystemCommonConfiguration.h"
#include "ElementTestSupport.h"
#include "testing/FakeMachine.h"
#include "testing/LogCapture.h"

namespace Configuration {
namespace {

const char kNoAddress[] =
    "OrvelSystemCommonConfiguration::OrvelSystemCommonConfiguration: Unable to find a local IP "
    "address, using default! Check configuration.\n";

struct AddressRow {
    const char* machineAddress;  // empty: the machine has none
    const char* expected;
    bool critical;
};

class HostDefaults : public testing::TestWithParam<AddressRow> {};

TEST_P(HostDefaults, EveryHostAndTheWebAddressFollowTheLocalAddress) {
    Quorvex::Testing::FakeMachine machine;
    machine.ipAddress = GetParam().machineAddress;
    Quorvex::ScopedMachine scoped(machine);
    Quorvex::Testing::LogCapture log;
    const OrvelSystemCommonConfiguration config;
    const ACE_CString address = GetParam().expected;
    for (const ACE_CString& host :
         {config.getCorbaNamingService(), config.getHTTPServer(), config.getConnectRServer(),
          config.getMasterDBServer(), config.getIntegrationEngineHost()}) {
        EXPECT_EQ(address, host);
    }
    EXPECT_EQ("http://" + address + "/Calyra/Quorvex/QuorvexDefault.asp",
              config.getCalyraAspServer());
    EXPECT_EQ(GetParam().critical ? 1u : 0u, log.records().size());
    EXPECT_EQ(GetParam().critical, log.contains(LM_CRITICAL, kNoAddress));
}

INSTANTIATE_TEST_SUITE_P(Machines, HostDefaults,
                         testing::Values(AddressRow{"10.20.1.15", "10.20.1.15", false},
                                         AddressRow{"", "127.0.0.1", true}));

TEST(OrvelSystemCommon, PortAndDaysAreSignedDecimalsAndFlagsOnlyOneOrZero) {
    Vesk::Element sample = Testing::sampleDocument("OrvelSystemCommonConfiguration.xml");
    OrvelSystemCommonConfiguration config;
    ASSERT_TRUE(config.readVesk(sample));
    EXPECT_EQ(4294967295u, config.getIntegrationEngineHostPort());  // stored "-1"
    config.setMergeLinkDaysToKeep(4294967294u);
    const auto written = config.writeVesk();
    EXPECT_EQ(ACE_CString("-2"),
              written->getMultiElement().getElement("MergeLinkDaysToKeep").getSingle().value());
    // "true" is not a flag's text: the flag keeps what it had, and the key still counts as read.
    Vesk::Element wordy("UseWindowsAuthentication", -1);
    wordy.addSingle().assign("true");
    OrvelSystemCommonConfiguration fresh;
    EXPECT_TRUE(fresh.readVesk(Testing::withChild(sample, "UseWindowsAuthentication", wordy)));
    EXPECT_FALSE(fresh.getUseWindowsAuthentication());
    EXPECT_EQ(OrvelSystemCommonConfiguration::WebServiceCommunication,
              fresh.getServerCommunicationDefinition());
}

TEST(OrvelSystemCommon, ADocumentWithoutThePortKeeps8001AndReadsIncomplete) {
    OrvelSystemCommonConfiguration config;
    EXPECT_FALSE(config.readVesk(
        Testing::withoutChild(Testing::sampleDocument("OrvelSystemCommonConfiguration.xml"),
                              "IntegrationEngineHostPort")));
    EXPECT_EQ(8001u, config.getIntegrationEngineHostPort());
    EXPECT_EQ(365u, config.getMergeLinkDaysToKeep());
    EXPECT_FALSE(config.isLocal());
    EXPECT_EQ(std::string("BrimmetServer\\OrvelSystemCommon"), config.path().c_str());
}

}  // namespace
}  // namespace Configuration
