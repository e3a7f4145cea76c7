// Turns a configuration document into its stored bytes and back, around the caller's store and
// retrieve operations (the repository's WriteItem and ReadItem).
//
// writeItem: writeVesk (a class that writes no tree: std::runtime_error), encode, set the
// document's timestamp to now, hand name, path, bytes and timestamp to store; returns the tree when
// store reports 0, else null. The new timestamp stays on the document even when the store fails:
// callers do not roll it back. readItem: retrieve bytes and timestamp (non-zero result: -1),
// decode, readVesk; returns 0 and sets the stored timestamp when every key was read (and hands the
// decoded tree to treeOut when given), and throws std::runtime_error
// "ConfigurationRepository::ReadItem: Error parsing configuration: <path>\n" when one was missing.
// Decode failures pass on as their own exceptions. Stateless; thread-safe for distinct documents.
#pragma once

#include <ace/SString.h>

#include <cstddef>
#include <functional>

#include "Configuration/ConfigDoc.h"
#include "Quorvex/BDateTime.h"
#include "Quorvex/auto_ptr.h"
#include "Vesk/Element.h"

namespace Configuration {
namespace DocumentCodec {

using StoreFunction =
    std::function<int(const ACE_CString& name, const ACE_CString& path, const unsigned char* bytes,
                      std::size_t length, const BDateTime& timestamp)>;
using RetrieveFunction =
    std::function<int(const ACE_CString& name, const ACE_CString& path, Quorvex::ByteArray& bytes,
                      std::size_t& length, BDateTime& timestamp)>;

Quorvex::auto_ptr<Vesk::Element> writeItem(const ACE_CString& name, ConfigDoc& document,
                                           const StoreFunction& store);
int readItem(const ACE_CString& name, ConfigDoc& document, const RetrieveFunction& retrieve,
             Vesk::Element* treeOut = nullptr);
// readVesk of a decoded tree into document; the "Error parsing configuration" std::runtime_error
// when a key was missing.
void readTree(const Vesk::Element& tree, ConfigDoc& document);

}  // namespace DocumentCodec
}  // namespace Configuration
