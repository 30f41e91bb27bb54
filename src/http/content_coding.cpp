#include "http/content_coding.h"

#include <brotli/encode.h>
#include <zlib.h>

#include <array>
#include <charconv>
#include <optional>

#include "base/runtime_error.h"
#include "base/text.h"

namespace zebtell::http {
namespace {

struct Levels {
    int gzip;
    int brotli;
};

// Pages are made for one reader, who waits: see docs/performance.md for what the levels cost.
constexpr Levels LevelsOf(Effort effort) {
    return effort == Effort::kQuick ? Levels{3, 4} : Levels{9, 9};
}

[[noreturn]] void Fail(std::string_view library) {
    throw base::RuntimeError(base::errors::kUnspecified, std::string(library) + " failed");
}

// A gzip stream's working memory, a quarter of a megabyte, kept from text to text.
class Deflater {
  public:
    explicit Deflater(int level) {
        constexpr int kWindowBits = 15;
        constexpr int kAsGzip = 16;
        constexpr int kMemoryLevel = 8;
        if (deflateInit2(&stream_,
                         level,
                         Z_DEFLATED,
                         kWindowBits + kAsGzip,
                         kMemoryLevel,
                         Z_DEFAULT_STRATEGY) != Z_OK) {
            Fail("zlib");
        }
    }
    ~Deflater() { deflateEnd(&stream_); }
    Deflater(const Deflater&) = delete;
    Deflater& operator=(const Deflater&) = delete;

    std::string Run(std::string_view text) {
        deflateReset(&stream_);
        std::string out(deflateBound(&stream_, text.size()), '\0');
        // zlib reads only; its type of an input is older than const.
        stream_.next_in = reinterpret_cast<Bytef*>(const_cast<char*>(text.data()));
        stream_.avail_in = static_cast<uInt>(text.size());
        stream_.next_out = reinterpret_cast<Bytef*>(out.data());
        stream_.avail_out = static_cast<uInt>(out.size());
        if (deflate(&stream_, Z_FINISH) != Z_STREAM_END) Fail("zlib");
        out.resize(stream_.total_out);
        return out;
    }

  private:
    z_stream stream_{};
};

std::string Gzipped(std::string_view text, Effort effort) {
    if (effort == Effort::kBest) return Deflater(LevelsOf(effort).gzip).Run(text);
    static thread_local Deflater quick(LevelsOf(Effort::kQuick).gzip);
    return quick.Run(text);
}

std::string Brotlied(std::string_view text, Effort effort) {
    std::size_t size = BrotliEncoderMaxCompressedSize(text.size());
    std::string out(size, '\0');
    if (BrotliEncoderCompress(LevelsOf(effort).brotli,
                              BROTLI_DEFAULT_WINDOW,
                              BROTLI_MODE_TEXT,
                              text.size(),
                              reinterpret_cast<const std::uint8_t*>(text.data()),
                              &size,
                              reinterpret_cast<std::uint8_t*>(out.data())) != BROTLI_TRUE) {
        Fail("brotli");
    }
    out.resize(size);
    return out;
}

// ";q=0.5" in thousandths; 1000 without one, nothing for what is no weight.
std::optional<int> Weight(std::string_view parameters) {
    for (std::string_view part : base::Split(parameters, ';')) {
        part = base::Trimmed(part);
        if (!base::StartsWithNoCase(part, "q=")) continue;
        part.remove_prefix(2);
        double weight = 0;
        const auto [end, error] = std::from_chars(part.data(), part.data() + part.size(), weight);
        const bool is_weight = error == std::errc() && end == part.data() + part.size();
        if (!is_weight || !(weight >= 0 && weight <= 1)) return std::nullopt;
        return static_cast<int>(weight * 1000);
    }
    return 1000;
}

struct Names {
    Coding coding;
    std::string_view name;
    std::string_view old_name;
};
constexpr Names kNames[] = {{Coding::kBrotli, "br", "br"},
                            {Coding::kGzip, "gzip", "x-gzip"},
                            {Coding::kIdentity, "identity", "identity"}};

// What a list of codings says about one of them; nothing when it says nothing.
std::optional<int> WeightOf(const Names& names, std::string_view list) {
    std::optional<int> of_any;
    for (const std::string_view item : base::Split(list, ',')) {
        const std::size_t end = std::min(item.find(';'), item.size());
        const std::string_view name = base::Trimmed(item.substr(0, end));
        const auto weight = Weight(item.substr(end));
        if (base::EqualNoCase(name, names.name) || base::EqualNoCase(name, names.old_name))
            return weight.value_or(0);
        if (name == "*") of_any = weight.value_or(0);
    }
    return of_any;
}

}  // namespace

Coding BestCoding(std::string_view accept_encoding, Effort effort) {
    const Coding favourite = effort == Effort::kQuick ? Coding::kGzip : Coding::kBrotli;
    Coding best = Coding::kIdentity;
    int best_weight = 0;
    for (const Names& names : kNames) {
        const int weight = WeightOf(names, accept_encoding).value_or(0);
        const bool is_favourite = names.coding == favourite && weight > 0;
        if (weight > best_weight || (weight == best_weight && is_favourite)) {
            best = names.coding;
            best_weight = weight;
        }
    }
    return best;
}

std::string_view CodingName(Coding coding) {
    for (const Names& names : kNames) {
        if (names.coding == coding && coding != Coding::kIdentity) return names.name;
    }
    return {};
}

std::string Encoded(std::string_view text, Coding coding, Effort effort) {
    switch (coding) {
        case Coding::kGzip:
            return Gzipped(text, effort);
        case Coding::kBrotli:
            return Brotlied(text, effort);
        case Coding::kIdentity:
            break;
    }
    return std::string(text);
}

}  // namespace zebtell::http
