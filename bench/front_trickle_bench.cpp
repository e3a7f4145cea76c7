// The service's HTTP front under many trickling peers: the real configuration-service on
// 127.0.0.1 holds N connections that each send one byte of a request head every two seconds (and
// come back when the service closes them), while one client sends good requests, each on a new
// connection as the configuration client does. Prints how many good requests were answered, their
// p50/p99/max times quiet and under the trickle with the ratio, how many trickling connections
// were open, and the service's peak resident memory.
//
// Usage: front_trickle_bench [--connections N] [--requests M] [--service PATH] [--plain]
//   --plain: pass no front options to the service (for a service that has none).
#include <algorithm>
#include <atomic>
#include <chrono>
#include <cstdio>
#include <cstring>
#include <memory>
#include <string>
#include <thread>
#include <vector>

#include "ProcessMemory.h"
#include "RawConnection.h"
#include "ServiceProcess.h"
#include "TicketFile.h"
#include "testing/ScratchDir.h"

namespace {

using Clock = std::chrono::steady_clock;
using ServiceTesting::RawConnection;

constexpr const char* kCookie = "OrvelWebApplication=trickle-bench";
const std::chrono::milliseconds kGiveUp{2000};  // a good request later than this is lost
const std::chrono::seconds kTrickleInterval{2};

struct Settings {
    int connections = 1000;
    int requests = 2000;
    std::string binary;
    bool plain = false;
};

Settings parse(int argc, char** argv) {
    Settings settings;
    for (int i = 1; i < argc; ++i) {
        const std::string arg = argv[i];
        const bool hasValue = i + 1 < argc;
        if (arg == "--connections" && hasValue) {
            settings.connections = std::atoi(argv[++i]);
        } else if (arg == "--requests" && hasValue) {
            settings.requests = std::atoi(argv[++i]);
        } else if (arg == "--service" && hasValue) {
            settings.binary = argv[++i];
        } else if (arg == "--plain") {
            settings.plain = true;
        } else {
            std::fprintf(stderr, "front_trickle_bench: unknown argument %s\n", arg.c_str());
            std::exit(2);
        }
    }
    return settings;
}

// N connections sending a request head one byte at a time, each every two seconds, reopened
// when the service closes them; runs on its own thread until destroyed.
class Tricklers {
public:
    Tricklers(int port, int count) : m_port(port) {
        for (int i = 0; i < count; ++i) {
            m_peers.emplace_back(port);
        }
        m_thread = std::thread([this] { loop(); });
    }
    ~Tricklers() {
        m_stop = true;
        m_thread.join();
    }
    // Connections open at the last round (as far as this side has seen).
    int open() const { return m_open.load(); }
    // The fewest open at the end of any round since the first.
    int fewestOpen() const { return m_fewest.load(); }

private:
    struct Peer {
        explicit Peer(int port) : connection(port), alive(connection.isOpen()) {}
        RawConnection connection;
        bool alive;
        std::size_t sent = 0;
    };

    void loop() {
        const std::string head =
            "POST /Sundrel/ConfigurationService/ConfigurationService.ashx HTTP/1.1\r\nHost: x\r\n"
            "X-Slow: " +
            std::string(4000, 's') + "\r\n\r\n";
        const auto slice = kTrickleInterval / 20;
        int open = static_cast<int>(m_peers.size());
        for (std::size_t round = 0; !m_stop; ++round) {
            for (std::size_t i = round % 20; i < m_peers.size(); i += 20) {
                Peer& peer = m_peers[i];
                if (peer.connection.closedByPeer(std::chrono::milliseconds(0))) {
                    open -= peer.alive ? 1 : 0;
                    peer = Peer(m_port);
                    open += peer.alive ? 1 : 0;
                } else {
                    peer.connection.send(head.substr(peer.sent++ % head.size(), 1));
                }
            }
            m_open = open;
            if (round >= 20) {
                m_fewest = std::min(m_fewest.load(), open);
            }
            std::this_thread::sleep_for(slice);
        }
    }

    const int m_port;
    std::vector<Peer> m_peers;
    std::atomic<bool> m_stop{false};
    std::atomic<int> m_open{0};
    std::atomic<int> m_fewest{1 << 30};
    std::thread m_thread;
};

struct Figures {
    int answered = 0;
    double p50 = 0, p99 = 0, max = 0;
};

// Sends count good requests one after the other, each on a new connection.
Figures goodRequests(int port, int count) {
    std::vector<double> times;
    const std::string request = RawConnection::post(
        "<Exists><Host>h</Host><ConfigurationName>n</ConfigurationName></Exists>", kCookie);
    for (int i = 0; i < count; ++i) {
        const auto start = Clock::now();
        RawConnection connection(port);
        connection.send(request);
        if (connection.readAnswer(kGiveUp).status == 200) {
            times.push_back(
                std::chrono::duration<double, std::milli>(Clock::now() - start).count());
        }
    }
    Figures figures;
    figures.answered = static_cast<int>(times.size());
    if (!times.empty()) {
        std::sort(times.begin(), times.end());
        figures.p50 = times[times.size() / 2];
        figures.p99 = times[std::min(times.size() - 1, times.size() * 99 / 100)];
        figures.max = times.back();
    }
    return figures;
}

void print(const char* phase, const Figures& f, int requests) {
    std::printf("%-28s answered %5d/%-5d  p50 %8.2f ms  p99 %8.2f ms  max %8.2f ms\n", phase,
                f.answered, requests, f.p50, f.p99, f.max);
}

}  // namespace

int main(int argc, char** argv) {
    const Settings settings = parse(argc, argv);
    Quorvex::Testing::ScratchDir scratch;
    ServiceTesting::TicketFile ticket(scratch.path(), "trickle-bench");
    ServiceTesting::ServiceProcess::Settings service;
    service.storeDirectory = scratch.file("store");
    service.eventDirectory = scratch.file("events");
    service.hostName = "BenchHost";
    if (!settings.plain) {
        service.extraArguments = {"--max-connections-per-peer",
                                  std::to_string(settings.connections + 100)};
    }
    ServiceTesting::ServiceProcess process(service, settings.binary);
    const int port = process.port();

    const Figures quiet = goodRequests(port, settings.requests);
    ServiceTesting::PeakWatch memory(process.pid());
    Figures busy;
    int open = 0;
    int fewest = 0;
    {
        Tricklers tricklers(port, settings.connections);
        std::this_thread::sleep_for(kTrickleInterval + std::chrono::milliseconds(200));
        busy = goodRequests(port, settings.requests);
        open = tricklers.open();
        fewest = tricklers.fewestOpen();
    }
    std::printf("\nconfiguration service front: %d trickling connections (one byte per %d s)\n",
                settings.connections, static_cast<int>(kTrickleInterval.count()));
    print("quiet", quiet, settings.requests);
    print("under the trickle", busy, settings.requests);
    std::printf("p99 ratio trickle/quiet      %.2f\n", quiet.p99 > 0 ? busy.p99 / quiet.p99 : 0.0);
    std::printf("trickling connections open   %d at the end, %d at the fewest\n", open, fewest);
    std::printf("service peak resident        %.1f MiB\n",
                static_cast<double>(memory.peak()) / (1u << 20));
    return busy.answered == settings.requests ? 0 : 1;
}
