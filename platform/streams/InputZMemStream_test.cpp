#include "Quorvex/InputZMemStream.h"

#include <gtest/gtest.h>
#include <zlib.h>

#include <random>
#include <string>

#include "Quorvex/StreamException.h"

namespace {

constexpr std::size_t kNoLimit = static_cast<std::size_t>(-1);

// Compresses with zlib itself, so the reader is checked against the reference writer.
std::string zlibCompress(const std::string& text) {
    uLongf len = compressBound(text.size());
    std::string out(len, '\0');
    EXPECT_EQ(Z_OK, compress2(reinterpret_cast<Bytef*>(&out[0]), &len,
                              reinterpret_cast<const Bytef*>(text.data()), text.size(), 9));
    out.resize(len);
    return out;
}

std::string inflateAll(const std::string& z, std::size_t maxInflated = kNoLimit,
                       std::size_t limit = kNoLimit) {
    InputZMemStream in(z.data(), z.size(), maxInflated);
    return in.readAll(limit);
}

std::string inflateByRead(const std::string& z, std::size_t chunk,
                          std::size_t maxInflated = kNoLimit) {
    InputZMemStream in(z.data(), z.size(), maxInflated);
    std::string out;
    std::string buf(chunk, '\0');
    while (const std::size_t n = in.read(&buf[0], chunk)) {
        out.append(buf, 0, n);
    }
    return out;
}

std::string sample(std::size_t n, bool random) {
    std::mt19937 gen(7);
    std::string s(n, '\0');
    for (std::size_t i = 0; i < n; ++i) {
        s[i] = random ? static_cast<char>(gen()) : "<Key>value</Key>\n"[i % 17];
    }
    return s;
}

TEST(ZStreamInput, RoundTripsThroughReadAllAndRead) {
    for (const std::string& text :
         {std::string(), std::string("a"), sample(1 << 20, true), sample(1 << 20, false)}) {
        const std::string z = zlibCompress(text);
        EXPECT_EQ(text, inflateAll(z));
        EXPECT_EQ(text, inflateByRead(z, 4093));
    }
}

TEST(ZStreamInput, ReadAllReturnsWhatIsLeftAfterRead) {
    const std::string text = sample(50000, true);
    const std::string z = zlibCompress(text);
    InputZMemStream in(z.data(), z.size());
    char head[100];
    ASSERT_EQ(sizeof head, in.read(head, sizeof head));
    EXPECT_EQ(text.substr(sizeof head), in.readAll(kNoLimit));
    EXPECT_EQ(0u, in.read(head, sizeof head));
}

TEST(ZStreamInput, EveryTruncationThrows) {
    const std::string z = zlibCompress("<Element><Key>value</Key></Element>");
    for (std::size_t len = 0; len < z.size(); ++len) {
        EXPECT_THROW(inflateAll(z.substr(0, len)), Quorvex::StreamException) << len;
        EXPECT_THROW(inflateByRead(z.substr(0, len), 3), Quorvex::StreamException) << len;
    }
}

TEST(ZStreamInput, BitFlipsThrowOrLeaveTheDataUnchanged) {
    const std::string text = "<Element><Key>value</Key><Key>other</Key></Element>";
    const std::string z = zlibCompress(text);
    int thrown = 0;
    for (std::size_t bit = 0; bit < z.size() * 8; ++bit) {
        std::string bad = z;
        bad[bit / 8] = static_cast<char>(bad[bit / 8] ^ (1 << (bit % 8)));
        try {
            EXPECT_EQ(text, inflateAll(bad, 4096)) << bit;  // only unused padding bits
        } catch (const Quorvex::StreamException&) {
            ++thrown;
        }
    }
    EXPECT_GT(thrown, static_cast<int>(z.size() * 8) - 8);
}

// Bytes behind the end of the stream, and input that is no zlib stream at all.
TEST(ZStreamInput, TrailingBytesAndNonZlibInputThrow) {
    const std::string z = zlibCompress("payload");
    for (const std::string& bad :
         {z + '\0', z + z, std::string("<Element/>"), std::string(100, '\0')}) {
        EXPECT_THROW(inflateAll(bad), Quorvex::StreamException);
    }
    EXPECT_THROW(inflateByRead(z + "garbage", 1), Quorvex::StreamException);
}

TEST(ZStreamInput, DecompressionBombIsStopped) {
    const std::string z = zlibCompress(std::string(10 << 20, '\0'));
    try {
        inflateAll(z, 1 << 20);
        FAIL() << "no exception";
    } catch (const Quorvex::StreamException& e) {
        EXPECT_NE(std::string::npos, std::string(e.what()).find("limit of 1048576 bytes"));
    }
    EXPECT_THROW(inflateByRead(z, 1 << 16, 1 << 20), Quorvex::StreamException);
    EXPECT_EQ(10u << 20, inflateByRead(z, 1 << 16).size());
}

TEST(ZStreamInput, LimitsAreInclusive) {
    const std::string text = sample(300000, false);
    const std::string z = zlibCompress(text);
    EXPECT_EQ(text, inflateAll(z, text.size(), text.size()));
    EXPECT_THROW(inflateAll(z, text.size() - 1), Quorvex::StreamException);
    EXPECT_THROW(inflateAll(z, kNoLimit, text.size() - 1), Quorvex::StreamException);
}

// Guards against a failed stream later returning 0 as if it had ended cleanly.
TEST(ZStreamInput, AFailedStreamKeepsFailing) {
    const std::string z = zlibCompress(sample(1000, true));
    InputZMemStream in(z.data(), z.size() / 2);
    EXPECT_THROW(in.readAll(kNoLimit), Quorvex::StreamException);
    char buf[16];
    EXPECT_THROW(in.read(buf, sizeof buf), Quorvex::StreamException);
}

}  // namespace
