// The list syntax of transfer-syntax numbers fed arbitrary bytes. The numbers it gives must be the
// maximal runs of ASCII digits, each taken modulo 2^32; and a service whose default list and
// modification list are those bytes (split at the first line break) resolves, against a fixed
// table with a repeated and extreme numbers, to each table number at most once, enabled only
// when the modification list names it. Any mismatch aborts.
#include <ace/Log_Msg.h>

#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <set>
#include <string>
#include <vector>

#include "Configuration/SOPServiceConfiguration.h"
#include "NumberList.h"

namespace {

using Configuration::NumberList::isDigit;

// The maximal digit runs of text, modulo 2^32, computed without the scanner.
std::vector<int> digitRuns(const std::string& text) {
    std::vector<int> runs;
    for (std::size_t i = 0; i < text.size();) {
        if (!isDigit(text[i])) {
            ++i;
            continue;
        }
        std::uint64_t value = 0;
        for (; i < text.size() && isDigit(text[i]); ++i) {
            value = (value * 10 + static_cast<std::uint64_t>(text[i] - '0')) % (1ull << 32);
        }
        runs.push_back(static_cast<std::int32_t>(static_cast<std::uint32_t>(value)));
    }
    return runs;
}

std::vector<int> scanned(const std::string& text) {
    std::vector<int> numbers;
    Configuration::NumberList::scan(text.data(), text.size(),
                                    [&](int nr) { numbers.push_back(nr); });
    return numbers;
}

const int kTable[] = {0, 1, 2, 3, 7, 7, 12, 255, 2147483647, -2147483647 - 1, -1};

void addText(Vesk::MultiElementValue& parent, const char* key, const std::string& value) {
    parent.addElement(key, {}, -1).addSingle().assign(value.data(), value.size());
}

Vesk::Element serviceDocument(const std::string& defaultList, const std::string* modification) {
    Vesk::Element tree("SOPServiceConfiguration", -1);
    Vesk::MultiElementValue& root = tree.addMultiElement();
    Vesk::MultiElementValue& rows = root.addElement("SupportedTxList", {}, -1).addMultiElement();
    for (int nr : kTable) {
        Vesk::MultiElementValue& row = rows.addElement("SupportedTx", {}, -1).addMultiElement();
        addText(row, "TxNr", std::to_string(nr));
        addText(row, "TxUID", "1.2." + std::to_string(nr));
        addText(row, "TxName", "row");
    }
    Vesk::MultiElementValue& service = root.addElement("SOPServiceList", {}, -1)
                                           .addMultiElement()
                                           .addElement("SOPService", {}, -1)
                                           .addMultiElement();
    addText(service, "TxListDefault", defaultList);
    if (modification != nullptr) {
        addText(service, "TxList", *modification);
    }
    return tree;
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    static const bool quiet = [] {  // read failures are expected here; logging them only slows
        ACE_LOG_MSG->priority_mask(LM_CRITICAL, ACE_Log_Msg::PROCESS);
        return true;
    }();
    (void)quiet;
    const std::string text(reinterpret_cast<const char*>(data), size);
    if (scanned(text) != digitRuns(text)) {
        std::abort();
    }
    const std::size_t split = text.find('\n');
    const std::string defaultList = text.substr(0, split);
    const std::string modification = split == std::string::npos ? "" : text.substr(split + 1);
    Configuration::SOPServiceConfiguration config;
    config.readVesk(
        serviceDocument(defaultList, split == std::string::npos ? nullptr : &modification));
    const std::set<int> table(std::begin(kTable), std::end(kTable));
    const std::vector<int> named = digitRuns(modification);
    const std::set<int> enabling(named.begin(), named.end());
    std::set<int> seen;
    const auto& service = config.getSOPServiceList().getSOPServices().at(0);
    for (const auto& entry : service.getTransferSyntaxList().getTransferSyntaxes()) {
        const bool mayBeEnabled = split == std::string::npos || enabling.count(entry.getNr()) == 1;
        if (!seen.insert(entry.getNr()).second || table.count(entry.getNr()) == 0 ||
            (entry.getEnabled() && !mayBeEnabled)) {
            std::abort();
        }
    }
    return 0;
}
