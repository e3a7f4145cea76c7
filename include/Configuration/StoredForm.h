// Configuration::StoredForm: the bytes a configuration document is stored as: the XML text of its
// element tree (docs/XML_FORMAT.md) compressed as one zlib stream, so any zlib tool inflates it.
// Stateless; thread-safe.
#pragma once

#include <cstddef>
#include <string>

#include "Configuration/Export.h"
#include "Vesk/Element.h"

namespace Configuration {

class CONFIGURATION_API StoredForm {
public:
    static constexpr std::size_t kInitialCapacity = 5120;  // bytes reserved for the output
    static constexpr int kCompressionLevel = 9;

    // The stored bytes of a tree.
    static std::string encode(const Vesk::Element& tree);
    // Parses stored bytes into tree. Corrupt compressed data throws Quorvex::StreamException;
    // bad XML throws Vesk::TrelException.
    static void decode(const unsigned char* data, std::size_t len, Vesk::Element& tree);
};

}  // namespace Configuration
