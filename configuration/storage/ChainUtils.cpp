#include "Configuration/ChainUtils.h"

#include "Configuration/MSMQConfiguration.h"
#include "Quorvex/Host.h"
#include "Quorvex/Log.h"
#include "Vesk/MultiElementValue.h"
#include "Vesk/MultiValue.h"
#include "Vesk/SingleValue.h"
#include "model/FieldCore.h"

namespace Configuration {
namespace ChainUtils {
namespace {

constexpr const char kDefinition[] = "Definition";
constexpr const char kDefinitionType[] = "DefinitionType";
constexpr const char kEnabled[] = "Enabled";

// One keyed item of the list: a link, added also when a key is missing.
bool readLink(const Vesk::MultiElementValue& item, Chain& chain) {
    ACE_CString definition;
    int type = Unresolved;
    bool enabled = true;
    bool complete = Fields::readScalar(item, kDefinition, definition);
    complete = Fields::readScalar(item, kDefinitionType, type) && complete;
    complete = Fields::readScalar(item, kEnabled, enabled) && complete;
    chain.emplace_back(definition, static_cast<ChainLinkDefinitionType>(type), enabled);
    return complete;
}

}  // namespace

Link::Link(const ACE_CString& definition, ChainLinkDefinitionType type, bool enabled)
    : m_definition(definition), m_type(type), m_enabled(enabled) {}

ACE_CString Link::getHost() const {
    return MSMQConfiguration::HostFromQueue(m_definition);
}

bool operator==(const Link& a, const Link& b) {
    return Quorvex::HostNamesEquivalent(a.getHost(), b.getHost());
}

const ACE_CString& ProcessingKeyword() {
    static const ACE_CString processing;
    return processing;
}

const ACE_CString& PersistentKeyword() {
    static const ACE_CString keyword =
        MSMQConfiguration::QuorvexInputQueueFromHost("__PERSISTENT__");
    return keyword;
}

const ACE_CString& PersistentMirrorKeyword() {
    static const ACE_CString keyword = MSMQConfiguration::QuorvexInputQueueFromHost("__MIRROR__");
    return keyword;
}

const ACE_CString& CacheKeyword() {
    static const ACE_CString keyword = MSMQConfiguration::QuorvexInputQueueFromHost("__CACHE__");
    return keyword;
}

bool isKeyword(const ACE_CString& text) {
    return text == PersistentKeyword() || text == PersistentMirrorKeyword() ||
           text == CacheKeyword();
}

bool getChainFromVesk(const ACE_CString& key, const Vesk::MultiElementValue& children,
                      Chain& chain) {
    chain.clear();
    bool complete = true;
    try {
        const Vesk::Element* list = children.find(key);
        if (list == nullptr || !list->hasValue() ||
            list->value().kind() != Vesk::Value::Kind::Multi) {
            return true;
        }
        for (const Vesk::Value& item : list->getMulti()) {
            if (item.kind() == Vesk::Value::Kind::MultiElement) {
                complete =
                    readLink(static_cast<const Vesk::MultiElementValue&>(item), chain) && complete;
            }
        }
    } catch (const Vesk::TrelException& e) {
        QUORVEX_LOG(LM_ERROR, "getChainFromVesk: TrelException: %s\n", e.what());
        return false;
    }
    return complete;
}

void addChainToVesk(const ACE_CString& key, const Chain& chain, Vesk::MultiElementValue& children) {
    Vesk::MultiValue& list = children.addElement(new Vesk::Element(key, -1)).addMulti();
    for (const Link& link : chain) {
        Vesk::MultiElementValue& item = list.addMultiElement();
        Fields::writeText(item, kDefinition, link.getDefinition());
        Fields::writeText(item, kDefinitionType, Fields::toText(link.getDefinitionType()));
        Fields::writeText(item, kEnabled, Fields::toText(link.getEnabled()));
    }
}

ACE_CString chainToString(const Chain& chain) {
    if (chain.empty()) {
        return "EMPTY CHAIN";
    }
    ACE_CString text;
    for (const Link& link : chain) {
        if (text.length() != 0) {
            text += "->";
        }
        text += "[";
        text += link.getHost();
        text += "]";
    }
    return text;
}

Chain::const_iterator findHostInChain(const ACE_CString& host, const Chain& chain) {
    for (auto it = chain.begin(); it != chain.end(); ++it) {
        if (Quorvex::HostNamesEquivalent(host, it->getHost())) {
            return it;
        }
    }
    return chain.end();
}

Chain::iterator findHostInChain(const ACE_CString& host, Chain& chain) {
    const Chain& constChain = chain;
    return chain.begin() + (findHostInChain(host, constChain) - constChain.begin());
}

Chain::const_iterator nextLink(const ACE_CString& host, const Chain& chain) {
    const auto found = findHostInChain(host, chain);
    return found == chain.end() ? found : found + 1;
}

bool isInChain(const Link& link, const Chain& chain) {
    for (const Link& other : chain) {
        if (other == link) {
            return true;
        }
    }
    return false;
}

}  // namespace ChainUtils
}  // namespace Configuration
