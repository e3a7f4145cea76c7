// Slow, idle, oversized, unauthenticated, malformed and racing peers against the real service
// process. After every case a good request must be answered and nothing may have been written
// outside the store; the suite prints one row per case: the answer, the time to the next good
// answer and the service's peak resident memory during the case.
#include <gtest/gtest.h>

#include <algorithm>
#include <atomic>
#include <chrono>
#include <cstdio>
#include <filesystem>
#include <functional>
#include <map>
#include <memory>
#include <thread>
#include <vector>

#include "InProcessService.h"
#include "ProcessMemory.h"
#include "RawConnection.h"
#include "RawPost.h"
#include "ServiceProcess.h"
#include "TicketFile.h"
#include "testing/ScratchDir.h"

#if defined(__SANITIZE_ADDRESS__) || defined(__SANITIZE_THREAD__)
#define HOSTILE_MEMORY_CHECKS 0  // sanitizers hold freed memory back on purpose
#define HOSTILE_HUGE_MIB 12      // and are slow: smaller huge bodies keep the suite short
#else
#define HOSTILE_MEMORY_CHECKS 1
#define HOSTILE_HUGE_MIB 60
#endif

namespace ConfigurationService {
namespace {

using Clock = std::chrono::steady_clock;
using ServiceTesting::elementText;
using ServiceTesting::HttpAnswer;
using ServiceTesting::itemBody;
using ServiceTesting::RawConnection;
using std::chrono::milliseconds;

constexpr const char* kTicket = "hostile-ticket-0815";
constexpr const char* kCookie = "OrvelWebApplication=hostile-ticket-0815";
constexpr const char* kPath = "/Sundrel/ConfigurationService/ConfigurationService.ashx";
constexpr int kRequestTimeoutSeconds = 2;  // given to the service: every deadline case waits it
constexpr int kPeerCap = 1100;
constexpr std::size_t kMiB = 1u << 20;
constexpr std::size_t kHuge = HOSTILE_HUGE_MIB * kMiB;  // a huge body of many tags
constexpr std::size_t kDocument = kHuge / 2;            // a huge document in one parameter
const milliseconds kAnswerTime{5000};     // a good answer later than this counts as lost
const milliseconds kDeadlineSlack{2500};  // after the request timeout, before a close is late

double millisecondsSince(Clock::time_point start) {
    return std::chrono::duration<double, std::milli>(Clock::now() - start).count();
}

// One row of the printed table.
struct Row {
    std::string name;
    std::string answer;
    double nextGoodMs;
    std::size_t peakBytes;
};

// Files outside the store directory, with their sizes.
std::map<std::string, std::uintmax_t> filesOutside(const std::string& root,
                                                   const std::string& store) {
    std::map<std::string, std::uintmax_t> files;
    for (auto it = std::filesystem::recursive_directory_iterator(root);
         it != std::filesystem::recursive_directory_iterator(); ++it) {
        if (it->path() == store) {
            it.disable_recursion_pending();
        } else if (it->is_regular_file()) {
            files[it->path().string()] = it->file_size();
        }
    }
    return files;
}

class HostilePeers : public ::testing::Test {
protected:
    struct Case {
        std::string name;
        std::function<std::string()> attack;  // returns what the peer saw
        std::size_t peakLimitBytes = 0;       // growth allowed during the case; 0: no check
        std::size_t keptLimitBytes = 0;       // growth allowed after the case; 0: no check
    };

    static void SetUpTestSuite() {
        s_scratch.reset(new Quorvex::Testing::ScratchDir());
        s_ticket.reset(new ServiceTesting::TicketFile(s_scratch->path(), kTicket));
        ServiceTesting::ServiceProcess::Settings settings;
        settings.storeDirectory = s_scratch->file("store");
        settings.eventDirectory = s_scratch->file("events");
        settings.hostName = "HostileHost";
        settings.extraArguments = {"--request-timeout",
                                   std::to_string(kRequestTimeoutSeconds),
                                   "--keep-alive",
                                   "2",
                                   "--max-connections-per-peer",
                                   std::to_string(kPeerCap)};
        s_service.reset(new ServiceTesting::ServiceProcess(settings));
    }

    static void TearDownTestSuite() {
        std::printf("\n%-42s | %-58s | %12s | %9s\n", "case", "answer", "next good ms", "peak MiB");
        for (const Row& row : s_rows) {
            std::printf("%-42s | %-58s | %12.1f | %9.1f\n", row.name.c_str(), row.answer.c_str(),
                        row.nextGoodMs, static_cast<double>(row.peakBytes) / kMiB);
        }
        std::printf("(request timeout %d s; peak = the service's resident memory)\n",
                    kRequestTimeoutSeconds);
        s_service.reset();
        s_ticket.reset();
        s_scratch.reset();
    }

    static int port() { return s_service->port(); }
    static pid_t pid() { return s_service->pid(); }
    static std::string storeDirectory() { return s_scratch->file("store"); }

    // One good request on a new connection: its time in milliseconds, or -1 when unanswered.
    static double timeGoodRequest() {
        const auto start = Clock::now();
        RawConnection connection(port());
        connection.send(RawConnection::post(itemBody("Exists", "h", "n"), kCookie));
        const HttpAnswer answer = connection.readAnswer(kAnswerTime);
        if (answer.status != 200 || elementText(answer.body, "ReturnStatus") != "1") {
            return -1;
        }
        return millisecondsSince(start);
    }

    // Sends one request on a new connection and reads its answer.
    static HttpAnswer exchange(const std::string& request) {
        RawConnection connection(port());
        connection.send(request);
        return connection.readAnswer(kAnswerTime);
    }

    static std::string statusText(const HttpAnswer& answer) {
        return answer.status == 0 ? "no answer" : std::to_string(answer.status);
    }

    // Runs each case, then checks the next good answer, the files outside the store and the
    // memory, and records the row.
    static void run(const std::vector<Case>& cases) {
        for (const Case& c : cases) {
            const auto outside = filesOutside(s_scratch->path(), storeDirectory());
            const std::size_t before = ServiceTesting::residentBytes(pid());
            ServiceTesting::PeakWatch watch(pid());
            const std::string answer = c.attack();
            const double nextGood = timeGoodRequest();
            EXPECT_GE(nextGood, 0) << c.name << ": no good answer afterwards";
            EXPECT_EQ(filesOutside(s_scratch->path(), storeDirectory()), outside) << c.name;
            if (HOSTILE_MEMORY_CHECKS && c.peakLimitBytes != 0) {
                EXPECT_LT(watch.peak(), before + c.peakLimitBytes) << c.name;
            }
            if (HOSTILE_MEMORY_CHECKS && c.keptLimitBytes != 0) {
                std::this_thread::sleep_for(milliseconds(300));  // the trim runs after the answer
                EXPECT_LT(ServiceTesting::residentBytes(pid()), before + c.keptLimitBytes)
                    << c.name << ": memory was not given back";
            }
            s_rows.push_back(Row{c.name, answer, nextGood, watch.peak()});
        }
    }

    static std::unique_ptr<Quorvex::Testing::ScratchDir> s_scratch;
    static std::unique_ptr<ServiceTesting::TicketFile> s_ticket;
    static std::unique_ptr<ServiceTesting::ServiceProcess> s_service;
    static std::vector<Row> s_rows;
};

std::unique_ptr<Quorvex::Testing::ScratchDir> HostilePeers::s_scratch;
std::unique_ptr<ServiceTesting::TicketFile> HostilePeers::s_ticket;
std::unique_ptr<ServiceTesting::ServiceProcess> HostilePeers::s_service;
std::vector<Row> HostilePeers::s_rows;

// Opens count connections; those the service refused at once are closed by it.
std::vector<RawConnection> openConnections(int port, int count) {
    std::vector<RawConnection> connections;
    connections.reserve(static_cast<std::size_t>(count));
    for (int i = 0; i < count; ++i) {
        connections.emplace_back(port);
    }
    return connections;
}

// Sends text to every connection one byte per interval, on a thread of its own, until every
// connection is closed or the object is destroyed.
class Trickle {
public:
    Trickle(std::vector<RawConnection>& connections, std::string text, milliseconds interval)
        : m_thread([this, &connections, text, interval] {
              for (std::size_t at = 0; !m_stop && at < text.size(); ++at) {
                  for (RawConnection& c : connections) {
                      c.send(text.substr(at, 1));
                  }
                  std::this_thread::sleep_for(interval);
              }
          }) {}
    ~Trickle() {
        m_stop = true;
        m_thread.join();
    }

private:
    std::atomic<bool> m_stop{false};
    std::thread m_thread;
};

// Waits until the service closes every connection; the seconds it took, or -1 if it did not
// within the request timeout and its slack.
double secondsUntilAllClosed(std::vector<RawConnection>& connections, Clock::time_point start) {
    const auto deadline = start + std::chrono::seconds(kRequestTimeoutSeconds) + kDeadlineSlack;
    for (RawConnection& c : connections) {
        const auto left = std::chrono::duration_cast<milliseconds>(deadline - Clock::now());
        if (!c.closedByPeer(std::max(left, milliseconds(1)))) {
            return -1;
        }
    }
    return millisecondsSince(start) / 1000;
}

std::string closedText(int count, double seconds) {
    char text[64];
    std::snprintf(text, sizeof text, "%d closed after %.1f s", count, seconds);
    return seconds < 0 ? std::to_string(count) + " still open" : text;
}

// Good requests sent while a case goes on: how many of count were answered, and the 99th
// percentile of their times in milliseconds.
struct Meanwhile {
    int answered = 0;
    double p99Ms = 0;
};

Meanwhile goodRequestsMeanwhile(int count, const std::function<double()>& timeOne) {
    std::vector<double> times;
    for (int i = 0; i < count; ++i) {
        const double ms = timeOne();
        if (ms >= 0) {
            times.push_back(ms);
        }
    }
    Meanwhile result;
    result.answered = static_cast<int>(times.size());
    if (!times.empty()) {
        std::sort(times.begin(), times.end());
        result.p99Ms = times[std::min(times.size() - 1, times.size() * 99 / 100)];
    }
    return result;
}

std::string withMeanwhile(const std::string& text, const Meanwhile& meanwhile, int count) {
    char more[64];
    std::snprintf(more, sizeof more, "; good %d/%d p99 %.1f ms", meanwhile.answered, count,
                  meanwhile.p99Ms);
    return text + more;
}

// Peers that send slowly, send nothing, hold many sockets or do not read their answers: each is
// cut off at its deadline while good requests go on being answered.
TEST_F(HostilePeers, SlowIdleAndGreedyPeersAreCutOffWhileOthersAreServed) {
    const std::string head = std::string("POST ") + kPath +
                             " HTTP/1.1\r\nHost: 127.0.0.1\r\nCookie: " + kCookie +
                             "\r\nContent-Length: 1000\r\n\r\n";
    const auto meanwhile = [](int count) { return goodRequestsMeanwhile(count, timeGoodRequest); };
    run({
        {"70 request heads, one byte per 200 ms",
         [&] {
             const auto start = Clock::now();
             auto slow = openConnections(port(), 70);
             Trickle trickle(slow, head, milliseconds(200));
             const Meanwhile good = meanwhile(10);
             EXPECT_EQ(good.answered, 10);
             const double closed = secondsUntilAllClosed(slow, start);
             EXPECT_GT(closed, 0) << "a trickled head outlived its deadline";
             return withMeanwhile(closedText(70, closed), good, 10);
         }},
        {"80 half-sent bodies",
         [&] {
             const auto start = Clock::now();
             auto half = openConnections(port(), 80);
             for (RawConnection& c : half) {
                 c.send(head + std::string(500, 'A'));
             }
             const Meanwhile good = meanwhile(10);
             EXPECT_EQ(good.answered, 10);
             const double closed = secondsUntilAllClosed(half, start);
             EXPECT_GT(closed, 0) << "a half-sent body outlived its deadline";
             return withMeanwhile(closedText(80, closed), good, 10);
         }},
        {"1000 idle connections",
         [&] {
             const auto start = Clock::now();
             auto idle = openConnections(port(), 1000);
             const Meanwhile good = meanwhile(200);
             EXPECT_EQ(good.answered, 200);
             const double closed = secondsUntilAllClosed(idle, start);
             EXPECT_GT(closed, 0) << "an idle connection outlived its deadline";
             return withMeanwhile(closedText(1000, closed), good, 200);
         }},
        {"connections over the per-peer cap",
         [&] {
             auto held = openConnections(port(), kPeerCap);
             EXPECT_FALSE(held.back().closedByPeer(milliseconds(100)));
             RawConnection extra(port());
             const bool refused = extra.closedByPeer(milliseconds(1000));
             EXPECT_TRUE(refused) << "connection " << kPeerCap + 1 << " was admitted";
             return std::string(refused ? "connection 1101 closed at once" : "admitted");
         }},
        {"64 pipelined answers never read",
         [&] {
             const std::string document(256 * 1024, 'Q');
             exchange(RawConnection::post(
                 itemBody("Store", "h", "big", "<Configuration>" + document + "</Configuration>"),
                 kCookie));
             RawConnection reader(port());
             std::string requests;
             for (int i = 0; i < 64; ++i) {
                 requests += RawConnection::post(itemBody("Retrieve", "h", "big"), kCookie);
             }
             reader.send(requests);
             const auto start = Clock::now();
             const Meanwhile good = meanwhile(10);
             EXPECT_EQ(good.answered, 10);
             std::this_thread::sleep_for(std::chrono::seconds(kRequestTimeoutSeconds) +
                                         kDeadlineSlack - (Clock::now() - start));
             int answers = 0;
             while (reader.readAnswer(milliseconds(200)).status == 200) {
                 ++answers;
             }
             const bool closed = reader.closedByPeer(milliseconds(200));
             EXPECT_TRUE(closed) << "the service waited for a peer that does not read";
             EXPECT_LT(answers, 64);
             return withMeanwhile(std::string(closed ? "closed" : "open") + " after " +
                                      std::to_string(answers) + " answers read",
                                  good, 10);
         }},
    });
}

// Bodies too large, or without the ticket, are refused from the head before they are read; huge
// bodies cost a small multiple of their size, and the memory goes back afterwards.
TEST_F(HostilePeers, LargeAndUnauthenticatedBodiesAreRefusedEarlyAndCheaply) {
    const auto head = [](const std::string& cookie, const std::string& fields) {
        return std::string("POST ") + kPath + " HTTP/1.1\r\nHost: 127.0.0.1\r\n" +
               (cookie.empty() ? "" : "Cookie: " + cookie + "\r\n") + fields + "\r\n";
    };
    const auto headOnly = [](const std::string& request, int expected) {
        RawConnection c(port());
        c.send(request);
        const HttpAnswer answer = c.readAnswer(milliseconds(2000));
        EXPECT_EQ(answer.status, expected) << answer.body;
        return statusText(answer) + " before any body byte";
    };
    const std::string tags = "<Store>" + [] {
        std::string many;
        many.reserve(kHuge);
        while (many.size() < kHuge) {
            many += "<a/>";
        }
        return many;
    }() + "</Store>";
    run({
        {"declared 1 GiB body",
         [&] { return headOnly(head(kCookie, "Content-Length: 1073741824\r\n"), 413); }},
        {"10 MiB body without the ticket",
         [&] { return headOnly(head("", "Content-Length: 10485760\r\n"), 403); }},
        {"10 MiB body, wrong ticket, 100-continue",
         [&] {
             return headOnly(head("OrvelWebApplication=guess",
                                  "Expect: 100-continue\r\nContent-Length: 10485760\r\n"),
                             403);
         }},
        {"chunked body without the ticket",
         [&] {
             RawConnection c(port());
             c.send(head("", "Transfer-Encoding: chunked\r\n") + "10000\r\n" +
                    std::string(65536, '<') + "\r\n");
             const HttpAnswer answer = c.readAnswer(milliseconds(2000));
             EXPECT_EQ(answer.status, 403);
             return statusText(answer) + " after 4 KiB";
         }},
        {std::to_string(kHuge / kMiB) + " MiB of <a/>",
         [&] {
             const HttpAnswer answer = exchange(RawConnection::post(tags, kCookie));
             EXPECT_EQ(answer.status, 400);
             EXPECT_NE(answer.body.find("tags"), std::string::npos) << answer.body;
             return statusText(answer);
         },
         3 * kHuge, 16 * kMiB},
        {"4 x " + std::to_string(kHuge / kMiB) + " MiB of <a/> at once",
         [&] {
             std::vector<std::thread> senders;
             std::atomic<int> refused{0};
             for (int i = 0; i < 4; ++i) {
                 senders.emplace_back([&] {
                     refused += exchange(RawConnection::post(tags, kCookie)).status == 400;
                 });
             }
             for (std::thread& t : senders) {
                 t.join();
             }
             EXPECT_EQ(refused.load(), 4);
             return std::to_string(refused.load()) + " x 400";
         },
         3 * 4 * kHuge, 16 * kMiB},
        {std::to_string(kDocument / kMiB) + " MiB document stored, memory given back",
         [&] {
             const std::size_t before = ServiceTesting::residentBytes(pid());
             const std::string document(kDocument, 'B');
             const HttpAnswer answer = exchange(RawConnection::post(
                 itemBody("Store", "h", "huge", "<Configuration>" + document + "</Configuration>"),
                 kCookie));
             EXPECT_EQ(elementText(answer.body, "ReturnStatus"), "1") << answer.body;
             std::this_thread::sleep_for(milliseconds(300));
             const std::size_t after = ServiceTesting::residentBytes(pid());
             if (HOSTILE_MEMORY_CHECKS) {
                 // The store keeps the decoded document (3/4 of its text); the body and its
                 // copies are gone.
                 EXPECT_LT(after, before + kDocument * 3 / 4 + 16 * kMiB);
             }
             return statusText(answer) + ", +" +
                    std::to_string((after - std::min(after, before)) / kMiB) + " MiB kept";
         },
         4 * kDocument},
    });
}

// What HTTP/1.1 asks of a server: pipelined requests in order, absolute-form targets, 405 with
// Allow for other methods, clear refusals of malformed heads.
TEST_F(HostilePeers, HttpIsSpokenAsHttp11Says) {
    const std::string exists = RawConnection::post(itemBody("Exists", "h", "n"), kCookie);
    const auto raw = [](const std::string& request) { return exchange(request); };
    const auto withTarget = [](const std::string& method, const std::string& target) {
        return method + " " + target + " HTTP/1.1\r\nHost: 127.0.0.1\r\nCookie: " + kCookie +
               "\r\nContent-Length: 0\r\n\r\n";
    };
    run({
        {"three pipelined requests",
         [&] {
             RawConnection c(port());
             c.send(RawConnection::post("<GetHostName></GetHostName>", "") + exists +
                    RawConnection::post(itemBody("Retrieve", "h", "absent"), kCookie));
             std::string roots;
             for (int i = 0; i < 3; ++i) {
                 const std::string body = c.readAnswer(kAnswerTime).body;
                 roots += body.substr(1, body.find('>') - 1) + " ";
             }
             EXPECT_EQ(roots, "GetHostNameResponse ExistsResponse RetrieveResponse ");
             return roots;
         }},
        {"absolute-form target with query",
         [&] {
             std::string request = exists;
             request.replace(5, 0, "http://127.0.0.1:" + std::to_string(port()));
             request.insert(request.find(" HTTP/1.1"), "?x=1");
             const HttpAnswer answer = raw(request);
             EXPECT_EQ(answer.status, 200) << answer.body;
             return statusText(answer);
         }},
        {"PUT, DELETE, OPTIONS, GET",
         [&] {
             std::string statuses;
             for (const char* method : {"PUT", "DELETE", "OPTIONS", "GET"}) {
                 HttpAnswer answer = raw(withTarget(method, kPath));
                 EXPECT_EQ(answer.status, 405) << method;
                 EXPECT_EQ(answer.fields["allow"], "POST") << method;
                 statuses += statusText(answer) + " ";
             }
             return statuses + "Allow: POST";
         }},
        {"unknown path", [&] { return statusText(raw(withTarget("POST", "/other"))); }},
        {"garbage request line",
         [&] {
             const HttpAnswer answer = raw("HELLO THERE\r\n\r\n");
             EXPECT_EQ(answer.status, 400);
             return statusText(answer);
         }},
        {"64 KiB request head",
         [&] {
             const HttpAnswer answer =
                 raw(RawConnection::post("<GetHostName></GetHostName>", kCookie,
                                         "X-Filler: " + std::string(65536, 'f') + "\r\n"));
             EXPECT_EQ(answer.status, 431);
             return statusText(answer);
         }},
        {"two different Content-Lengths",
         [&] {
             const HttpAnswer answer = raw(RawConnection::post("<GetHostName></GetHostName>",
                                                               kCookie, "Content-Length: 5\r\n"));
             EXPECT_EQ(answer.status, 400);
             return statusText(answer);
         }},
        {"100-continue with the ticket",
         [&] {
             RawConnection c(port());
             const std::string body = itemBody("Exists", "h", "n");
             c.send(std::string("POST ") + kPath + " HTTP/1.1\r\nHost: x\r\nCookie: " + kCookie +
                    "\r\nExpect: 100-continue\r\nContent-Length: " + std::to_string(body.size()) +
                    "\r\n\r\n");
             const HttpAnswer interim = c.readAnswer(milliseconds(2000));
             c.send(body);
             const HttpAnswer answer = c.readAnswer(milliseconds(2000));
             EXPECT_EQ(interim.status, 100);
             EXPECT_EQ(answer.status, 200);
             return statusText(interim) + " then " + statusText(answer);
         }},
    });
}

// Request bodies that attack the XML parser or the store's names.
TEST_F(HostilePeers, HostileXmlIsRefusedOrStoredSafely) {
    const auto post = [](const std::string& body) {
        return exchange(RawConnection::post(body, kCookie));
    };
    run({
        {"200,000 nested elements",
         [&] {
             std::string deep;
             for (int i = 0; i < 200000; ++i) {
                 deep += "<a>";
             }
             const HttpAnswer answer = post(deep);
             EXPECT_EQ(answer.status, 400);
             return statusText(answer);
         }},
        {"entity declarations (a billion laughs)",
         [&] {
             std::string doctype = "<!DOCTYPE Exists [<!ENTITY l0 \"lol\">";
             for (int i = 1; i < 10; ++i) {
                 const std::string previous = "&l" + std::to_string(i - 1) + ";";
                 doctype += "<!ENTITY l" + std::to_string(i) + " \"" + previous + previous +
                            previous + previous + "\">";
             }
             const HttpAnswer answer = post(doctype + "]>" + itemBody("Exists", "&l9;", "&l9;"));
             EXPECT_LT(answer.body.size(), 4096u);
             return statusText(answer) + ", " + std::to_string(answer.body.size()) + " bytes";
         }},
        {"invalid UTF-8 in names",
         [&] {
             const std::string name = "bad\xff\xfe\xc0\x80name";
             post(itemBody("Store", "h\xff", name, "<Configuration>AA==</Configuration>"));
             const HttpAnswer got = post(itemBody("Retrieve", "h\xff", name));
             EXPECT_EQ(elementText(got.body, "Configuration"), "AA==") << got.body;
             return "stored, read back " + elementText(got.body, "ReturnStatus");
         }},
        {"NUL bytes in names",
         [&] {
             const HttpAnswer answer =
                 post(itemBody("Store", std::string("h\0x", 3), std::string("n\0", 2),
                               "<Configuration>AA==</Configuration>"));
             EXPECT_NE(elementText(answer.body, "ReturnStatus"), "1") << answer.body;
             return statusText(answer) + ", ReturnStatus " +
                    elementText(answer.body, "ReturnStatus");
         }},
    });
}

}  // namespace
}  // namespace ConfigurationService
