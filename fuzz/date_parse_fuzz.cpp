// Parses arbitrary text as BDateTime, BDate and BTime. Parsing never throws; a value that parsed
// must print as text that parses back to the same value.
#include <cstddef>
#include <cstdint>
#include <cstdlib>

#include "Quorvex/BDate.h"
#include "Quorvex/BDateTime.h"
#include "Quorvex/BTime.h"

namespace {

template <class T>
void checkRoundTrip(const ACE_CString& text) {
    const T value(text);
    if (value.isValid() && T(value.ToString()) != value) {
        std::abort();
    }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const ACE_CString text(reinterpret_cast<const char*>(data), size);
    checkRoundTrip<BDateTime>(text);
    checkRoundTrip<BDate>(text);
    checkRoundTrip<BTime>(text);
    return 0;
}
