// Text conversions. The library's strings are 8-bit; the local code page is ISO-8859-1.
// Pure functions; thread-safe.
#pragma once

#include <ace/SString.h>

namespace Quorvex {

// UTF-8 to the local 8-bit code page; a character it cannot hold, or a malformed UTF-8 sequence,
// becomes '?' (one '?' per character, or per broken start of one). Throws std::runtime_error only
// when the system cannot convert at all (no iconv converter).
void ConvertUTF8StringToAnsi(const ACE_CString& utf8, ACE_CString& ansi);
// Replaces the XML character entities (&lt; &gt; &amp; &quot; &apos; and &#N; / &#xN; from 1 to
// 255) by their characters; anything else is kept as it stands.
void ConvertXmlStringToString(const ACE_CString& xml, ACE_CString& text);

}  // namespace Quorvex
