// Stored form of a 1 MB document: encode (print + deflate level 9) and decode (inflate + parse
// into an element tree) next to bare zlib with bare pugixml on the same XML text. Throughput is
// reported as bytes of XML text per second; decode/bare is the figure to watch.
#include <benchmark/benchmark.h>
#include <zlib.h>
#include <pugixml.hpp>

#include <random>
#include <string>
#include <vector>

#include "Configuration/StoredForm.h"
#include "Quorvex/OutputMemStream.h"
#include "Vesk/XmlUtils.h"

namespace {

// A configuration-like tree of about 1 MB of XML: many objects of short keyed texts.
Vesk::Element makeDocument() {
    std::mt19937 random(42);
    Vesk::Element root("Location", -1);
    Vesk::MultiElementValue& children = root.addMultiElement();
    for (int i = 0; children.size() < 100000 && i < 4200; ++i) {
        Vesk::MultiElementValue& server = children.addElement("Server", {}, -1).addMultiElement();
        server.addElement("HostName", {}, -1)
            .addSingle()
            .assign(("host-" + std::to_string(random() % 100000)).c_str());
        server.addElement("Port", {}, -1)
            .addSingle()
            .assign(std::to_string(random() % 65536).c_str());
        server.addElement("Enabled", {}, -1).addSingle().assign(random() % 2 ? "1" : "0");
        server.addElement("Path", {}, -1).addSingle().assign("D:\\Quorvex\\stack\\input\\");
        server.addElement("Description", {}, -1)
            .addSingle()
            .assign(("Storage node <" + std::to_string(i) + "> & mirror").c_str());
    }
    return root;
}

struct Fixture {
    Vesk::Element tree = makeDocument();
    std::string xml = Vesk::XmlUtils::toString(tree);
    std::string stored = Configuration::StoredForm::encode(tree);
};

const Fixture& fixture() {
    static const Fixture f;
    return f;
}

void BM_EncodeStoredForm(benchmark::State& state) {
    const Fixture& f = fixture();
    for (auto _ : state) {
        benchmark::DoNotOptimize(Configuration::StoredForm::encode(f.tree));
    }
    state.SetBytesProcessed(state.iterations() * f.xml.size());
}

void BM_EncodeBarePugixmlZlib(benchmark::State& state) {
    const Fixture& f = fixture();
    pugi::xml_document doc;
    doc.load_buffer(f.xml.data(), f.xml.size());
    std::vector<Bytef> out(compressBound(f.xml.size()));
    for (auto _ : state) {
        struct Sink : pugi::xml_writer {
            std::string text;
            void write(const void* data, size_t size) override {
                text.append(static_cast<const char*>(data), size);
            }
        } sink;
        sink.text.reserve(f.xml.size());
        doc.save(sink, "", pugi::format_raw);
        uLongf len = out.size();
        compress2(out.data(), &len, reinterpret_cast<const Bytef*>(sink.text.data()),
                  sink.text.size(), 9);
        benchmark::DoNotOptimize(len);
    }
    state.SetBytesProcessed(state.iterations() * f.xml.size());
}

void BM_DecodeStoredForm(benchmark::State& state) {
    const Fixture& f = fixture();
    for (auto _ : state) {
        Vesk::Element tree;
        Configuration::StoredForm::decode(reinterpret_cast<const unsigned char*>(f.stored.data()),
                                          f.stored.size(), tree);
        benchmark::DoNotOptimize(tree);
    }
    state.SetBytesProcessed(state.iterations() * f.xml.size());
}

void BM_DecodeBareZlibPugixml(benchmark::State& state) {
    const Fixture& f = fixture();
    for (auto _ : state) {
        std::string text(f.xml.size(), '\0');
        uLongf len = text.size();
        uncompress(reinterpret_cast<Bytef*>(&text[0]), &len,
                   reinterpret_cast<const Bytef*>(f.stored.data()), f.stored.size());
        pugi::xml_document doc;
        doc.load_buffer_inplace(&text[0], len, pugi::parse_default | pugi::parse_ws_pcdata);
        benchmark::DoNotOptimize(doc);
    }
    state.SetBytesProcessed(state.iterations() * f.xml.size());
}

BENCHMARK(BM_EncodeStoredForm)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_EncodeBarePugixmlZlib)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_DecodeStoredForm)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_DecodeBareZlibPugixml)->Unit(benchmark::kMillisecond);

}  // namespace

BENCHMARK_MAIN();
