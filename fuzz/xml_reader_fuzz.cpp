// Fuzzes the XML reader of the element tree: any input must either be refused with
// Vesk::TrelException or give a tree that prints and reads back to an equal tree.
#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <string>

#include "Quorvex/OutputMemStream.h"
#include "Vesk/XmlUtils.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    Vesk::Element tree;
    try {
        Vesk::XmlUtils::parse(reinterpret_cast<const char*>(data), size, tree);
    } catch (const Vesk::TrelException&) {
        return 0;
    }
    for (const Vesk::Ordering ordering : {Vesk::Ordering(), Vesk::Ordering::indented()}) {
        OutputMemStream out;
        Vesk::XmlUtils::streamOut(tree, out, ordering);
        Vesk::Element again;
        try {
            Vesk::XmlUtils::parse(out.data(), out.size(), again);
        } catch (const Vesk::TrelException& e) {
            std::fprintf(stderr, "written tree refused on reading: %s\n%s\n", e.what(),
                         out.str().c_str());
            std::abort();
        }
        if (again != tree) {
            std::fprintf(stderr, "round trip changed the tree:\n%s\n", out.str().c_str());
            std::abort();
        }
    }
    return 0;
}
