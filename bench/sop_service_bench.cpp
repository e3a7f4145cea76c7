// Reading a SOP service document of 300 services over 40 transfer syntaxes and 20 templates, in
// two steps: parse (XML text to element tree) and resolve (element tree to the typed document
// with every service's transfer syntaxes resolved). Prints µs per read of each step and the ratio
// resolve/parse; the resolve step is meant to stay cheaper than the parse.
#include <benchmark/benchmark.h>

#include <cstdio>
#include <map>
#include <string>
#include <vector>

#include "Configuration/SOPServiceConfiguration.h"
#include "Vesk/XmlUtils.h"

namespace {

constexpr int kSyntaxes = 40;
constexpr int kTemplates = 20;
constexpr int kServices = 300;

void addText(Vesk::MultiElementValue& parent, const char* key, const std::string& value) {
    parent.addElement(key, {}, -1).addSingle().assign(value.c_str());
}

Vesk::MultiElementValue& addList(Vesk::MultiElementValue& parent, const char* key) {
    return parent.addElement(key, {}, -1).addMultiElement();
}

// Numbers from..from+count-1 (modulo the table), comma-separated.
std::string numbers(int from, int count) {
    std::string text;
    for (int i = 0; i < count; ++i) {
        text += (i == 0 ? "" : ",") + std::to_string((from + i) % kSyntaxes + 1);
    }
    return text;
}

// Synthetic UIDs under the UUID-derived root: the benchmark needs their shape, not their meaning.
std::string uid(const char* kind, int n) {
    return std::string("2.25.") + kind + "." + std::to_string(n);
}

std::string makeDocument() {
    Vesk::Element tree("SOPServiceConfiguration", -1);
    Vesk::MultiElementValue& root = tree.addMultiElement();
    addText(root, "ReleaseDate", "2023-01-15");
    addText(root, "Version", "12");
    addText(root, "Description", "benchmark document");
    addText(root, "ProductVersion", "4.2.0");
    Vesk::MultiElementValue& rows = addList(root, "SupportedTxList");
    for (int nr = 1; nr <= kSyntaxes; ++nr) {
        Vesk::MultiElementValue& row = addList(rows, "SupportedTx");
        addText(row, "TxNr", std::to_string(nr));
        addText(row, "TxUID", uid("1", nr));
        addText(row, "TxName", "Transfer syntax number " + std::to_string(nr));
        addText(row, "TxDescription", "Described at some length for the administrator");
    }
    Vesk::MultiElementValue& templates = addList(root, "TemplateTxLists");
    for (int t = 0; t < kTemplates; ++t) {
        Vesk::MultiElementValue& entry = addList(templates, "TemplateTxList");
        addText(entry, "TemplateName", "Template" + std::to_string(t));
        addText(entry, "TemplateDescription", "A group of syntaxes");
        addText(entry, "Additional", t % 4 == 3 ? "1" : "0");
        addText(entry, "TxList", numbers(t * 2, 4 + t % 12));
    }
    Vesk::MultiElementValue& services = addList(root, "SOPServiceList");
    for (int s = 0; s < kServices; ++s) {
        Vesk::MultiElementValue& service = addList(services, "SOPService");
        addText(service, "UID", uid("2", s));
        addText(service, "Name", "Storage service number " + std::to_string(s));
        addText(service, "ObjectType", s % 10 == 0 ? "SR" : "IMAGE");
        addText(service, "Additional", s % 4 == 3 ? "1" : "0");
        addText(service, "EnabledDefault", "1");
        const bool byTemplate = s % 3 != 0;
        addText(service, "TxListDefault",
                byTemplate ? "Template" + std::to_string(s % kTemplates) : numbers(s, 6));
        if (s % 5 == 0) {
            addText(service, "TxList", numbers(s, 3));
        }
    }
    return Vesk::XmlUtils::toString(tree);
}

const std::string& document() {
    static const std::string xml = makeDocument();
    return xml;
}

const Vesk::Element& parsedDocument() {
    static const Vesk::Element tree = [] {
        Vesk::Element parsed;
        Vesk::XmlUtils::parse(document().data(), document().size(), parsed);
        return parsed;
    }();
    return tree;
}

void BM_Parse(benchmark::State& state) {
    for (auto _ : state) {
        Vesk::Element tree;
        Vesk::XmlUtils::parse(document().data(), document().size(), tree);
        benchmark::DoNotOptimize(tree);
    }
    state.SetBytesProcessed(state.iterations() * document().size());
}

void BM_Resolve(benchmark::State& state) {
    const Vesk::Element& tree = parsedDocument();
    std::size_t entries = 0;
    for (auto _ : state) {
        Configuration::SOPServiceConfiguration config;
        if (!config.readVesk(tree)) {
            state.SkipWithError("the document did not read completely");
        }
        entries = 0;
        for (const auto& service : config.getSOPServiceList().getSOPServices()) {
            entries += service.getTransferSyntaxList().getTransferSyntaxes().size();
        }
        benchmark::DoNotOptimize(config);
    }
    state.counters["entries"] = static_cast<double>(entries);
}

void BM_ParseAndResolve(benchmark::State& state) {
    for (auto _ : state) {
        Vesk::Element tree;
        Vesk::XmlUtils::parse(document().data(), document().size(), tree);
        Configuration::SOPServiceConfiguration config;
        config.readVesk(tree);
        benchmark::DoNotOptimize(config);
    }
}

BENCHMARK(BM_Parse)->Unit(benchmark::kMicrosecond);
BENCHMARK(BM_Resolve)->Unit(benchmark::kMicrosecond);
BENCHMARK(BM_ParseAndResolve)->Unit(benchmark::kMicrosecond);

// Keeps each benchmark's µs per read, to print the ratio at the end.
class RatioReporter : public benchmark::ConsoleReporter {
public:
    void ReportRuns(const std::vector<Run>& runs) override {
        ConsoleReporter::ReportRuns(runs);
        for (const Run& run : runs) {
            microseconds[run.benchmark_name()] = run.GetAdjustedRealTime();
        }
    }
    std::map<std::string, double> microseconds;
};

}  // namespace

int main(int argc, char** argv) {
    benchmark::Initialize(&argc, argv);
    RatioReporter reporter;
    benchmark::RunSpecifiedBenchmarks(&reporter);
    const double parse = reporter.microseconds["BM_Parse"];
    const double resolve = reporter.microseconds["BM_Resolve"];
    if (parse > 0 && resolve > 0) {
        std::printf(
            "\n%d services, %d transfer syntaxes, %d templates, %zu bytes of XML\n"
            "parse %.1f us/read, resolve %.1f us/read, resolve/parse = %.2f (aim: below 1)\n",
            kServices, kSyntaxes, kTemplates, document().size(), parse, resolve, resolve / parse);
    }
    return 0;
}
