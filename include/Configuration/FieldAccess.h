// Configuration::Fields::Access: the one friend through which the shared readers, writers and
// comparison reach a configuration class's private field list. Declared here so that every
// exported class header can name it; defined inside the library.
#pragma once

namespace Configuration {
namespace Fields {
struct Access;
}  // namespace Fields
}  // namespace Configuration
