// Test helpers for the DICOM documents: sample documents from tests/data/dicom, a one-line
// description of a resolved list or service (the form the samples state their expectations in),
// and a builder of element trees for documents made in code.
#pragma once

#include <string>

#include "Configuration/SOPService.h"
#include "Configuration/TransferSyntaxList.h"
#include "ElementTestSupport.h"
#include "Vesk/Element.h"

namespace Configuration {
namespace Testing {

// The tree of tests/data/dicom/file.
inline Vesk::Element dicomDocument(const std::string& file) {
    return sampleDocument("../dicom/" + file);
}

// "NR+ NR-": each entry's number, + when enabled, - when not, in list order.
inline std::string describe(const TransferSyntaxList& list) {
    std::string text;
    for (const TransferSyntax& entry : list.getTransferSyntaxes()) {
        text += (text.empty() ? "" : " ") + std::to_string(entry.getNr()) +
                (entry.getEnabled() ? "+" : "-");
    }
    return text;
}

// "type=KIND enabled=0|1 template=NAME: LIST".
inline std::string describe(const SOPService& service) {
    static const char* const kTypes[] = {"IMAGE", "GSPS", "SR", "KO", "PRIVATE", "CSPS"};
    const std::string list = describe(service.getTransferSyntaxList());
    return std::string("type=") + kTypes[service.getObjectType()] +
           " enabled=" + (service.getEnabled() ? "1" : "0") +
           " template=" + service.getTemplateName().c_str() + ":" + (list.empty() ? "" : " ") +
           list;
}

// Builds element trees: child(parent, key) appends a list element, text(parent, key, value) a
// text element.
inline Vesk::MultiElementValue& child(Vesk::MultiElementValue& parent, const char* key) {
    return parent.addElement(key, {}, -1).addMultiElement();
}
inline void text(Vesk::MultiElementValue& parent, const char* key, const std::string& value) {
    parent.addElement(key, {}, -1).addSingle().assign(value.data(), value.size());
}

}  // namespace Testing
}  // namespace Configuration
