// A whole SOP service document read from arbitrary XML. Reading never throws; every resolved list
// holds only numbers of the master table, each at most once, and a template name only when a
// template of that name exists; a copy compares equal; writing is refused. Any mismatch aborts.
#include <ace/Log_Msg.h>

#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <exception>
#include <set>

#include "Configuration/SOPServiceConfiguration.h"
#include "Vesk/XmlUtils.h"

namespace {

using namespace Configuration;

void checkList(const TransferSyntaxList& list, const std::set<int>& table) {
    std::set<int> seen;
    for (const TransferSyntax& entry : list.getTransferSyntaxes()) {
        if (!seen.insert(entry.getNr()).second || table.count(entry.getNr()) == 0) {
            std::abort();
        }
    }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    static const bool quiet = [] {  // read failures are expected here; logging them only slows
        ACE_LOG_MSG->priority_mask(LM_CRITICAL, ACE_Log_Msg::PROCESS);
        return true;
    }();
    (void)quiet;
    Vesk::Element tree;
    try {
        Vesk::XmlUtils::parse(reinterpret_cast<const char*>(data), size, tree);
    } catch (const std::exception&) {
        return 0;  // refused cleanly
    }
    SOPServiceConfiguration config;
    config.readVesk(tree);
    std::set<int> table;
    for (const auto& row : config.getSupportedTransferSyntaxList().getSupportedTransferSyntaxes()) {
        table.insert(row.getNr());
    }
    std::set<std::string> templateNames;
    for (const auto& entry :
         config.getTemplateTransferSyntaxLists().getTemplateTransferSyntaxLists()) {
        checkList(entry.getTransferSyntaxList(), table);
        templateNames.insert(std::string(entry.getName().c_str(), entry.getName().length()));
    }
    for (const SOPService& service : config.getSOPServiceList().getSOPServices()) {
        checkList(service.getTransferSyntaxList(), table);
        const ACE_CString& name = service.getTemplateName();
        if (name.length() > 0 &&
            templateNames.count(std::string(name.c_str(), name.length())) == 0) {
            std::abort();
        }
    }
    const SOPServiceConfiguration copy = config;
    if (!(copy == config)) {
        std::abort();
    }
    try {
        config.writeVesk();
    } catch (const std::exception&) {
        return 0;
    }
    std::abort();
}
