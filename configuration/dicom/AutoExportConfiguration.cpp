// The automatic export rules: read-only classes, and the look-up of a destination among them.
#include "Configuration/AutoExportConfiguration.h"

#include <strings.h>

#include "Configuration/DocumentNames.h"
#include "ListReserve.h"
#include "model/ClassDefinition.h"

namespace Configuration {
namespace {

// A list in one child: absent, the read is incomplete; without a value, the list keeps what it
// held; else the list is replaced by the children with itemKey (any key when null), an item whose
// read is incomplete being left out.
template <class C>
struct ChildList : Fields::Form {
    C& container;
    const char* itemKey;

    bool read(const Fields::In& in, const char* key) const {
        const Vesk::Element* list = in.children.find(Fields::keyOf(key));
        if (list == nullptr) {
            return false;
        }
        if (!list->hasValue()) {
            return true;
        }
        const Vesk::MultiElementValue& children = list->getMultiElement();
        if (itemKey != nullptr) {
            return Fields::readItems(container, Fields::KeyRange{children, Fields::keyOf(itemKey)},
                                     Fields::DropFailed, Fields::ElementReader(), Fields::NoKey());
        }
        return Fields::readItems(container, children, Fields::DropFailed, Fields::ElementReader(),
                                 Fields::NoKey());
    }
    template <class Co>
    void compare(Co& c) const {
        c.add(container);
    }
};

template <class C>
ChildList<C> childList(C& container, const char* itemKey = nullptr) {
    return ChildList<C>{{}, container, itemKey};
}

constexpr const char kRules[] = "AutoExportRules";

}  // namespace

// Compared by name and value; read by hand (the name is the element's key).
template <class Self, class Io>
void Criterion::fields(Self& self, Io& io) {
    io("Name", self.m_name);
    io("Value", self.m_value);
}

bool Criterion::readVesk(const Vesk::Element& element) {
    m_name = element.key();
    m_value.clear();
    if (element.hasValue() && element.value().kind() == Vesk::Value::Kind::Single) {
        m_value = element.getSingle().value();
    }
    return true;
}

CONFIGURATION_DEFINE_NO_WRITE(Criterion, "Criterion::writeVesk - Class cannot be serialized.")
CONFIGURATION_DEFINE_EQUAL(Criterion)

template <class Self, class Io>
void Destination::fields(Self& self, Io& io) {
    io("DestinationName", self.m_destinationName);
    io("IsStorageCommitRequired", self.m_storageCommitRequired);
}

CONFIGURATION_DEFINE_READ(Destination, Fields::FailureForm::Failed)
// The destination refuses with the criterion's text.
CONFIGURATION_DEFINE_NO_WRITE(Destination, "Criterion::writeVesk - Class cannot be serialized.")
CONFIGURATION_DEFINE_EQUAL(Destination)

template <class Self, class Io>
void AutoExportRule::fields(Self& self, Io& io) {
    io("Name", Fields::attribute(self.m_name));
    io("Enabled", self.m_enabled);
    io("Criteria", childList(self.m_criteria));
    io("Destinations", childList(self.m_destinations));
}

// A rule without a name is not read at all.
bool AutoExportRule::readVesk(const Vesk::Element& element) {
    bool named = false;
    element.getAttributeValue(Fields::keyOf("Name"), named);
    return named && Fields::read(*this, element, "AutoExportRule", Fields::FailureForm::Failed);
}

CONFIGURATION_DEFINE_NO_WRITE(AutoExportRule,
                              "AutoExportRule::writeVesk - Class cannot be serialized.")
CONFIGURATION_DEFINE_EQUAL(AutoExportRule)

bool AutoExportRule::hasDestination(const ACE_CString& name) const {
    for (const Destination& destination : m_destinations) {
        const ACE_CString& candidate = destination.m_destinationName;
        if (candidate.length() == name.length() &&
            ::strncasecmp(candidate.c_str(), name.c_str(), name.length()) == 0) {
            return true;
        }
    }
    return false;
}

template <class Self, class Io>
void AutoExportConfiguration::fields(Self& self, Io& io) {
    io(kRules, Fields::required(childList(self.m_rules, AutoExportRule::WELL_KNOWN_NAME)));
    io("Enabled", self.m_enabled);
    io("MaxRetries", self.m_maxRetries);
    io("RetryDelay", self.m_retryDelay);
}

// The convention's read, after making room for every rule the document holds.
bool AutoExportConfiguration::readVesk(const Vesk::Element& element) {
    if (element.hasValue() && element.value().kind() == Vesk::Value::Kind::MultiElement) {
        const Vesk::Element* rules = element.getMultiElement().find(Fields::keyOf(kRules));
        if (rules != nullptr) {
            reserveForItems(*rules, AutoExportRule::WELL_KNOWN_NAME, m_rules);
        }
    }
    return Fields::read(*this, element, "AutoExportConfiguration", Fields::FailureForm::Failed);
}

CONFIGURATION_DEFINE_NO_WRITE(AutoExportConfiguration,
                              "AutoExportConfiguration::writeVesk - Class cannot be serialized.")
CONFIGURATION_DEFINE_EQUAL(AutoExportConfiguration)

AutoExportConfiguration::AutoExportConfiguration()
    : TypedConfigDoc(ConfigDoc::getConfigurationRegistryPath() + DocumentNames::kAutoExport,
                     false) {}

bool AutoExportConfiguration::isDestinationUsed(const ACE_CString& name) const {
    for (const AutoExportRule& rule : m_rules) {
        if (rule.hasDestination(name)) {
            return true;
        }
    }
    return false;
}

}  // namespace Configuration
