// The machine's master source: the master named by the system document, and none from a
// document that does not read whole.
#include <gtest/gtest.h>

#include <set>
#include <string>

#include "Configuration/ConfigurationRepository.h"
#include "Configuration/OrvelSystemConfiguration.h"
#include "Configuration/StoredForm.h"
#include "repository/FakeServices.h"
#include "repository/MasterSource.h"
#include "testing/FakeMachine.h"
#include "testing/ScratchDir.h"

namespace Configuration {
namespace {

const char kSystemPath[] = "BrimmetServer\\OrvelSystem";

// The stored system document naming master, without the keys in dropped.
std::string systemDocument(const char* master, const std::set<std::string>& dropped = {}) {
    OrvelSystemConfiguration system;
    system.setMasterConfigurationServiceHostName(master);
    Quorvex::auto_ptr<Vesk::Element> tree = system.writeVesk();
    Vesk::Element kept(tree->key(), -1);
    Vesk::MultiElementValue& children = kept.addMultiElement();
    for (const Vesk::Element& child : tree->getMultiElement()) {
        if (dropped.count(child.key().c_str()) == 0) {
            children.addElement(child);
        }
    }
    return StoredForm::encode(kept);
}

class SystemMasterSource : public ::testing::Test {
protected:
    SystemMasterSource() {
        machine.env["QUORVEX_EVENT_DIR"] = events.path();
        local.name = "slave1";
        connector->add("testhost", local);
        connector->add("slave1", local);
    }
    ACE_CString masterFrom(const std::string& bytes) {
        local.put("slave1", kSystemPath, bytes, "2010-01-01T00:00:00.000");
        ConfigurationRepository repository(connector);
        return machineMasterSource().masterHostName(repository);
    }

    Quorvex::Testing::ScratchDir events;
    Quorvex::Testing::FakeMachine machine;
    Quorvex::ScopedMachine scoped{machine};
    Testing::FakeService local;
    std::shared_ptr<Testing::FakeConnector> connector =
        std::make_shared<Testing::FakeConnector>("testhost");
};

TEST_F(SystemMasterSource, TheSystemDocumentNamesTheMaster) {
    EXPECT_EQ(masterFrom(systemDocument("Master1")), "Master1");
}

// Guards against a system document that fails part-way redirecting every write to a master
// named in its partly read fields.
TEST_F(SystemMasterSource, ADocumentThatDoesNotReadWholeNamesNoMaster) {
    EXPECT_EQ(masterFrom(systemDocument("Master1", {"LogRoot"})), "");
    EXPECT_EQ(masterFrom("not a stored document"), "");
}

}  // namespace
}  // namespace Configuration
