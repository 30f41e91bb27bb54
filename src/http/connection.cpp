#include "http/connection.h"

#include <array>
#include <boost/asio/buffer.hpp>
#include <boost/asio/post.hpp>
#include <boost/asio/ssl/stream.hpp>
#include <boost/asio/write.hpp>

#include "http/read_buffer.h"
#include "http/reply.h"
#include "http/request_parser.h"
#include "http/response_head.h"

namespace zebtell::http {
namespace {

using TlsStream = asio::ssl::stream<Socket>;

constexpr std::size_t kBodyReadSize = std::size_t{32} * 1024;
constexpr std::size_t kSlowestBytesPerSecond = std::size_t{16} * 1024;
constexpr std::string_view kContinue = "HTTP/1.1 100 Continue\r\n\r\n";

// The same protocol over a plain socket and over TLS. At most one read and one write are under way.
template <class Stream>
class StreamConnection final : public Connection {
  public:
    StreamConnection(std::shared_ptr<Worker> worker,
                     std::string peer,
                     std::shared_ptr<asio::ssl::context> tls,
                     Stream stream)
        : worker_(std::move(worker)),
          options_(worker_->context().options),
          peer_(std::move(peer)),
          tls_(std::move(tls)),
          stream_(std::move(stream)),
          parser_(options_.limits),
          share_(worker_->context().bodies) {}

    void Start() override;
    void Respond(Response response) override;
    void OnOverdue() override;
    void CloseWhenIdle() override;
    void Close() override;

  private:
    static constexpr bool kIsTls = std::is_same_v<Stream, TlsStream>;

    enum class Phase {
        kOpening,  // nothing of the first request has come
        kIdle,     // nothing of a further request has come
        kHead,
        kBody,
        kHandling,
        kWriting,
        kLingering,  // the last response is out, the client has not closed yet
        kClosed,
    };

    void Enter(Phase phase, Timeouts::Duration timeout);
    void ReadMore();
    void EnterReading();
    void OnRead(const error_code& error, std::size_t count);
    void ProcessInput();
    void Handle();
    void Refuse(int status);
    void SendContinue();
    void Send(Response response);
    void Write();
    void OnWritten(const error_code& error);
    void Linger();
    void EndSending();
    void Drain();

    std::shared_ptr<StreamConnection> Self() {
        return std::static_pointer_cast<StreamConnection>(shared_from_this());
    }
    Socket& socket() {
        if constexpr (kIsTls) {
            return stream_.next_layer();
        } else {
            return stream_;
        }
    }

    const std::shared_ptr<Worker> worker_;
    const ServerOptions& options_;
    const std::string peer_;
    const std::shared_ptr<asio::ssl::context> tls_;  // the server may have a newer one by now
    Stream stream_;
    ReadBuffer in_;
    RequestParser parser_;
    BodyBudget::Share share_;
    Phase phase_ = Phase::kOpening;
    bool is_reading_ = false;
    bool has_continued_ = false;
    bool is_head_ = false;
    Sending sending_{After::kClose, kIsTls};
    std::size_t requests_ = 0;
    Response response_;
    std::string head_;
};

template <class Stream>
void StreamConnection<Stream>::Enter(Phase phase, Timeouts::Duration timeout) {
    phase_ = phase;
    const auto now = Worker::Clock::now();
    const auto crowded =
        phase == Phase::kIdle ? std::min(timeout, options_.timeouts.crowded_idle) : timeout;
    SetDeadlines(now + timeout, now + crowded);
}

template <class Stream>
void StreamConnection<Stream>::Start() {
    worker_->Add(shared_from_this());
    if (worker_->stopping()) return Close();
    Enter(Phase::kOpening, options_.timeouts.head);
    if constexpr (kIsTls) {
        stream_.async_handshake(asio::ssl::stream_base::server,
                                [self = Self()](const error_code& error) {
                                    if (self->phase_ == Phase::kClosed) return;
                                    error ? self->Close() : self->ReadMore();
                                });
    } else {
        ReadMore();
    }
}

template <class Stream>
void StreamConnection<Stream>::EnterReading() {
    const Timeouts& timeouts = options_.timeouts;
    if (parser_.state() == RequestParser::State::kBody) {
        if (phase_ != Phase::kBody) Enter(Phase::kBody, timeouts.body);
    } else if (parser_.has_begun()) {
        if (phase_ != Phase::kHead) Enter(Phase::kHead, timeouts.head);
    } else if (phase_ != Phase::kOpening && phase_ != Phase::kIdle) {
        if (worker_->stopping()) return Close();
        Enter(Phase::kIdle, timeouts.idle);
        in_.ShrinkWhenEmpty();
    }
}

template <class Stream>
void StreamConnection<Stream>::ReadMore() {
    EnterReading();
    if (phase_ == Phase::kClosed) return;
    // Large pieces for those who have sent some already; announcing a large body takes no memory.
    const bool is_large = phase_ == Phase::kBody && parser_.body_size() >= kBodyReadSize / 2;
    const auto space = in_.Space(is_large ? kBodyReadSize : 1);
    is_reading_ = true;
    stream_.async_read_some(asio::buffer(space.data(), space.size()),
                            [self = Self()](const error_code& error, std::size_t count) {
                                self->OnRead(error, count);
                            });
}

template <class Stream>
void StreamConnection<Stream>::OnRead(const error_code& error, std::size_t count) {
    is_reading_ = false;
    if (phase_ == Phase::kClosed) return;
    if (error) return Close();
    if (phase_ == Phase::kWriting) return;  // a refusal on the way; what comes no longer matters
    if (phase_ == Phase::kLingering) return Drain();
    in_.Commit(count);
    ProcessInput();
}

template <class Stream>
void StreamConnection<Stream>::ProcessInput() {
    if (!in_.Data().empty()) in_.Consume(parser_.Take(in_.Data()));
    if (!share_.Resize(in_.Capacity() + parser_.body_size())) return Refuse(503);
    switch (parser_.state()) {
        case RequestParser::State::kDone:
            return Handle();
        case RequestParser::State::kRefused:
            return Refuse(parser_.refusal());
        case RequestParser::State::kBody:
            if (parser_.expects_continue() && !has_continued_) return SendContinue();
            return ReadMore();
        case RequestParser::State::kHead:
            return ReadMore();
    }
}

template <class Stream>
void StreamConnection<Stream>::SendContinue() {
    has_continued_ = true;
    EnterReading();
    asio::async_write(stream_,
                      asio::buffer(kContinue.data(), kContinue.size()),
                      [self = Self()](const error_code& error, std::size_t) {
                          if (self->phase_ == Phase::kClosed) return;
                          error ? self->Close() : self->ReadMore();
                      });
}

template <class Stream>
void StreamConnection<Stream>::Handle() {
    phase_ = Phase::kHandling;
    SetDeadlines(Worker::Clock::time_point::max(), Worker::Clock::time_point::max());
    const bool keeps = ++requests_ < options_.limits.requests_per_connection &&
                       parser_.keep_alive() && !worker_->stopping();
    sending_.after = !keeps                ? After::kClose
                     : parser_.is_http10() ? After::kKeepAliveHttp10
                                           : After::kKeepAlive;
    is_head_ = parser_.is_head();
    Request request = parser_.TakeRequest();
    ServerContext& context = worker_->context();
    context.proxies.SetClient(request, peer_, kIsTls);
    sending_.secure = request.secure;
    try {
        context.handler(std::move(request), MakeResponder(weak_from_this()));
    } catch (const std::exception& error) {
        context.Log(std::string("Request handler: ") + error.what());
    }
}

template <class Stream>
void StreamConnection<Stream>::Respond(Response response) {
    if (worker_->io().get_executor().running_in_this_thread()) return Send(std::move(response));
    asio::post(worker_->io(), [weak = weak_from_this(), response = std::move(response)]() mutable {
        if (const auto connection = weak.lock()) connection->Respond(std::move(response));
    });
}

template <class Stream>
void StreamConnection<Stream>::Send(Response response) {
    if (phase_ != Phase::kHandling) return;
    response_ = std::move(response);
    if (response_.status < 200 || response_.status > 599) response_ = ErrorResponse(500);
    if (worker_->stopping()) sending_.after = After::kClose;
    Write();
}

template <class Stream>
void StreamConnection<Stream>::Refuse(int status) {
    is_head_ = parser_.is_head();
    sending_.after = After::kClose;
    response_ = ErrorResponse(status);
    Write();
}

template <class Stream>
void StreamConnection<Stream>::Write() {
    head_.clear();
    AppendHead(head_, response_, worker_->Date(), sending_);
    const std::string& text = response_.shared_body ? *response_.shared_body : response_.body;
    const bool has_body = !is_head_ && HasBody(response_.status);
    const std::array<asio::const_buffer, 2> buffers = {
        asio::buffer(head_), asio::buffer(text.data(), has_body ? text.size() : 0)};
    const std::chrono::seconds for_size(text.size() / kSlowestBytesPerSecond);
    Enter(Phase::kWriting, options_.timeouts.write + for_size);
    asio::async_write(stream_, buffers, [self = Self()](const error_code& error, std::size_t) {
        self->OnWritten(error);
    });
}

template <class Stream>
void StreamConnection<Stream>::OnWritten(const error_code& error) {
    if (phase_ == Phase::kClosed) return;
    if (error) return Close();
    response_ = {};
    parser_.Reset();
    share_.Resize(0);
    if (sending_.after == After::kClose) return Linger();
    has_continued_ = false;
    ProcessInput();
}

// Closing at once would reset the connection when the client has sent more than was read, and the
// reset may overtake the response. So the rest is read away until the client closes too.
template <class Stream>
void StreamConnection<Stream>::Linger() {
    Enter(Phase::kLingering, options_.timeouts.linger);
    if constexpr (kIsTls) {
        stream_.async_shutdown([self = Self()](const error_code&) { self->EndSending(); });
    } else {
        EndSending();
    }
}

template <class Stream>
void StreamConnection<Stream>::EndSending() {
    if (phase_ == Phase::kClosed) return;
    error_code ignored;
    socket().shutdown(asio::socket_base::shutdown_send, ignored);
    if (!is_reading_) Drain();
}

template <class Stream>
void StreamConnection<Stream>::Drain() {
    in_.Clear();
    in_.ShrinkWhenEmpty();
    const auto space = in_.Space(1);
    is_reading_ = true;
    socket().async_read_some(asio::buffer(space.data(), space.size()),
                             [self = Self()](const error_code& error, std::size_t count) {
                                 self->OnRead(error, count);
                             });
}

template <class Stream>
void StreamConnection<Stream>::OnOverdue() {
    const bool awaits_request = phase_ == Phase::kHead || phase_ == Phase::kBody;
    // Without a read under way it is the interim response that the client does not take.
    if (awaits_request && is_reading_) return Refuse(408);
    Close();
}

template <class Stream>
void StreamConnection<Stream>::CloseWhenIdle() {
    if (phase_ == Phase::kOpening || phase_ == Phase::kIdle) Close();
}

template <class Stream>
void StreamConnection<Stream>::Close() {
    if (phase_ == Phase::kClosed) return;
    phase_ = Phase::kClosed;
    error_code ignored;
    socket().close(ignored);
    worker_->context().connections.Leave(peer_);
    worker_->Remove(shared_from_this());
}

}  // namespace

std::shared_ptr<Connection> MakeConnection(std::shared_ptr<Worker> worker,
                                           Socket socket,
                                           std::string peer,
                                           std::shared_ptr<asio::ssl::context> tls) {
    if (tls == nullptr) {
        return std::make_shared<StreamConnection<Socket>>(
            std::move(worker), std::move(peer), nullptr, std::move(socket));
    }
    TlsStream stream(std::move(socket), *tls);
    return std::make_shared<StreamConnection<TlsStream>>(
        std::move(worker), std::move(peer), std::move(tls), std::move(stream));
}

}  // namespace zebtell::http
