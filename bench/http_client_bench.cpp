// Requests per second of HttpConfigurationClient::retrieve of a 4 KiB and a 64 KiB document
// against the loopback recording server, next to the same request sent by a bare libcurl loop
// that, like the client, opens a connection per request and closes it after the answer. Prints
// the client's share of the bare loop's rate for each size.
#include <benchmark/benchmark.h>
#include <curl/curl.h>

#include <algorithm>
#include <cstdio>
#include <map>
#include <memory>
#include <string>
#include <vector>

#include "Configuration/HttpConfigurationClient.h"
#include "Quorvex/Base64Coder.h"
#include "testing/RecordingHttpServer.h"

namespace {

using Quorvex::Testing::RecordingHttpServer;
using Quorvex::Testing::ScriptedResponse;

const char* const RETRIEVE_BODY =
    "<Retrieve><Host>bench-host</Host><ConfigurationName>Bench</ConfigurationName></Retrieve>";

std::string legacyOk(const std::string& inner) {
    return "<Answer><ReturnStatus>1</ReturnStatus>" + inner + "</Answer>";
}

// A loopback server that answers retrieve with one document of the given size.
class DocumentServer {
public:
    explicit DocumentServer(std::size_t size) : m_size(size) {
        std::string document(size, '\0');
        for (std::size_t i = 0; i < size; ++i) {
            document[i] = static_cast<char>("<Element key=\"x\">1</Element>\n"[i % 30]);
        }
        const ACE_CString encoded = Base64Coder::Encode(
            reinterpret_cast<const unsigned char*>(document.data()), document.size());
        m_server.setRecording(false);
        m_server.answerBody("<GetHostName></GetHostName>",
                            ScriptedResponse::Ok(legacyOk("<HostName>bench</HostName>")));
        m_server.answerBody("<GetMasterHostName></GetMasterHostName>",
                            ScriptedResponse::Ok(legacyOk("<HostName>bench</HostName>")));
        m_server.setDefault(ScriptedResponse::Ok(
            legacyOk("<Configuration>" + std::string(encoded.c_str()) + "</Configuration>")));
    }

    std::size_t size() const { return m_size; }
    std::string authority() const { return m_server.authority(); }
    std::string url() const {
        return "http://" + authority() + "/Sundrel/ConfigurationService/ConfigurationService.ashx";
    }

private:
    std::size_t m_size;
    RecordingHttpServer m_server;
};

DocumentServer& serverFor(std::size_t size) {
    static std::map<std::size_t, std::unique_ptr<DocumentServer>> servers;
    auto& server = servers[size];
    if (!server) {
        server = std::make_unique<DocumentServer>(size);
    }
    return *server;
}

void ClientRetrieve(benchmark::State& state) {
    DocumentServer& server = serverFor(static_cast<std::size_t>(state.range(0)));
    const Configuration::HttpConfigurationClient client(server.authority().c_str(), false, false);
    for (auto _ : state) {
        Quorvex::ByteArray data;
        std::size_t length = 0;
        client.retrieve("bench-host", "Bench", data, length);
        if (length != server.size()) {
            state.SkipWithError("wrong document length");
            break;
        }
        benchmark::DoNotOptimize(data.get());
    }
    state.SetItemsProcessed(state.iterations());
}

std::size_t collect(char* data, std::size_t size, std::size_t count, void* target) {
    static_cast<std::string*>(target)->append(data, size * count);
    return size * count;
}

// The same request by libcurl alone: one easy handle for the whole loop and, as the client must,
// a new connection for every request, closed after its answer; the answer appended to a string.
// With decode set, the loop also cuts the document's Base64 text out of the answer and decodes
// it: the least work any client of the service must do for a retrieve.
void bareLoop(benchmark::State& state, bool decode) {
    const std::string url = serverFor(static_cast<std::size_t>(state.range(0))).url();
    CURL* curl = curl_easy_init();
    curl_easy_setopt(curl, CURLOPT_URL, url.c_str());
    curl_easy_setopt(curl, CURLOPT_PROXY, "");
    curl_easy_setopt(curl, CURLOPT_NOSIGNAL, 1L);
    curl_easy_setopt(curl, CURLOPT_FRESH_CONNECT, 1L);
    curl_easy_setopt(curl, CURLOPT_FORBID_REUSE, 1L);
    curl_easy_setopt(curl, CURLOPT_POSTFIELDS, RETRIEVE_BODY);
    curl_easy_setopt(curl, CURLOPT_WRITEFUNCTION, &collect);
    for (auto _ : state) {
        std::string answer;
        curl_easy_setopt(curl, CURLOPT_WRITEDATA, &answer);
        const CURLcode result = curl_easy_perform(curl);
        if (result != CURLE_OK) {
            state.SkipWithError(curl_easy_strerror(result));
            break;
        }
        if (decode) {
            const std::size_t start = answer.find("<Configuration>") + 15;
            const std::size_t end = answer.find("</Configuration>", start);
            std::size_t length = 0;
            Quorvex::ByteArray bytes =
                Base64Coder::Decode(answer.data() + start, end - start, length);
            benchmark::DoNotOptimize(bytes.get());
        }
        benchmark::DoNotOptimize(answer.data());
    }
    curl_easy_cleanup(curl);
    state.SetItemsProcessed(state.iterations());
}

void BareCurlRetrieve(benchmark::State& state) {
    bareLoop(state, false);
}

void BareCurlRetrieveAndDecode(benchmark::State& state) {
    bareLoop(state, true);
}

// The client's own work beyond the exchange: decoding the document's Base64 text.
void Base64DecodeOnly(benchmark::State& state) {
    const std::string document(static_cast<std::size_t>(state.range(0)), 'x');
    const ACE_CString encoded = Base64Coder::Encode(
        reinterpret_cast<const unsigned char*>(document.data()), document.size());
    for (auto _ : state) {
        std::size_t length = 0;
        Quorvex::ByteArray decoded = Base64Coder::Decode(encoded, length);
        benchmark::DoNotOptimize(decoded.get());
    }
    state.SetItemsProcessed(state.iterations());
}

// Each size measured client first, then bare, next to each other in time.
BENCHMARK(ClientRetrieve)->Arg(4096)->UseRealTime();
BENCHMARK(BareCurlRetrieve)->Arg(4096)->UseRealTime();
BENCHMARK(ClientRetrieve)->Arg(65536)->UseRealTime();
BENCHMARK(BareCurlRetrieve)->Arg(65536)->UseRealTime();
BENCHMARK(BareCurlRetrieveAndDecode)->Arg(65536)->UseRealTime();
BENCHMARK(Base64DecodeOnly)->Arg(4096)->Arg(65536);

// The console output, plus every repetition's rate kept for the comparison at the end.
class RateReporter : public benchmark::ConsoleReporter {
public:
    void ReportRuns(const std::vector<Run>& runs) override {
        for (const auto& run : runs) {
            const auto rate = run.counters.find("items_per_second");
            if (rate == run.counters.end()) {
                continue;
            }
            if (run.run_type == Run::RT_Iteration) {
                m_rates[run.run_name.str()].push_back(rate->second.value);
            } else if (run.aggregate_name == "median") {
                m_medians[run.run_name.str()] = rate->second.value;
            }
        }
        ConsoleReporter::ReportRuns(runs);
    }

    // The median rate of a benchmark; 0 when it did not run.
    double median(const std::string& name) const {
        const auto aggregate = m_medians.find(name);
        if (aggregate != m_medians.end()) {
            return aggregate->second;
        }
        const auto found = m_rates.find(name);
        if (found == m_rates.end() || found->second.empty()) {
            return 0;
        }
        std::vector<double> values = found->second;
        std::sort(values.begin(), values.end());
        return values[values.size() / 2];
    }

private:
    std::map<std::string, std::vector<double>> m_rates;
    std::map<std::string, double> m_medians;
};

void printRatios(const RateReporter& reporter) {
    for (const char* size : {"4096", "65536"}) {
        const double client = reporter.median(std::string("ClientRetrieve/") + size + "/real_time");
        const double bare = reporter.median(std::string("BareCurlRetrieve/") + size + "/real_time");
        if (client <= 0 || bare <= 0) {
            continue;
        }
        std::printf(
            "retrieve %5s B: client %7.0f req/s, bare libcurl %7.0f req/s, ratio %5.1f %%\n", size,
            client, bare, 100.0 * client / bare);
    }
}

}  // namespace

int main(int argc, char** argv) {
    curl_global_init(CURL_GLOBAL_DEFAULT);
    benchmark::Initialize(&argc, argv);
    RateReporter reporter;
    benchmark::RunSpecifiedBenchmarks(&reporter);
    printRatios(reporter);
    benchmark::Shutdown();
    // No curl_global_cleanup: the client's per-thread handle is cleaned up after main returns.
    return 0;
}
