// Vesk::XmlUtils: the XML form of an element tree (documented in docs/XML_FORMAT.md).
//
// streamOut writes any tree (every byte string but NUL, all value kinds, attributes in order)
// and streamIn reads it back to an equal tree. streamIn refuses hostile input with
// Vesk::TrelException: malformed or truncated XML, a DOCTYPE (no entity expansion ever happens),
// nesting deeper than kMaxDepth, text larger than kMaxTextBytes. Stateless and thread-safe.
#pragma once

#include <ace/SString.h>

#include <cstddef>
#include <string>

#include "Quorvex/InputStream.h"
#include "Quorvex/OutputStream.h"
#include "Vesk/Element.h"
#include "Vesk/Ordering.h"

namespace Vesk {
namespace XmlUtils {

constexpr int kMaxDepth = 200;                     // element nesting, counting value levels
constexpr std::size_t kMaxTextBytes = 256u << 20;  // 256 MiB of XML text

// Reads one tree from in into out (out's previous contents are replaced). If name is not empty
// the root's key must equal it.
void streamIn(InputStream& in, Element& out, const ACE_CString& name = ACE_CString());
// Same, from XML text already in memory.
void parse(const char* text, std::size_t len, Element& out,
           const ACE_CString& name = ACE_CString());

// Writes element as an XML document to out. If name is not empty it replaces the root's key.
void streamOut(const Element& element, OutputStream& out, const Ordering& ordering = Ordering(),
               const ACE_CString& name = ACE_CString());
// Same, returned as a string.
std::string toString(const Element& element, const Ordering& ordering = Ordering());

}  // namespace XmlUtils
}  // namespace Vesk
