// ElementText: the text of an element of an answer, found by its exact marks "<tag>" and
// "</tag>" as HttpConfigurationClient::findElementText finds it: where it stands (without a copy),
// or the text itself when the answer must hold it. Plain functions over caller-owned text;
// thread-safe.
#pragma once

#include <ace/SString.h>

#include <cstddef>
#include <string_view>

namespace Configuration {

// Sets raw to the text between the first "<tag>" at or after start and the next "</tag>", as it
// stands (entities not replaced); false when either mark is missing.
bool locateElementText(std::string_view text, std::string_view tag, std::size_t start,
                       std::string_view& raw);

// The text of the first element tag of answer, entities replaced (findElementText);
// HttpConfigurationException(missing) when it is absent.
ACE_CString requiredElementText(const char* tag, const ACE_CString& answer, const char* missing);

}  // namespace Configuration
