// ErrorData: the error record in the answers of the newer services (user workflow, and the
// configuration service's status-judged requests). Made only by Create(); the caller shares
// ownership through the returned SmartPtr. A plain record without locks: fill it on one thread.
#pragma once

#include <ace/SString.h>

#include "Configuration/Export.h"
#include "Configuration/SmartPtr.h"

namespace Configuration {

class CONFIGURATION_API ErrorData {
public:
    // A new record with every field empty.
    static SmartPtr<ErrorData> Create();

    // Fills the fields from the elements of an answer text; a missing element keeps its field.
    void LoadXml(const ACE_CString& text);

    ACE_CString ErrorKey;
    ACE_CString ErrorCode;
    ACE_CString ErrorMessage;
    ACE_CString LocalizedErrorMessage;  // converted from UTF-8 to the local code page
    ACE_CString ErrorOriginalStackTrace;

private:
    ErrorData() = default;
};

}  // namespace Configuration
