#include "http/request_parser.h"

// One file of the layer holds the library's compiled part; the others would only wait for it.
#include <boost/beast/http/basic_parser.hpp>
#include <boost/beast/http/error.hpp>
#include <optional>

#include "base/text.h"
#include "http/target.h"

namespace zebtell::http {
namespace {

namespace beast_http = boost::beast::http;
using boost::beast::error_code;

std::string_view View(boost::beast::string_view text) {
    return {text.data(), text.size()};
}

bool IsDigits(std::string_view text) {
    return !text.empty() && text.find_first_not_of("0123456789") == std::string_view::npos;
}

// Fills a Request with what the library's parser finds and adds the checks that it leaves to us:
// it joins folded headers, takes repeated lengths that agree, reads past unknown transfer codings
// and reports trailers as if they were headers.
class StrictParser : public beast_http::basic_parser<true> {
  public:
    explicit StrictParser(const Limits& limits) : limits_(limits) {
        eager(true);
        header_limit(static_cast<std::uint32_t>(limits.request_line_bytes + limits.header_bytes));
        body_limit(limits.body_bytes);
    }

    Request request;
    bool is_http10 = false;
    bool expects_continue = false;
    bool has_request_line = false;
    int refusal = 0;

    // The bytes that the next put() reads.
    void SetInput(std::string_view bytes) { input_ = bytes; }

  private:
    void Refuse(int status, error_code& ec) {
        refusal = status;
        ec = beast_http::error::bad_field;
    }

    void on_request_impl(beast_http::verb verb,
                         boost::beast::string_view method,
                         boost::beast::string_view target,
                         int version,
                         error_code& ec) override;
    void on_field_impl(beast_http::field field,
                       boost::beast::string_view name,
                       boost::beast::string_view value,
                       error_code& ec) override;
    void on_header_impl(error_code& ec) override;

    void on_response_impl(int, boost::beast::string_view, int, error_code&) override {}
    void on_body_init_impl(const boost::optional<std::uint64_t>& length, error_code&) override {
        // Bytes that were only announced get no memory.
        constexpr std::uint64_t kMostReserved = std::uint64_t{64} * 1024;
        if (length) request.body.reserve(std::min(*length, kMostReserved));
    }
    std::size_t on_body_impl(boost::beast::string_view bytes, error_code&) override {
        request.body.append(bytes.data(), bytes.size());
        return bytes.size();
    }
    void on_chunk_header_impl(std::uint64_t, boost::beast::string_view, error_code&) override {}
    std::size_t on_chunk_body_impl(std::uint64_t,
                                   boost::beast::string_view bytes,
                                   error_code& ec) override {
        return on_body_impl(bytes, ec);
    }
    void on_finish_impl(error_code&) override {}

    bool IsFolded(std::string_view name, std::string_view value) const;
    int RefusalOf(beast_http::field field, std::string_view value);

    const Limits& limits_;
    std::string_view input_;
    std::size_t header_bytes_ = 0;
    bool has_host_ = false;
    bool has_length_ = false;
    bool has_coding_ = false;
};

void StrictParser::on_request_impl(beast_http::verb verb,
                                   boost::beast::string_view method,
                                   boost::beast::string_view target,
                                   int version,
                                   error_code& ec) {
    constexpr std::size_t kBesideTarget = sizeof("  HTTP/1.1") - 1;
    request.method = View(method);
    is_http10 = version == 10;
    has_request_line = true;
    if (verb == beast_http::verb::unknown) return Refuse(501, ec);
    if (verb != beast_http::verb::get && verb != beast_http::verb::head &&
        verb != beast_http::verb::post) {
        return Refuse(405, ec);
    }
    if (method.size() + target.size() + kBesideTarget > limits_.request_line_bytes) {
        return Refuse(414, ec);
    }
    if (!IsAcceptableTarget(View(target))) return Refuse(400, ec);
    request.target = View(target);
    request.headers.reserve(16);
}

// A folded header's value stands in the library's own memory, or behind a line break.
bool StrictParser::IsFolded(std::string_view name, std::string_view value) const {
    const std::less<> before;
    const char* const end = input_.data() + input_.size();
    if (before(value.data(), input_.data()) || before(end, value.data())) return true;
    const char* const gap = name.data() + name.size();
    return std::find(gap, value.data(), '\n') != value.data();
}

int StrictParser::RefusalOf(beast_http::field field, std::string_view value) {
    switch (field) {
        case beast_http::field::host:
            return std::exchange(has_host_, true) || !IsAcceptableHost(value) ? 400 : 0;
        case beast_http::field::content_length:
            return std::exchange(has_length_, true) || !IsDigits(value) ? 400 : 0;
        case beast_http::field::transfer_encoding:
            if (std::exchange(has_coding_, true) || is_http10) return 400;
            return base::EqualNoCase(value, "chunked") ? 0 : 501;
        case beast_http::field::expect:
            expects_continue = !is_http10 && base::EqualNoCase(value, "100-continue");
            return expects_continue || is_http10 ? 0 : 417;
        default:
            return 0;
    }
}

void StrictParser::on_field_impl(beast_http::field field,
                                 boost::beast::string_view name,
                                 boost::beast::string_view value,
                                 error_code& ec) {
    constexpr std::size_t kBesideTexts = sizeof(": \r\n") - 1;
    header_bytes_ += name.size() + value.size() + kBesideTexts;
    if (header_bytes_ > limits_.header_bytes) return Refuse(431, ec);
    if (IsFolded(View(name), View(value))) return Refuse(400, ec);
    if (is_header_done()) return;  // a trailer: nobody may add headers behind the body
    if (request.headers.size() >= limits_.header_count) return Refuse(431, ec);
    if (const int status = RefusalOf(field, View(value))) return Refuse(status, ec);
    request.headers.emplace_back(View(name), View(value));
}

void StrictParser::on_header_impl(error_code& ec) {
    if (!is_http10 && !has_host_) return Refuse(400, ec);
}

// "GET / HTTP/2.0": a version that exists, but not here.
bool NamesOtherVersion(std::string_view request_line) {
    const std::size_t target = request_line.find(' ');
    if (target == std::string_view::npos) return false;
    const std::size_t version = request_line.find(' ', target + 1);
    if (version == std::string_view::npos) return false;
    const std::string_view name = request_line.substr(version + 1, 8);
    return name.size() == 8 && name.starts_with("HTTP/") && IsDigits(name.substr(5, 1)) &&
           name[6] == '.' && IsDigits(name.substr(7, 1)) && name != "HTTP/1.1" &&
           name != "HTTP/1.0";
}

}  // namespace

class RequestParser::Impl {
  public:
    explicit Impl(const Limits& limits) : limits_(limits) { Reset(); }

    void Reset() { parser_.emplace(limits_); }
    std::size_t Take(std::string_view bytes);

    StrictParser& parser() { return *parser_; }

  private:
    int RefusalFor(const error_code& error, std::string_view bytes) const;
    int RefusalForLength(std::string_view left) const;

    const Limits& limits_;
    std::optional<StrictParser> parser_;
};

std::size_t RequestParser::Impl::Take(std::string_view bytes) {
    std::size_t skipped = 0;
    if (!parser_->got_some()) {
        // An empty line before a request is what some clients leave behind a posted form.
        while (bytes.substr(skipped).starts_with("\r\n")) skipped += 2;
        bytes.remove_prefix(skipped);
        if (bytes.empty() || bytes == "\r") return skipped;
    }
    // A body that is nothing but its last chunk: the library takes that in one piece only.
    constexpr std::string_view kLastChunk = "0\r\n\r\n";
    if (parser_->is_header_done() && parser_->chunked() && bytes.starts_with('0') &&
        bytes.size() < kLastChunk.size()) {
        return skipped;
    }
    parser_->SetInput(bytes);
    error_code error;
    const std::size_t used = parser_->put({bytes.data(), bytes.size()}, error);
    if (parser_->refusal == 0) {
        parser_->refusal = error && error != beast_http::error::need_more
                               ? RefusalFor(error, bytes)
                               : RefusalForLength(bytes.substr(used));
    }
    return skipped + used;
}

int RequestParser::Impl::RefusalFor(const error_code& error, std::string_view bytes) const {
    if (error == beast_http::error::body_limit) return 413;
    if (error == beast_http::error::header_limit) {
        const int status = RefusalForLength(bytes);
        return status == 0 ? 431 : status;
    }
    if (error == beast_http::error::bad_version && NamesOtherVersion(bytes)) return 505;
    return 400;
}

// What has not ended yet must not grow without end either. The library may keep the whole head
// waiting, request line included, once the line came in pieces.
int RequestParser::Impl::RefusalForLength(std::string_view left) const {
    if (parser_->is_done() || left.size() <= limits_.request_line_bytes) return 0;
    if (parser_->is_header_done()) return left.size() > limits_.header_bytes ? 400 : 0;
    const std::size_t line = parser_->has_request_line ? 0 : std::min(left.find('\r'), left.size());
    if (line > limits_.request_line_bytes) return 414;
    return left.size() - line > limits_.header_bytes ? 431 : 0;
}

RequestParser::RequestParser(const Limits& limits) : impl_(std::make_unique<Impl>(limits)) {}
RequestParser::~RequestParser() = default;

std::size_t RequestParser::Take(std::string_view bytes) {
    return impl_->Take(bytes);
}

RequestParser::State RequestParser::state() const {
    const StrictParser& parser = impl_->parser();
    if (parser.refusal != 0) return State::kRefused;
    if (parser.is_done()) return State::kDone;
    return parser.is_header_done() ? State::kBody : State::kHead;
}

int RequestParser::refusal() const {
    return impl_->parser().refusal;
}
bool RequestParser::has_begun() const {
    return impl_->parser().got_some();
}
std::size_t RequestParser::body_size() const {
    return impl_->parser().request.body.size();
}
bool RequestParser::keep_alive() const {
    return impl_->parser().keep_alive();
}
bool RequestParser::is_http10() const {
    return impl_->parser().is_http10;
}
bool RequestParser::is_head() const {
    return impl_->parser().request.method == "HEAD";
}

bool RequestParser::expects_continue() const {
    return impl_->parser().expects_continue && impl_->parser().request.body.empty();
}

Request RequestParser::TakeRequest() {
    return std::move(impl_->parser().request);
}
void RequestParser::Reset() {
    impl_->Reset();
}

}  // namespace zebtell::http
