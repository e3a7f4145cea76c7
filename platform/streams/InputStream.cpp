#include "Quorvex/InputStream.h"

#include "Quorvex/StreamException.h"

std::string InputStream::readAll(std::size_t limit) {
    std::string out;
    char chunk[16384];
    for (;;) {
        const std::size_t n = read(chunk, sizeof chunk);
        if (n == 0) {
            return out;
        }
        if (out.size() + n > limit) {
            throw Quorvex::StreamException("InputStream: more than " + std::to_string(limit) +
                                           " bytes");
        }
        out.append(chunk, n);
    }
}
