#include "SopServiceReport.h"

#include <algorithm>
#include <cstddef>
#include <string>

#include "Configuration/SOPServiceConfiguration.h"
#include "JsonText.h"

namespace Configctl {
namespace {

using Configuration::SOPService;
using Configuration::TransferSyntax;

// Text padded with blanks to width.
std::string padded(const std::string& text, std::size_t width) {
    return text.size() >= width ? text : text + std::string(width - text.size(), ' ');
}

std::size_t enabledCount(const SOPService& service) {
    const auto& entries = service.getTransferSyntaxList().getTransferSyntaxes();
    return static_cast<std::size_t>(
        std::count_if(entries.begin(), entries.end(),
                      [](const TransferSyntax& entry) { return entry.getEnabled(); }));
}

void printService(const SOPService& service, std::ostream& out) {
    const auto& entries = service.getTransferSyntaxList().getTransferSyntaxes();
    const std::string templateName = service.getTemplateName().c_str();
    out << service.getName().c_str() << "\n"
        << "  UID          " << service.getUID().c_str() << "\n"
        << "  Object type  " << Configuration::sopObjectTypeText(service.getObjectType()) << "\n"
        << "  Template     " << (templateName.empty() ? "(numbers)" : templateName) << "\n"
        << "  Offered      " << (service.getEnabled() ? "yes" : "no") << "\n"
        << "  Transfer syntaxes: " << enabledCount(service) << " of " << entries.size()
        << " enabled\n";
    std::size_t width = 0;
    for (const TransferSyntax& entry : entries) {
        width = std::max(width, entry.getUID().length());
    }
    for (const TransferSyntax& entry : entries) {
        if (entry.getEnabled()) {
            out << "    " << padded(entry.getUID().c_str(), width) << "  "
                << entry.getName().c_str() << "\n";
        }
    }
}

void writeServiceJson(const SOPService& service, JsonWriter& json) {
    json.beginObject().field("name", service.getName()).field("uid", service.getUID());
    json.field("objectType", Configuration::sopObjectTypeText(service.getObjectType()));
    json.key("template").optional(service.getTemplateName().c_str());
    json.field("offered", service.getEnabled()).key("transferSyntaxes").beginArray();
    for (const TransferSyntax& entry : service.getTransferSyntaxList().getTransferSyntaxes()) {
        json.beginObject().field("uid", entry.getUID()).field("name", entry.getName());
        json.field("enabled", entry.getEnabled()).endObject();
    }
    json.endArray().endObject();
}

}  // namespace

void printSopServices(const Configuration::SOPServiceConfiguration& config, std::ostream& out) {
    const auto& services = config.getSOPServiceList().getSOPServices();
    const std::size_t offered = static_cast<std::size_t>(std::count_if(
        services.begin(), services.end(), [](const SOPService& s) { return s.getEnabled(); }));
    out << config.getDescription().c_str() << "\n"
        << "Version " << config.getVersion().c_str() << " of " << config.getReleaseDate().c_str()
        << ", product " << config.getProductVersion().c_str() << "\n"
        << services.size() << " services (" << offered << " offered), "
        << config.getSupportedTransferSyntaxList().getSupportedTransferSyntaxes().size()
        << " transfer syntaxes, "
        << config.getTemplateTransferSyntaxLists().getTemplateTransferSyntaxLists().size()
        << " templates\n";
    for (const SOPService& service : services) {
        out << "\n";
        printService(service, out);
    }
}

void printSopServicesJson(const Configuration::SOPServiceConfiguration& config, std::ostream& out) {
    JsonWriter json(out);
    json.beginObject().field("description", config.getDescription());
    json.field("version", config.getVersion()).field("releaseDate", config.getReleaseDate());
    json.field("productVersion", config.getProductVersion()).key("services").beginArray();
    for (const SOPService& service : config.getSOPServiceList().getSOPServices()) {
        writeServiceJson(service, json);
    }
    json.endArray().endObject();
}

}  // namespace Configctl
