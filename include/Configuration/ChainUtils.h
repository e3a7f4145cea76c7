// Configuration::ChainUtils: storage chains. A chain is the ordered list of places a study
// travels through after it reaches a location; each place is a Link whose definition is a queue
// name in direct format, either concrete or one of the keyword queues below, which
// MSMQCommonConfiguration::translateLinkDefinitionWithStackUid resolves against the strategy
// document when it is asked.
//
// Element form of a chain (under a key the caller chooses, e.g. "MigrationChain"): a list value
// with one keyed item per link, in chain order: "Definition" (text), "DefinitionType" (number),
// "Enabled" (flag). An item missing a key gives a link with that value at its default
// (definition "", type Unresolved, enabled true) and makes the read incomplete.
// Text form (log lines and tools): "[host]->[host]", "EMPTY CHAIN" for an empty chain; a link
// whose definition is not a direct-format name shows as "[]".
// Links are plain values; every function here is stateless and thread-safe.
#pragma once

#include <ace/SString.h>

#include <vector>

#include "Configuration/Export.h"

namespace Vesk {
class MultiElementValue;
}

namespace Configuration {
namespace ChainUtils {

// What a link definition turned out to be when it was resolved.
enum ChainLinkDefinitionType : int {
    Unresolved = 0,    // not resolved yet (the default of a link read without a type)
    ActiveStack = 1,   // a stack resolved from the persistent or persistent-mirror keyword
    Host = 2,          // reserved: never produced by the resolution
    Cache = 3,         // the active cache
    LiteralQueue = 4,  // a concrete queue, taken as it stands
};

// One hop of a chain. Two links are equal when their hosts are equivalent host names; the
// definition text, type and flag are not compared.
class CONFIGURATION_API Link {
public:
    Link() = default;
    Link(const ACE_CString& definition, ChainLinkDefinitionType type, bool enabled);

    // The queue name or keyword.
    const ACE_CString& getDefinition() const { return m_definition; }
    void setDefinition(const ACE_CString& definition) { m_definition = definition; }
    // What the definition resolved to.
    ChainLinkDefinitionType getDefinitionType() const { return m_type; }
    void setDefinitionType(ChainLinkDefinitionType type) { m_type = type; }
    // Whether the link is in use.
    bool getEnabled() const { return m_enabled; }
    void setEnabled(bool enabled) { m_enabled = enabled; }
    // The host part of the definition; "" when it is not a direct-format name.
    ACE_CString getHost() const;

private:
    ACE_CString m_definition;
    ChainLinkDefinitionType m_type = Unresolved;
    bool m_enabled = true;
};

CONFIGURATION_API bool operator==(const Link& a, const Link& b);
inline bool operator!=(const Link& a, const Link& b) {
    return !(a == b);
}

using Chain = std::vector<Link>;

// "" : the link of the location itself, where a study is processed.
CONFIGURATION_API const ACE_CString& ProcessingKeyword();
// The input queue of the pseudo-host "__PERSISTENT__": the active persistent stack.
CONFIGURATION_API const ACE_CString& PersistentKeyword();
// The input queue of the pseudo-host "__MIRROR__": the mirror of the active persistent stack.
CONFIGURATION_API const ACE_CString& PersistentMirrorKeyword();
// The input queue of the pseudo-host "__CACHE__": the active cache.
CONFIGURATION_API const ACE_CString& CacheKeyword();
// True when text is exactly (case included) the persistent, mirror or cache keyword.
CONFIGURATION_API bool isKeyword(const ACE_CString& text);

// Reads the chain under key into chain (cleared first). An absent key, a key without a value or
// with a value that is not a list gives an empty chain and true; items that are not keyed lists
// are skipped; false when an item lacks a key (the link is still added) or the element library
// failed (logged).
CONFIGURATION_API bool getChainFromVesk(const ACE_CString& key,
                                        const Vesk::MultiElementValue& children, Chain& chain);
// Appends key holding chain in its element form to children.
CONFIGURATION_API void addChainToVesk(const ACE_CString& key, const Chain& chain,
                                      Vesk::MultiElementValue& children);
// The text form of chain (see above).
CONFIGURATION_API ACE_CString chainToString(const Chain& chain);
// The first link whose host is equivalent to host; end() when none.
CONFIGURATION_API Chain::const_iterator findHostInChain(const ACE_CString& host,
                                                        const Chain& chain);
CONFIGURATION_API Chain::iterator findHostInChain(const ACE_CString& host, Chain& chain);
// The link after host's link: end() when host is the last hop or not in the chain.
CONFIGURATION_API Chain::const_iterator nextLink(const ACE_CString& host, const Chain& chain);
// Whether any link of chain has a host equivalent to link's.
CONFIGURATION_API bool isInChain(const Link& link, const Chain& chain);

}  // namespace ChainUtils
}  // namespace Configuration
