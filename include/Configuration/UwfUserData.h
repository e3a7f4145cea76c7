// UwfUserData: a user of the user-workflow service: identity, type, the ids of the user's inbox
// and master folder, and the on-call flag. Made only by Create() and shared through SmartPtr; a
// plain record without locks: fill and read one record on one thread at a time.
#pragma once

#include <ace/SString.h>

#include "Configuration/Export.h"
#include "Configuration/SmartPtr.h"

namespace Vesk {
class XmlEmitter;
}

namespace Configuration {

class CONFIGURATION_API UwfUserData {
public:
    // A new record with every field empty and OnCall false.
    static SmartPtr<UwfUserData> Create();
    UwfUserData(const UwfUserData& other) = default;
    UwfUserData& operator=(const UwfUserData& other) = default;

    // Writes <User> with every field in order, leaving out empty ones.
    void WriteXml(Vesk::XmlEmitter& xml) const;
    // Reads the fields from the elements of text; a missing element keeps its field. UserId and
    // UserName arrive as UTF-8 and are converted to the local code page; throws std::exception
    // when "OnCall" is no flag.
    void LoadXml(const ACE_CString& text);

    // "UserDataSet".
    static const char* DataSetName();
    // The namespace URI of the record, ending in "/UserWorkFlow/User".
    static const char* Namespace();

    ACE_CString UserId;
    ACE_CString UserName;
    ACE_CString Type;
    ACE_CString InboxId;
    ACE_CString MasterFolderId;
    bool OnCall = false;

private:
    UwfUserData() = default;
};

}  // namespace Configuration
