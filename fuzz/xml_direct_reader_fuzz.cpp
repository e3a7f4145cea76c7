// Fuzzes the one-pass XML reader against the general one: whatever the one-pass reader accepts,
// the general reader must accept too and read into an equal tree. The fuzzer is seeded with
// printed trees, so it explores the shape the one-pass reader takes and the edges it refuses.
#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <string>

#include "XmlDirectReader.h"
#include "XmlTreeReader.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const char* text = reinterpret_cast<const char*>(data);
    Vesk::Element direct;
    if (!Vesk::XmlDirectReader::read(text, size, direct)) {
        return 0;
    }
    std::string copy(text, size);
    try {
        if (Vesk::XmlTreeReader::parse(copy) != direct) {
            std::fprintf(stderr, "the two readers read different trees\n");
            std::abort();
        }
    } catch (const Vesk::TrelException& e) {
        std::fprintf(stderr, "accepted by the one-pass reader, refused by the general one: %s\n",
                     e.what());
        std::abort();
    }
    return 0;
}
