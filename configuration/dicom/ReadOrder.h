// For a class whose reading order differs from its written order: its one field list gives both,
//     if constexpr (readingFields<Io>) { ...reading order... } else { ...written order... }
// the written (declared) order also serving comparison. Readers find keys by name, so the order
// shows only when a read ends early on a logged failure: what comes after it keeps its value.
#pragma once

#include <type_traits>

#include "model/Fields.h"

namespace Configuration {

// Whether the field-list visitor Io is the reader.
template <class Io>
constexpr bool readingFields = std::is_same<Io, Fields::Reader>::value;

}  // namespace Configuration
