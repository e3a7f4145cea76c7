#include "Quorvex/OutputZMemStream.h"

#include <gtest/gtest.h>
#include <zlib.h>

#include <random>
#include <stdexcept>
#include <string>

#include "Quorvex/StreamException.h"

namespace {

std::string randomBytes(std::size_t n, unsigned seed) {
    std::mt19937 gen(seed);
    std::string s(n, '\0');
    for (auto& c : s) {
        c = static_cast<char>(gen());
    }
    return s;
}

// Inflates with zlib's one-shot uncompress, which accepts only a complete RFC 1950 stream.
std::string plainUncompress(const OutputZMemStream& z, std::size_t expectedSize) {
    std::string out(expectedSize + 1, '\0');
    uLongf outLen = out.size();
    const int rc = uncompress(reinterpret_cast<Bytef*>(&out[0]), &outLen, z.data(), z.size());
    EXPECT_EQ(Z_OK, rc);
    out.resize(outLen);
    return out;
}

std::string compressInPieces(const std::string& text, std::size_t piece, std::size_t capacity,
                             int level = 9) {
    OutputZMemStream z(capacity, level);
    for (std::size_t i = 0; i < text.size(); i += piece) {
        z.write(text.data() + i, std::min(piece, text.size() - i));
    }
    z.flush();
    return plainUncompress(z, text.size());
}

// A complete RFC 1950 stream, also when nothing was written.
TEST(ZStreamOutput, OutputIsAPlainZlibStream) {
    for (const std::string text : {"<Element key=\"DicomScp\"><Port>104</Port></Element>", ""}) {
        OutputZMemStream z;
        z.write(text);
        z.flush();
        ASSERT_GE(z.size(), 2u);
        EXPECT_EQ(0x78, z.data()[0]);  // deflate, 32 KiB window
        EXPECT_EQ(text, plainUncompress(z, text.size()));
    }
}

TEST(ZStreamOutput, LargeInputsGrowTheBufferFromATinyCapacity) {
    const std::string random = randomBytes(1 << 20, 1);
    EXPECT_EQ(random, compressInPieces(random, 1 << 20, 1));
    const std::string repetitive(1 << 20, 'x');
    EXPECT_EQ(repetitive, compressInPieces(repetitive, 1000, 1));
}

TEST(ZStreamOutput, ManySmallWritesEqualOneWrite) {
    std::string text;
    for (int i = 0; i < 5000; ++i) {
        text += "<Key>" + std::to_string(i) + "</Key>";
    }
    EXPECT_EQ(text, compressInPieces(text, 7, 5120));
    EXPECT_EQ(text, compressInPieces(text, 1, 0, 0));  // level 0: stored blocks
}

TEST(ZStreamOutput, FlushTwiceIsHarmlessButWritingAfterFlushThrows) {
    OutputZMemStream z;
    z.write(std::string("abc"));
    z.flush();
    const std::size_t size = z.size();
    z.flush();
    EXPECT_EQ(size, z.size());
    EXPECT_THROW(z.write(std::string("d")), Quorvex::StreamException);
}

TEST(ZStreamOutput, RejectsLevelsZlibDoesNotKnow) {
    EXPECT_THROW(OutputZMemStream(64, 10), std::invalid_argument);
    EXPECT_THROW(OutputZMemStream(64, -2), std::invalid_argument);
}

}  // namespace
