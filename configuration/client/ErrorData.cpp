#include "Configuration/ErrorData.h"

#include "Configuration/HttpConfigurationClient.h"
#include "Quorvex/TextConversion.h"

namespace Configuration {

namespace {

// Sets field from element tag of text (searched from the start); a missing element keeps it.
void readElement(const ACE_CString& text, const char* tag, ACE_CString& field) {
    ACE_CString value;
    ACE_CString::size_type next = 0;
    if (HttpConfigurationClient::findElementText(tag, text, 0, value, next)) {
        field = value;
    }
}

}  // namespace

SmartPtr<ErrorData> ErrorData::Create() {
    return SmartPtr<ErrorData>(new ErrorData());
}

void ErrorData::LoadXml(const ACE_CString& text) {
    readElement(text, "ErrorKey", ErrorKey);
    readElement(text, "ErrorCode", ErrorCode);
    readElement(text, "ErrorMessage", ErrorMessage);
    readElement(text, "ErrorOriginalStackTrace", ErrorOriginalStackTrace);
    ACE_CString localized;
    ACE_CString::size_type next = 0;
    if (HttpConfigurationClient::findElementText("LocalizedErrorMessage", text, 0, localized,
                                                 next)) {
        Quorvex::ConvertUTF8StringToAnsi(localized, LocalizedErrorMessage);
    }
}

}  // namespace Configuration
