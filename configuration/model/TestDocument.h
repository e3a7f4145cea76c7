// TestDocument: a small site-wide (or per-machine) document for tests of the document machinery:
// a name, a size and a nested AnonParam. Test support only.
#pragma once

#include "Configuration/AnonParam.h"
#include "Configuration/TypedConfigDoc.h"
#include "model/Fields.h"

namespace Configuration {
namespace Testing {

class TestDocument : public TypedConfigDoc<TestDocument> {
public:
    explicit TestDocument(const char* name = "TestDoc", bool isLocal = false)
        : TypedConfigDoc(ConfigDoc::getConfigurationRegistryPath() + name, isLocal) {}
    bool readVesk(const Vesk::Element& e) override {
        return Fields::read(*this, e, "TestDoc", Fields::FailureForm::Failed);
    }
    Quorvex::auto_ptr<Vesk::Element> writeVesk() const override {
        return Fields::write(*this, "TestDoc");
    }
    friend bool operator==(const TestDocument& a, const TestDocument& b) {
        return Fields::equal(a, b);
    }

    ACE_CString name = "default";
    unsigned int size = 5;
    AnonParam param;

private:
    friend struct Fields::Access;
    template <class Self, class Io>
    static void fields(Self& s, Io& io) {
        io("Name", s.name);
        io("Size", s.size);
        io("AnonParam", s.param);
    }
};

}  // namespace Testing
}  // namespace Configuration
