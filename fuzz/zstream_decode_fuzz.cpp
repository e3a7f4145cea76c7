// Inflates arbitrary bytes. The only allowed failure is Quorvex::StreamException, and the limit
// keeps decompression bombs from growing memory.
#include <cstddef>
#include <cstdint>
#include <cstdlib>

#include "Quorvex/InputZMemStream.h"
#include "Quorvex/StreamException.h"

namespace {

constexpr std::size_t kMaxInflated = 1 << 20;

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    try {
        InputZMemStream in(data, size, kMaxInflated);
        const std::string out = in.readAll(kMaxInflated / 2);
        if (out.size() > kMaxInflated / 2) {
            std::abort();
        }
    } catch (const Quorvex::StreamException&) {
    }
    return 0;
}
