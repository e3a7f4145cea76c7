// TestDocument: a small site-wide (or per-machine) document for tests of the document machinery:
// a name, a size and a nested AnonParam. Test support only.
#pragma once

#include "ClassDefinition.h"
#include "Configuration/AnonParam.h"
#include "Configuration/TypedConfigDoc.h"

namespace Configuration {
namespace Testing {

class TestDocument : public TypedConfigDoc<TestDocument> {
    CONFIGURATION_CLASS(TestDocument);

public:
    explicit TestDocument(const char* name = "TestDoc", bool isLocal = false)
        : TypedConfigDoc(ConfigDoc::getConfigurationRegistryPath() + name, isLocal) {}

    ACE_CString name = "default";
    unsigned int size = 5;
    AnonParam param;
};

template <class Self, class Io>
void TestDocument::fields(Self& self, Io& io) {
    io("Name", self.name);
    io("Size", self.size);
    io("AnonParam", self.param);
}

CONFIGURATION_DEFINE_INLINE(TestDocument, "TestDoc", Fields::FailureForm::Failed)

}  // namespace Testing
}  // namespace Configuration
