// A whole SOP service document read from arbitrary XML. Reading never throws; every resolved list
// holds only numbers of the master table, each at most once, and a template name only when a
// template of that name exists; a copy compares equal; writing is refused. Any mismatch aborts.
#include <set>

#include "ClassFuzz.h"
#include "Configuration/SOPServiceConfiguration.h"

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
    Vesk::Element tree;
    if (!ClassFuzz::parse(data, size, tree)) {
        return 0;
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
    ClassFuzz::copiesEqual(config);
    ClassFuzz::refusesWrite(config);
    return 0;
}
