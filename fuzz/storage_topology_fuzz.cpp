// Storage topology fed arbitrary bytes: the bytes as a queue name in direct format (a name that
// parses must rebuild from its parts), and, when they are an element tree, as the chains of a
// document: every chain read is written and read back to the same links, its text form and host
// search terminate, and the topology, rules and location documents read it without throwing.
#include <string>

#include "ClassFuzz.h"
#include "Configuration/ChainUtils.h"
#include "Configuration/LocationConfiguration.h"
#include "Configuration/MSMQCommonConfiguration.h"
#include "Configuration/MSMQConfiguration.h"
#include "Configuration/RulesConfiguration.h"
#include "StorageForms.h"
#include "Vesk/MultiElementValue.h"

namespace {

using Configuration::ChainUtils::Chain;
using Configuration::StorageFields::sameLinks;

void checkQueueName(const std::string& text) {
    const ACE_CString queue(text.data(), text.size());
    ACE_CString host, name;
    if (!Configuration::MSMQConfiguration::ParseDirectFormattedMSMQ(queue, host, name)) {
        if (Configuration::MSMQConfiguration::HostFromQueue(queue).length() != 0) {
            std::abort();
        }
        return;
    }
    const std::size_t colon = text.find(':');
    const std::string rebuilt = text.substr(0, colon + 1) +
                                std::string(host.c_str(), host.length()) + "\\" +
                                std::string(name.c_str(), name.length());
    if (rebuilt != text) {
        std::abort();
    }
}

// Every child of children read as a chain round-trips through the element form.
void checkChains(const Vesk::MultiElementValue& children) {
    for (const Vesk::Element& child : children) {
        Chain chain;
        Configuration::ChainUtils::getChainFromVesk(child.key(), children, chain);
        Vesk::Element holder("Holder", -1);
        Configuration::ChainUtils::addChainToVesk("Chain", chain, holder.addMultiElement());
        Chain again;
        if (!Configuration::ChainUtils::getChainFromVesk("Chain", holder.getMultiElement(),
                                                         again) ||
            !sameLinks(chain, again)) {
            std::abort();
        }
        Configuration::ChainUtils::chainToString(chain);
        for (const auto& link : chain) {
            Configuration::ChainUtils::nextLink(link.getHost(), chain);
        }
    }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string text(reinterpret_cast<const char*>(data), size);
    checkQueueName(text);
    Vesk::Element tree;
    if (!ClassFuzz::parse(data, size, tree)) {
        return 0;
    }
    if (tree.hasValue() && tree.value().kind() == Vesk::Value::Kind::MultiElement) {
        checkChains(tree.getMultiElement());
    }
    ClassFuzz::readTwice<Configuration::MSMQCommonConfiguration>(tree);
    ClassFuzz::readTwice<Configuration::RulesConfiguration>(tree);
    ClassFuzz::readTwice<Configuration::LocationConfiguration>(tree);
    return 0;
}
