// UwfContactNameData: the parts of a user's name as the user-workflow service keeps it for
// display. Made only by Create() and shared through SmartPtr; a plain record without locks: fill
// and read one record on one thread at a time.
#pragma once

#include <ace/SString.h>

#include "Configuration/Export.h"
#include "Configuration/SmartPtr.h"

namespace Vesk {
class XmlEmitter;
}

namespace Configuration {

class CONFIGURATION_API UwfContactNameData {
public:
    // A new record with every field empty.
    static SmartPtr<UwfContactNameData> Create();
    UwfContactNameData(const UwfContactNameData& other) = default;
    UwfContactNameData& operator=(const UwfContactNameData& other) = default;

    // Writes <ContactName> with every field in order, leaving out empty ones.
    void WriteXml(Vesk::XmlEmitter& xml) const;
    // Reads the fields from the elements of text (UTF-8, converted to the local code page); a
    // missing element keeps its field.
    void LoadXml(const ACE_CString& text);

    // "ContactNameDataSet".
    static const char* DataSetName();
    // The namespace URI of the record, ending in "/UserWorkFlow/ContactName".
    static const char* Namespace();

    ACE_CString FamilyName;
    ACE_CString GivenName;
    ACE_CString MiddleName;
    ACE_CString HonorificPrefix;
    ACE_CString HonorificSuffix;

private:
    UwfContactNameData() = default;
};

}  // namespace Configuration
