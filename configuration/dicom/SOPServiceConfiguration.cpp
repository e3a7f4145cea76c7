// The SOP service document: reads its four texts and its four lists, and resolves the templates'
// and services' transfer syntaxes between the reads, in the order the document's meaning needs:
// templates against the master table as read, services against the templates.
#include "Configuration/SOPServiceConfiguration.h"

#include "Configuration/DocumentNames.h"
#include "SOPServiceIndex.h"
#include "model/ClassDefinition.h"

namespace Configuration {
namespace {

// Reads the child key into object when there is one (the object's own read logs its failures);
// true when absent.
bool readIfPresent(const Vesk::MultiElementValue& children, const char* key,
                   Vesk::Serializable& object) {
    const Vesk::Element* child = children.find(Fields::keyOf(key));
    return child == nullptr || object.readVesk(*child);
}

// Holds a look-up index of the master table in slot while it lives, unless slot holds one already
// (so that the passes of one read share one index, and a pass on its own builds its own).
class IndexScope {
public:
    IndexScope(std::shared_ptr<SOPServiceIndex>& slot,
               const std::vector<SupportedTransferSyntax>& rows)
        : m_slot(slot), m_owner(!slot) {
        if (m_owner) {
            m_slot = std::make_shared<SOPServiceIndex>(rows);
        }
    }
    ~IndexScope() {
        if (m_owner) {
            m_slot.reset();
        }
    }
    IndexScope(const IndexScope&) = delete;
    IndexScope& operator=(const IndexScope&) = delete;

private:
    std::shared_ptr<SOPServiceIndex>& m_slot;
    bool m_owner;
};

}  // namespace

// Compared in this order; readVesk below reads the same keys.
template <class Self, class Io>
void SOPServiceConfiguration::fields(Self& self, Io& io) {
    io("ReleaseDate", self.m_releaseDate);
    io("Version", self.m_version);
    io("Description", self.m_description);
    io("ProductVersion", self.m_productVersion);
    io(SupportedTransferSyntaxList::WELL_KNOWN_NAME, Fields::derived(self.m_supported));
    io(TemplateTransferSyntaxLists::WELL_KNOWN_NAME, Fields::derived(self.m_templates));
    io(SOPServiceList::WELL_KNOWN_NAME, Fields::derived(self.m_services));
    io(FilterTagList::WELL_KNOWN_NAME, Fields::derived(self.m_filterTags));
}

CONFIGURATION_DEFINE_NO_WRITE(SOPServiceConfiguration,
                              "SOPServiceConfiguration::writeVesk - Not supported.")
CONFIGURATION_DEFINE_EQUAL(SOPServiceConfiguration)

SOPServiceConfiguration::SOPServiceConfiguration()
    : TypedConfigDoc(
          ConfigDoc::getConfigurationRegistryPath() + DocumentNames::kSOPServiceConfiguration,
          false) {}

bool SOPServiceConfiguration::readVesk(const Vesk::Element& element) {
    try {
        const Vesk::MultiElementValue& children = element.getMultiElement();
        Fields::Reader head(Fields::In{&element, children});
        head("ReleaseDate", m_releaseDate);
        head("Version", m_version);
        head("Description", m_description);
        head("ProductVersion", m_productVersion);
        bool complete = head.complete();
        complete =
            readIfPresent(children, SupportedTransferSyntaxList::WELL_KNOWN_NAME, m_supported) &&
            complete;
        complete =
            readIfPresent(children, TemplateTransferSyntaxLists::WELL_KNOWN_NAME, m_templates) &&
            complete;
        const IndexScope index(m_index, m_supported.getSupportedTransferSyntaxes());
        ProcessTemplateTransferSyntaxLists();
        complete = readIfPresent(children, SOPServiceList::WELL_KNOWN_NAME, m_services) && complete;
        ProcessSOPServiceList();
        complete =
            readIfPresent(children, FilterTagList::WELL_KNOWN_NAME, m_filterTags) && complete;
        return complete;
    } catch (const std::exception& e) {
        Fields::logReadFailure("SOPServiceConfiguration", Fields::FailureForm::Failed, e.what());
        return false;
    }
}

void SOPServiceConfiguration::ProcessTemplateTransferSyntaxLists() {
    const IndexScope index(m_index, m_supported.getSupportedTransferSyntaxes());
    for (TemplateTransferSyntaxList& entry : m_templates.m_templates) {
        Str2TransferSyntaxList(entry.m_listText, entry.m_transferSyntaxList);
    }
}

void SOPServiceConfiguration::ProcessSOPServiceList() {
    const IndexScope index(m_index, m_supported.getSupportedTransferSyntaxes());
    m_index->indexTemplates(m_templates.m_templates);
    for (SOPService& service : m_services.m_services) {
        std::vector<TransferSyntax>& entries = service.m_transferSyntaxList.getTransferSyntaxes();
        const TemplateTransferSyntaxList* found =
            GetTemplateTxList(service.m_defaultListText, service.m_additional);
        if (found != nullptr) {
            const auto& offered = found->getTransferSyntaxList().getTransferSyntaxes();
            entries.reserve(entries.size() + offered.size());
            for (const TransferSyntax& entry : offered) {
                entries.emplace_back(entry.sharedRow());  // enabled, whatever the template says
            }
            service.m_templateName = service.m_defaultListText;
        } else {
            Str2TransferSyntaxList(service.m_defaultListText, service.m_transferSyntaxList);
        }
        if (service.m_hasModificationList) {
            UpdateTransferSyntaxList(service.m_transferSyntaxList, service.m_modificationListText);
        }
    }
}

TemplateTransferSyntaxList* SOPServiceConfiguration::GetTemplateTxList(const ACE_CString& name,
                                                                       bool additional) {
    if (m_index) {
        return m_index->findTemplate(name, additional);
    }
    for (TemplateTransferSyntaxList& entry : m_templates.m_templates) {
        if (entry.getName() == name && entry.getAdditional() == additional) {
            return &entry;
        }
    }
    return nullptr;
}

void SOPServiceConfiguration::Str2TransferSyntaxList(const ACE_CString& text,
                                                     TransferSyntaxList& list) {
    if (text.length() == 0) {
        return;
    }
    if (m_index) {
        m_index->appendNamed(text, list);
        return;
    }
    SOPServiceIndex(m_supported.getSupportedTransferSyntaxes()).appendNamed(text, list);
}

void SOPServiceConfiguration::UpdateTransferSyntaxList(TransferSyntaxList& list,
                                                       const ACE_CString& text) {
    enableNamed(list, text);
}

}  // namespace Configuration
