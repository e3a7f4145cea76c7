// Vesk::XmlEmitter: writes XML text element by element to an OutputStream, escaping text and
// attribute values ("<", "&", ">", quotes). No declaration, no indentation; an element is always
// written as an opening tag, its text and a closing tag (never self-closing). Not thread-safe.
#pragma once

#include <ace/SString.h>

#include <vector>

#include "Quorvex/OutputStream.h"
#include "Vesk/TrelException.h"
#include "Vesk/XmlAttributes.h"

namespace Vesk {

class XmlEmitter {
public:
    explicit XmlEmitter(OutputStream& out) : m_out(out) {}
    // Opens an element.
    void startElement(const ACE_CString& name, const XmlAttributes& attributes = XmlAttributes());
    // Writes escaped text inside the open element.
    void characters(const ACE_CString& text);
    // Closes the innermost open element; TrelException if none is open.
    void endElement();
    // startElement, characters, endElement in one call.
    void textElement(const ACE_CString& name, const ACE_CString& text);

private:
    OutputStream& m_out;
    std::vector<ACE_CString> m_open;
};

}  // namespace Vesk
