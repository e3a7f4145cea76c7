#include "Client/ServiceTicketModule.h"

#include <dlfcn.h>
#include <limits.h>
#include <stdlib.h>

#include <algorithm>
#include <cstdlib>
#include <stdexcept>

#include "Quorvex/Host.h"

namespace Configuration {

namespace {

// The folder of the loaded object (shared library or program) that holds address.
std::string folderOf(const void* address) {
    Dl_info info{};
    if (dladdr(address, &info) == 0 || info.dli_fname == nullptr) {
        return std::string();
    }
    char resolved[PATH_MAX];
    const std::string path =
        realpath(info.dli_fname, resolved) != nullptr ? resolved : info.dli_fname;
    const auto slash = path.rfind('/');
    return slash == std::string::npos ? std::string() : path.substr(0, slash);
}

void addCandidate(std::vector<std::string>& candidates, const std::string& folder) {
    if (folder.empty()) {
        return;
    }
    const std::string path = folder + "/" + ServiceTicketModule::LIBRARY_NAME;
    if (std::find(candidates.begin(), candidates.end(), path) == candidates.end()) {
        candidates.push_back(path);
    }
}

// Loads the module as soon as this library is loaded; failures are remembered by the instance.
[[maybe_unused]] ServiceTicketModule& g_loadedAtStart = ServiceTicketModule::process();

}  // namespace

ServiceTicketModule::ServiceTicketModule(const std::vector<std::string>& candidates)
    : m_handle(nullptr) {
    for (const auto& candidate : candidates) {
        m_handle = dlopen(candidate.c_str(), RTLD_NOW | RTLD_LOCAL);
        if (m_handle != nullptr) {
            break;
        }
    }
}

ServiceTicketModule::~ServiceTicketModule() {
    if (m_handle != nullptr) {
        dlclose(m_handle);
    }
}

int ServiceTicketModule::fetch(ACE_CString& ticket) {
    if (m_handle == nullptr) {
        throw std::runtime_error("ServerInterop DLL is missing. Unable to get service ticket");
    }
    TicketFunction function = m_function.load(std::memory_order_acquire);
    if (function == nullptr) {
        function = reinterpret_cast<TicketFunction>(dlsym(m_handle, TICKET_FUNCTION));
        if (function == nullptr) {
            throw std::runtime_error(
                "Unable to export GetQuorvexServiceTicket from serverinterop.dll");
        }
        m_function.store(function, std::memory_order_release);
    }
    ticket.clear();
    return function(ticket);
}

ServiceTicketModule& ServiceTicketModule::process() {
    // Never unloaded: the module stays mapped until the process ends.
    static ServiceTicketModule* const module = new ServiceTicketModule(defaultCandidates());
    return *module;
}

std::vector<std::string> ServiceTicketModule::defaultCandidates() {
    if (const char* path = std::getenv(LIBRARY_VARIABLE)) {
        return {path};
    }
    std::vector<std::string> candidates;
    addCandidate(candidates, folderOf(reinterpret_cast<const void*>(&folderOf)));
    // The platform libraries' folder: where the module is built and installed beside them.
    addCandidate(candidates, folderOf(reinterpret_cast<const void*>(&Quorvex::GetHostName)));
    candidates.push_back(LIBRARY_NAME);
    return candidates;
}

}  // namespace Configuration
