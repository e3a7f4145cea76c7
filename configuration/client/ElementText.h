// ElementText: where the text of an element stands in an answer, found by its exact marks
// "<tag>" and "</tag>" as HttpConfigurationClient::findElementText finds it, without copying it.
// A plain function over caller-owned text; thread-safe.
#pragma once

#include <cstddef>
#include <string_view>

namespace Configuration {

// Sets raw to the text between the first "<tag>" at or after start and the next "</tag>", as it
// stands (entities not replaced); false when either mark is missing.
bool locateElementText(std::string_view text, std::string_view tag, std::size_t start,
                       std::string_view& raw);

}  // namespace Configuration
