// The server-information element.
#include "ServerInfo.h"

#include "TimeText.h"
#include "Vesk/XmlUtils.h"

#ifndef CONFIGURATION_SERVICE_VERSION
#define CONFIGURATION_SERVICE_VERSION "0"
#endif

namespace ConfigurationService {
namespace {

void addText(Vesk::MultiElementValue& list, const char* key, const std::string& text) {
    list.addElement(key, Vesk::Attributes(), -1).addSingle().assign(text.c_str());
}

}  // namespace

std::string ServerInfo::describe(ServiceContext& context) {
    using namespace std::chrono;
    const long long uptime = duration_cast<seconds>(steady_clock::now() - context.started).count();
    Vesk::Element info("ServerInfo");
    Vesk::MultiElementValue& list = info.addMultiElement();
    addText(list, "HostName", context.hostName);
    addText(list, "MasterHostName", context.master.knownHostName());
    addText(list, "IsMaster", context.master.isMaster() ? "1" : "0");
    addText(list, "MasterAddress", context.master.address());
    addText(list, "Version", CONFIGURATION_SERVICE_VERSION);
    addText(list, "StoreDirectory", context.store.directory().c_str());
    addText(list, "ItemCount", std::to_string(context.store.size()));
    addText(list, "RegisteredServices", std::to_string(context.store.services().size()));
    addText(list, "StartTime", TimeText::format(context.startedMs));
    addText(list, "UptimeSeconds", std::to_string(uptime));
    addText(list, "Port", std::to_string(context.port));
    return Vesk::XmlUtils::toString(info);
}

}  // namespace ConfigurationService
