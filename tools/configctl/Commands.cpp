// configctl's commands.
#include "Commands.h"

#include <fstream>
#include <iostream>
#include <iterator>
#include <map>
#include <set>
#include <sstream>
#include <stdexcept>

#include "Configuration/HttpConfigurationClient.h"
#include "Configuration/SOPServiceConfiguration.h"
#include "Configuration/StoredForm.h"
#include "DicomSite.h"
#include "DicomSiteReport.h"
#include "JsonText.h"
#include "Quorvex/BDateTime.h"
#include "SopServiceReport.h"
#include "StorageTopologyReport.h"
#include "Vesk/XmlUtils.h"

namespace Configctl {
namespace {

std::string readFile(const std::string& path) {
    std::ifstream in(path, std::ios::binary);
    if (!in) {
        throw std::runtime_error("cannot read " + path);
    }
    return std::string(std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>());
}

// The tree as indented XML ending in exactly one line break.
std::string pretty(const Vesk::Element& tree) {
    std::string text = Vesk::XmlUtils::toString(tree, Vesk::Ordering::indented());
    while (!text.empty() && text.back() == '\n') {
        text.pop_back();
    }
    return text + "\n";
}

// The commands that print a list, and so can print it as JSON.
const std::set<std::string> kJsonCommands = {
    "archive",   "check",    "dicom-nodes", "folders",  "hosts", "items",
    "processes", "services", "sop",         "topology", "users",
};

}  // namespace

Commands::Commands(const ToolOptions& options, std::ostream& out)
    : m_options(options), m_out(out) {}

Commands::~Commands() = default;

void Commands::run() {
    using Command = void (Commands::*)();
    static const std::map<std::string, Command> commands = {
        {"check", &Commands::check},
        {"dicom-nodes", &Commands::dicomNodes},
        {"hosts", &Commands::hosts},
        {"items", &Commands::items},
        {"get", &Commands::get},
        {"put", &Commands::put},
        {"exists", &Commands::exists},
        {"time", &Commands::time},
        {"register", &Commands::registerService},
        {"unregister", &Commands::unregisterService},
        {"info", &Commands::info},
        {"whoami", &Commands::whoami},
        {"sop", &Commands::sopServices},
        {"topology", &Commands::topology},
        {"archive", &Commands::archive},
        {"processes", &Commands::processes},
        {"services", &Commands::services},
        {"users", &Commands::users},
        {"folders", &Commands::folders},
    };
    if (m_options.json && kJsonCommands.count(m_options.command) == 0) {
        throw std::invalid_argument("--output json: " + m_options.command +
                                    " prints text only (see --help)");
    }
    auto found = commands.find(m_options.command);
    if (found != commands.end()) {
        (this->*found->second)();
        return;
    }
    expectArguments(0, 0, m_options.command.c_str());
    if (m_options.command == "changed") {
        client().signalChanged();
    } else if (m_options.command == "refresh") {
        client().signalRefresh();
    } else if (m_options.command == "restart") {
        client().signalRestart();
    } else {
        throw std::invalid_argument("unknown command " + m_options.command + " (see --help)");
    }
}

Configuration::HttpConfigurationClient& Commands::client() {
    if (!m_client) {
        m_client.reset(new Configuration::HttpConfigurationClient(m_options.server.c_str(), true,
                                                                  m_options.https));
    }
    return *m_client;
}

std::ostream& Commands::notes() {
    return m_options.json || m_options.dot ? std::cerr : m_out;
}

ACE_CString Commands::host() {
    return m_options.host.empty() ? client().hostName() : ACE_CString(m_options.host.c_str());
}

void Commands::expectArguments(std::size_t min, std::size_t max, const char* form) const {
    const std::size_t count = m_options.arguments.size();
    if (count < min || count > max) {
        throw std::invalid_argument(std::string("usage: configctl ") + form);
    }
}

void Commands::hosts() {
    expectArguments(0, 0, "hosts [--module-type N]");
    std::vector<ACE_CString> hosts;
    if (m_options.moduleType >= 0) {
        client().listHostsByModuleType(m_options.moduleType, hosts);
    } else {
        client().listHosts(hosts);
    }
    if (m_options.json) {
        JsonWriter json(m_out);
        json.beginArray();
        for (const ACE_CString& name : hosts) {
            json.value(name);
        }
        json.endArray();
        return;
    }
    for (const ACE_CString& name : hosts) {
        m_out << name.c_str() << "\n";
    }
}

void Commands::items() {
    expectArguments(0, 0, "items [--host NAME|*]");
    std::vector<Configuration::_HttpConfigurationItemInfo> items;
    client().listItems(host(), items);
    if (m_options.json) {
        JsonWriter json(m_out);
        json.beginArray();
        for (const auto& item : items) {
            json.beginObject()
                .field("host", item.host)
                .field("name", item.configurationName)
                .field("lastModified", item.lastModifiedTime)
                .endObject();
        }
        json.endArray();
        return;
    }
    for (const auto& item : items) {
        m_out << item.lastModifiedTime.c_str() << "  " << item.host.c_str() << "  "
              << item.configurationName.c_str() << "\n";
    }
}

void Commands::get() {
    expectArguments(1, 1, "get NAME [--host NAME]");
    Quorvex::ByteArray bytes;
    std::size_t length = 0;
    client().retrieve(host(), m_options.arguments[0].c_str(), bytes, length);
    Vesk::Element tree;
    Configuration::StoredForm::decode(bytes.get(), length, tree);
    maskCredentials(tree);
    m_out << pretty(tree);
}

void Commands::put() {
    expectArguments(2, 2, "put NAME FILE [--host NAME] [--master]");
    const std::string xml = readFile(m_options.arguments[1]);
    Vesk::Element tree;
    Vesk::XmlUtils::parse(xml.data(), xml.size(), tree);
    const std::string stored = Configuration::StoredForm::encode(tree);
    const auto* data = reinterpret_cast<const unsigned char*>(stored.data());
    if (m_options.viaMaster) {
        client().storeMaster(host(), m_options.arguments[0].c_str(), data, stored.size(), "");
    } else {
        client().store(host(), m_options.arguments[0].c_str(), data, stored.size(), "");
    }
}

void Commands::exists() {
    expectArguments(1, 1, "exists NAME [--host NAME]");
    bool found = false;
    client().checkForExistence(host(), m_options.arguments[0].c_str(), found);
    m_out << (found ? "yes" : "no") << "\n";
}

void Commands::time() {
    expectArguments(1, 1, "time NAME [--host NAME]");
    BDateTime timestamp;
    client().getTimeStamp(host(), m_options.arguments[0].c_str(), timestamp);
    m_out << timestamp.ToString().c_str() << "\n";
}

void Commands::registerService() {
    expectArguments(1, 2, "register SERVICE [CONNECTION] [--host NAME]");
    const std::string connection = m_options.arguments.size() > 1 ? m_options.arguments[1] : "";
    client().registerService(host(), m_options.arguments[0].c_str(), connection.c_str());
}

void Commands::unregisterService() {
    expectArguments(1, 1, "unregister SERVICE");
    client().unregisterService(m_options.arguments[0].c_str());
}

void Commands::info() {
    expectArguments(0, 0, "info");
    const ACE_CString text = client().getServerInformation();
    Vesk::Element tree;
    Vesk::XmlUtils::parse(text.c_str(), text.length(), tree);
    m_out << pretty(tree);
}

void Commands::whoami() {
    expectArguments(0, 0, "whoami");
    m_out << "host " << client().hostName().c_str() << "\nmaster "
          << client().masterHostName().c_str() << "\n";
}

void Commands::sopServices() {
    expectArguments(0, 1, "sop [NAME] [--host NAME]");
    Configuration::SOPServiceConfiguration config;
    const std::string name =
        m_options.arguments.empty() ? config.path().c_str() : m_options.arguments[0];
    Quorvex::ByteArray bytes;
    std::size_t length = 0;
    client().retrieve(host(), name.c_str(), bytes, length);
    Vesk::Element tree;
    Configuration::StoredForm::decode(bytes.get(), length, tree);
    if (!config.readVesk(tree)) {
        notes() << "(incomplete: the document lacks required keys or holds unreadable entries)\n";
    }
    if (m_options.json) {
        printSopServicesJson(config, m_out);
    } else {
        printSopServices(config, m_out);
    }
}

// Site-wide documents live under the master's name, per-machine ones under --host.
void Commands::loadDicomSite(DicomSite& site) {
    const ACE_CString machine = host();
    ACE_CString master = client().masterHostName();
    if (master.empty()) {
        master = client().hostName();
    }
    site.load([&](const Configuration::ConfigDoc& document, Vesk::Element& tree) {
        const ACE_CString& owner = document.isLocal() ? machine : master;
        bool found = false;
        client().checkForExistence(owner, document.path(), found);
        if (!found) {
            return false;
        }
        Quorvex::ByteArray bytes;
        std::size_t length = 0;
        client().retrieve(owner, document.path(), bytes, length);
        Configuration::StoredForm::decode(bytes.get(), length, tree);
        return true;
    });
}

void Commands::dicomNodes() {
    expectArguments(0, 0, "dicom-nodes [--host NAME]");
    DicomSite site;
    loadDicomSite(site);
    if (m_options.json) {
        printDicomNodesJson(site, m_out);
    } else {
        printDicomNodes(site, m_out);
    }
}

void Commands::check() {
    expectArguments(0, 0, "check [--host NAME]");
    DicomSite site;
    loadDicomSite(site);
    const std::vector<SiteProblem> problems = checkSite(site);
    if (m_options.json) {
        printSiteCheckJson(site, problems, m_out);
    } else {
        printSiteCheck(site, problems, m_out);
    }
    if (!problems.empty()) {
        m_out.flush();
        throw CheckFailed(std::to_string(problems.size()) + " mistakes in the DICOM documents");
    }
}

}  // namespace Configctl
