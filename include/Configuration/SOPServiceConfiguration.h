// Configuration::SOPServiceConfiguration: the site-wide document "SOPServiceConfiguration": which
// DICOM services (SOP classes) the archive's servers offer and, for each, which transfer syntaxes
// they accept in association negotiation.
//
// Element "SOPServiceConfiguration"; keys in order: "ReleaseDate", "Version", "Description",
// "ProductVersion" (strings, empty; required), then, each optional, "SupportedTxList" (the master
// table of numbered transfer syntaxes), "TemplateTxLists" (named groups of syntax numbers),
// "SOPServiceList" (the services) and "FilterTagList" (tags used as filters).
//
// Reading resolves every template's and every service's transfer syntaxes once, against the
// master table as read: a service takes the syntaxes of the template its "TxListDefault" names
// (among the templates of its own "Additional" set), or else the numbers "TxListDefault" holds;
// a present "TxList" then enables exactly the numbers it names. Numbers are decimal, separated by
// any one character ("1,2,3", "1 2 3"); unknown numbers and repeats are ignored. Reading again
// appends to every list and resolves again: read into a fresh object.
//
// A server walks getSOPServiceList().getSOPServices() and offers, per service, the entries of
// getTransferSyntaxList().getTransferSyntaxes() whose getEnabled() is true, by getUID().
//
// The document is maintained outside the library: writeVesk throws std::exception
// ("SOPServiceConfiguration::writeVesk - Not supported."), so the repository can read it but not
// store it. Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include <memory>

#include "Configuration/ConfigurationClass.h"
#include "Configuration/FilterTagList.h"
#include "Configuration/SOPServiceList.h"
#include "Configuration/SupportedTransferSyntaxList.h"
#include "Configuration/TemplateTransferSyntaxLists.h"
#include "Configuration/TypedConfigDoc.h"

namespace Configuration {

class SOPServiceIndex;

class CONFIGURATION_API SOPServiceConfiguration : public TypedConfigDoc<SOPServiceConfiguration> {
    CONFIGURATION_CLASS(SOPServiceConfiguration);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "SOPServiceConfiguration";

    // The site-wide document "SOPServiceConfiguration", every string empty, every list empty.
    SOPServiceConfiguration();

    // When the document was released.
    const ACE_CString& getReleaseDate() const { return m_releaseDate; }
    void setReleaseDate(const ACE_CString& value) { m_releaseDate = value; }
    // The document's own version.
    const ACE_CString& getVersion() const { return m_version; }
    void setVersion(const ACE_CString& value) { m_version = value; }
    // Free text.
    const ACE_CString& getDescription() const { return m_description; }
    void setDescription(const ACE_CString& value) { m_description = value; }
    // The product version the document belongs to.
    const ACE_CString& getProductVersion() const { return m_productVersion; }
    void setProductVersion(const ACE_CString& value) { m_productVersion = value; }
    // The master table of transfer syntaxes.
    const SupportedTransferSyntaxList& getSupportedTransferSyntaxList() const {
        return m_supported;
    }
    // The templates, each with its resolved syntaxes.
    const TemplateTransferSyntaxLists& getTemplateTransferSyntaxLists() const {
        return m_templates;
    }
    // The services, each with its resolved syntaxes.
    const SOPServiceList& getSOPServiceList() const { return m_services; }
    // The filter tags.
    const FilterTagList& getFilterTagList() const { return m_filterTags; }

private:
    // Resolves every template's list text against the master table.
    void ProcessTemplateTransferSyntaxLists();
    // Resolves every service: its template's syntaxes or its numbers, then its "TxList".
    void ProcessSOPServiceList();
    // The first template with that name (whole, case-sensitive) and additional flag; null if none.
    TemplateTransferSyntaxList* GetTemplateTxList(const ACE_CString& name, bool additional);
    // Appends to list the master-table rows that text names, each once, in the order of text.
    void Str2TransferSyntaxList(const ACE_CString& text, TransferSyntaxList& list);
    // Enables exactly the entries of list that text names (an empty text disables them all).
    void UpdateTransferSyntaxList(TransferSyntaxList& list, const ACE_CString& text);

    ACE_CString m_releaseDate;
    ACE_CString m_version;
    ACE_CString m_description;
    ACE_CString m_productVersion;
    SupportedTransferSyntaxList m_supported;
    TemplateTransferSyntaxLists m_templates;
    SOPServiceList m_services;
    FilterTagList m_filterTags;
    // Look-up tables of the master table and the templates, held only while reading.
    std::shared_ptr<SOPServiceIndex> m_index;
};

}  // namespace Configuration
