// ServiceTicketModule: the companion module libServerInterop.so, which hands out this machine's
// service ticket for the configuration service.
//
// The process-wide instance is loaded once, while this library is being loaded (a failure is
// only remembered). It is looked for, in order: at the path in QUORVEX_SERVERINTEROP_LIBRARY when
// that variable is set (and nowhere else then); next to the binary that holds this code
// (libConfiguration.so, or a program linking it statically); next to the platform library
// libQuorvexCommon.so (where the build puts it, and where it is installed); then by name through
// the dynamic loader's search path (LD_LIBRARY_PATH, system directories).
//
// Thread-safety: fetch() may be called from any thread; the function's address is cached in an
// atomic, so two first calls at once only repeat the look-up.
#pragma once

#include <ace/SString.h>

#include <atomic>
#include <string>
#include <vector>

namespace Configuration {

class ServiceTicketModule {
public:
    // Environment variable naming the module to load instead of searching for it.
    static constexpr const char* LIBRARY_VARIABLE = "QUORVEX_SERVERINTEROP_LIBRARY";
    static constexpr const char* LIBRARY_NAME = "libServerInterop.so";
    // ServerInterop::ServerInteropAPI::GetQuorvexServiceTicket(ACE_String_Base<char>&).
    static constexpr const char* TICKET_FUNCTION =
        "_ZN13ServerInterop16ServerInteropAPI23GetQuorvexServiceTicketER15ACE_String_BaseIcE";

    // Loads the first candidate that opens; none: the module is missing.
    explicit ServiceTicketModule(const std::vector<std::string>& candidates);
    ~ServiceTicketModule();
    ServiceTicketModule(const ServiceTicketModule&) = delete;
    ServiceTicketModule& operator=(const ServiceTicketModule&) = delete;

    // Whether a module was loaded.
    bool loaded() const { return m_handle != nullptr; }
    // Asks the module for the ticket: 0 and the ticket in ticket, or the module's non-zero
    // result. std::exception when the module is missing or does not export the function.
    int fetch(ACE_CString& ticket);

    // The process-wide module, loaded when this library was loaded.
    static ServiceTicketModule& process();
    // Where the process-wide module is looked for, in order.
    static std::vector<std::string> defaultCandidates();

private:
    using TicketFunction = int (*)(ACE_CString&);

    void* m_handle;
    std::atomic<TicketFunction> m_function{nullptr};
};

}  // namespace Configuration
