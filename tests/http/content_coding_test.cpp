#include "http/content_coding.h"

#include <brotli/decode.h>
#include <gtest/gtest.h>
#include <zlib.h>

#include <thread>
#include <vector>

namespace zebtell::http {
namespace {

std::string Unpacked(const std::string& packed, Coding coding, std::size_t most) {
    std::string text(most, '\0');
    if (coding == Coding::kBrotli) {
        std::size_t size = most;
        EXPECT_EQ(BrotliDecoderDecompress(packed.size(),
                                          reinterpret_cast<const std::uint8_t*>(packed.data()),
                                          &size,
                                          reinterpret_cast<std::uint8_t*>(text.data())),
                  BROTLI_DECODER_RESULT_SUCCESS);
        return text.substr(0, size);
    }
    z_stream stream{};
    stream.next_in = reinterpret_cast<Bytef*>(const_cast<char*>(packed.data()));
    stream.avail_in = static_cast<uInt>(packed.size());
    stream.next_out = reinterpret_cast<Bytef*>(text.data());
    stream.avail_out = static_cast<uInt>(text.size());
    EXPECT_EQ(inflateInit2(&stream, 15 + 16), Z_OK);
    EXPECT_EQ(inflate(&stream, Z_FINISH), Z_STREAM_END);
    EXPECT_EQ(stream.avail_in, 0U);
    inflateEnd(&stream);
    return text.substr(0, stream.total_out);
}

TEST(ContentCoding, IsWhatTheClientLikesBest) {
    const struct {
        const char* accept;
        Coding coding;
    } rows[] = {
        {"", Coding::kIdentity},
        {"gzip", Coding::kGzip},
        {"X-GZIP", Coding::kGzip},
        {"gzip, deflate, br", Coding::kBrotli},
        {"deflate, compress;q=0.5", Coding::kIdentity},
        {"br;q=0.5, gzip", Coding::kGzip},
        {"br; q=0.5 , gzip ; q=0.4", Coding::kBrotli},
        {"br;q=0, gzip;q=0.0", Coding::kIdentity},
        {"*", Coding::kBrotli},
        {"br;q=0, *;q=0.1", Coding::kGzip},
        {"*;q=0", Coding::kIdentity},
        {"identity, gzip;q=0.5", Coding::kIdentity},
        {"identity;q=0.5, gzip;q=0.5", Coding::kGzip},
        {"gzip;q=2, br;q=x, br;q=", Coding::kIdentity},
        {"gzip;q=nan", Coding::kIdentity},
        {"gzippy, brr", Coding::kIdentity},
        {",;,;q=1,", Coding::kIdentity},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(BestCoding(row.accept, Effort::kBest), row.coding) << row.accept;
    }
    EXPECT_EQ(BestCoding("br, gzip, *", Effort::kQuick), Coding::kGzip);
    EXPECT_EQ(BestCoding("br, gzip;q=0.9", Effort::kQuick), Coding::kBrotli);
    EXPECT_EQ(BestCoding("br", Effort::kQuick), Coding::kBrotli);
}

// Several threads, each of which keeps its working memory from text to text.
TEST(ContentCoding, GivesEveryTextBack) {
    std::string hard;
    for (unsigned i = 0, x = 1; i < 100'000; ++i)
        hard += static_cast<char>((x = x * 69069 + 1) >> 24);
    const std::vector<std::string> texts = {"", "a", std::string(300'000, 'x'), hard};
    const auto check = [&] {
        for (const std::string& text : texts) {
            for (const Coding coding : {Coding::kGzip, Coding::kBrotli}) {
                for (const Effort effort : {Effort::kQuick, Effort::kBest, Effort::kQuick}) {
                    const std::string packed = Encoded(text, coding, effort);
                    EXPECT_TRUE(Unpacked(packed, coding, text.size() + 1) == text);
                    EXPECT_TRUE(text != texts[2] || packed.size() < 2000) << packed.size();
                }
            }
        }
    };
    std::vector<std::jthread> threads;
    for (int i = 0; i < 2; ++i) threads.emplace_back(check);
}

}  // namespace
}  // namespace zebtell::http
