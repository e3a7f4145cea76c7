// The HTTP front of the configuration service over cpp-httplib.
#include "ConfigurationServer.h"

#include <httplib.h>
#include <sys/socket.h>

#include <algorithm>
#include <cstdint>
#include <stdexcept>

#include "Answer.h"
#include "Quorvex/Host.h"
#include "Quorvex/Log.h"
#include "RequestDispatcher.h"
#include "TimeText.h"

namespace ConfigurationService {
namespace {

constexpr int kListenBacklog = 1024;
constexpr const char* kContentType = "text/xml";

std::string messageForStatus(int status) {
    switch (status) {
        case 404:
            return std::string("no such service path; POST to ") + ConfigurationServer::kPath;
        case 405:
            return "the configuration service answers POST only";
        case 413:
            return "the request body is larger than this service accepts";
        default:
            return "HTTP error " + std::to_string(status);
    }
}

std::string ownHostName(const ServiceOptions& options) {
    if (!options.hostName.empty()) {
        return options.hostName;
    }
    const std::string name = Quorvex::GetHostName(false).c_str();
    if (name.empty()) {
        throw std::runtime_error("cannot find this machine's host name; give --host-name");
    }
    return name;
}

}  // namespace

ConfigurationServer::ConfigurationServer(const ServiceOptions& options,
                                         const std::string& serviceTicket)
    : m_store(new Configuration::DirectoryStore(options.storeDirectory.c_str())),
      m_changes(new ChangeNotifier()),
      m_tickets(new TicketCheck(serviceTicket)),
      m_http(new httplib::Server()) {
    const std::string hostName = ownHostName(options);
    m_master.reset(new MasterLink(hostName, options.masterAddress, options.masterHostName));
    m_context.reset(new ServiceContext{*m_store, *m_master, *m_changes, hostName});
    m_context->startedMs = TimeText::now();
    m_dispatcher.reset(new RequestDispatcher(*m_context, *m_tickets));
    configureHttp(options);
    bindSocket(options);
    m_context->port = m_port;
}

ConfigurationServer::~ConfigurationServer() = default;

void ConfigurationServer::configureHttp(const ServiceOptions& options) {
    const std::size_t threads = static_cast<std::size_t>(options.threads);
    m_http->new_task_queue = [threads] { return new httplib::ThreadPool(threads); };
    m_http->set_keep_alive_max_count(1000000);
    m_http->set_keep_alive_timeout(options.keepAliveSeconds);
    m_http->set_tcp_nodelay(true);
    m_http->set_payload_max_length(options.maxBodyBytes);
    m_http->set_socket_options([this](int fd) {
        // SO_REUSEADDR only: SO_REUSEPORT would let a second instance share the port unnoticed.
        int yes = 1;
        ::setsockopt(fd, SOL_SOCKET, SO_REUSEADDR, &yes, sizeof yes);
        m_listenFd = fd;
    });
    // A content reader takes the body as it stands, whatever its declared type (the library
    // would otherwise parse form-encoded bodies itself and cap them at 8 KiB).
    const std::size_t maxBody = options.maxBodyBytes;
    m_http->Post(
        kPath, [this, maxBody](const httplib::Request& request, httplib::Response& response,
                               const httplib::ContentReader& readContent) {
            std::string body;
            body.reserve(std::min<std::size_t>(
                request.get_header_value<std::uint64_t>("Content-Length"), maxBody));
            const bool complete = readContent([&body](const char* data, std::size_t length) {
                body.append(data, length);
                return true;
            });
            if (!complete) {
                // The library set 413 for an oversized body; the error handler writes the answer.
                response.status = response.status >= 400 ? response.status : 400;
                return;
            }
            std::vector<std::string> cookies;
            for (std::size_t i = 0; i < request.get_header_value_count("Cookie"); ++i) {
                cookies.push_back(request.get_header_value("Cookie", i));
            }
            Reply reply = m_dispatcher->dispatch(body, cookies, request.remote_addr);
            response.status = reply.status;
            response.body = std::move(reply.body);
            response.set_header("Content-Type", kContentType);
        });
    m_http->Get(
        kPath, [](const httplib::Request&, httplib::Response& response) { response.status = 405; });
    m_http->set_error_handler([](const httplib::Request&, httplib::Response& response) {
        if (response.body.empty()) {
            response.body = Answer::failure("", messageForStatus(response.status));
            response.set_header("Content-Type", kContentType);
        }
    });
}

void ConfigurationServer::bindSocket(const ServiceOptions& options) {
    if (options.port == 0) {
        m_port = m_http->bind_to_any_port(options.bindAddress);
    } else if (m_http->bind_to_port(options.bindAddress, options.port)) {
        m_port = options.port;
    }
    if (m_port <= 0) {
        throw std::runtime_error("cannot listen on " + options.bindAddress + ":" +
                                 std::to_string(options.port));
    }
    // The library listens with a tiny backlog; a deeper one keeps bursts of new connections
    // from being dropped.
    if (m_listenFd >= 0) {
        ::listen(m_listenFd, kListenBacklog);
    }
}

bool ConfigurationServer::run() {
    return m_http->listen_after_bind();
}

void ConfigurationServer::stop() {
    m_http->stop();
}

bool ConfigurationServer::running() const {
    return m_http->is_running();
}

}  // namespace ConfigurationService
