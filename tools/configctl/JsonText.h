// JsonText: JSON string literals for configctl's --output json. Names arrive in the 8-bit code
// page (Latin-1); the output is plain ASCII, every other character written as \uXXXX. Stateless;
// thread-safe.
#pragma once

#include <string>

namespace Configctl {

// text as a quoted JSON string, its bytes taken as Latin-1 characters.
std::string jsonString(const std::string& text);

}  // namespace Configctl
