// CrashBurst: the crash-safety tests' scaffolding: a scratch store with its ticket, and a burst
// of writer threads against a service killed with SIGKILL in the middle of it. Not thread-safe.
#pragma once

#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "ServiceProcess.h"
#include "TicketFile.h"
#include "testing/ScratchDir.h"

namespace ServiceTesting {

// A scratch directory with the ticket file, and the settings of a service storing under it.
class CrashScene {
public:
    CrashScene(const std::string& ticket, const std::string& hostName);
    const ServiceProcess::Settings& settings() const { return m_settings; }
    // The cookie that carries the ticket.
    std::string cookie() const { return "OrvelWebApplication=" + m_ticket.ticket(); }

private:
    Quorvex::Testing::ScratchDir m_scratch;
    TicketFile m_ticket;
    ServiceProcess::Settings m_settings;
};

// A write the service acknowledged, with its answer.
struct Acknowledged {
    int writer;
    int index;
    std::string answer;
};

// writers threads call write(writer, index) for index 0 to perWriter - 1, each stopping at its
// first write that gives no answer; after killAfter acknowledgements (or waitMs) the service is
// killed with SIGKILL. Returns the acknowledged writes once every thread has ended; none when
// the service did not die.
std::vector<Acknowledged> killMidBurst(
    ServiceProcess& service, int writers, int perWriter, int killAfter, int waitMs,
    const std::function<std::optional<std::string>(int writer, int index)>& write);

// How many times needle occurs in text.
std::size_t occurrences(const std::string& text, const std::string& needle);

}  // namespace ServiceTesting
