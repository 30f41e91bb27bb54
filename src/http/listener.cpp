#include "http/listener.h"

#include <boost/asio/ip/v6_only.hpp>
#include <boost/asio/post.hpp>
#include <future>

#include "base/runtime_error.h"
#include "http/connection.h"

namespace zebtell::http {
namespace {

using Tcp = asio::ip::tcp;

constexpr std::chrono::milliseconds kPauseAfterError(100);

Tcp::endpoint Resolve(asio::io_context& io, const ServerOptions& options) {
    Tcp::resolver resolver(io);
    error_code error;
    const auto found = resolver.resolve(
        options.address, std::to_string(options.port), Tcp::resolver::passive, error);
    if (!error && !found.empty()) return found.begin()->endpoint();
    throw base::RuntimeError(base::errors::kUnspecified,
                             "Address " + options.address + ": " + error.message());
}

void Bind(Acceptor& acceptor, const Tcp::endpoint& endpoint) {
    acceptor.open(endpoint.protocol());
    acceptor.set_option(Acceptor::reuse_address(true));
    if (endpoint.protocol() == Tcp::v6()) acceptor.set_option(asio::ip::v6_only(false));
    acceptor.bind(endpoint);
    acceptor.listen();
}

// "" when the client has gone already.
std::string PeerAddress(const Socket& socket) {
    error_code error;
    const auto endpoint = socket.remote_endpoint(error);
    if (error) return {};
    const auto parsed = IpAddress::Parse(endpoint.address().to_string());
    return parsed ? parsed->ToText() : endpoint.address().to_string();
}

}  // namespace

Listener::Listener(std::vector<std::shared_ptr<Worker>> workers,
                   std::shared_ptr<asio::ssl::context> tls)
    : workers_(std::move(workers)),
      context_(workers_.front()->context()),
      tls_(std::move(tls)),
      acceptor_(workers_.front()->io()),
      pause_(workers_.front()->io()) {
    const auto endpoint = Resolve(workers_.front()->io(), context_.options);
    try {
        Bind(acceptor_, endpoint);
        port_ = acceptor_.local_endpoint().port();
    } catch (const boost::system::system_error& error) {
        throw base::RuntimeError(base::errors::kUnspecified,
                                 "Cannot listen on " + context_.options.address + " port " +
                                     std::to_string(context_.options.port) + ": " +
                                     error.code().message());
    }
}

void Listener::Start() {
    asio::post(acceptor_.get_executor(), [this] { Accept(); });
}

void Listener::UseTls(std::shared_ptr<asio::ssl::context> tls) {
    asio::post(acceptor_.get_executor(),
               [this, tls = std::move(tls)]() mutable { tls_ = std::move(tls); });
}

void Listener::Stop() {
    std::promise<void> closed;
    asio::post(acceptor_.get_executor(), [this, &closed] {
        error_code ignored;
        acceptor_.close(ignored);
        pause_.cancel();
        closed.set_value();
    });
    closed.get_future().wait();
}

void Listener::Accept() {
    Worker& worker = *workers_[next_++ % workers_.size()];
    acceptor_.async_accept(worker.io(), [this, &worker](const error_code& error, Socket socket) {
        OnAccepted(error, worker, std::move(socket));
    });
}

void Listener::OnAccepted(const error_code& error, Worker& worker, Socket socket) {
    if (!acceptor_.is_open()) return;
    if (!error) {
        Admit(worker, std::move(socket));
        return Accept();
    }
    // Out of file descriptors or memory, as a rule: it passes, and trying at once helps nobody.
    context_.Log("Accept: " + error.message());
    pause_.expires_after(kPauseAfterError);
    pause_.async_wait([this](const error_code& cancelled) {
        if (!cancelled && acceptor_.is_open()) Accept();
    });
}

void Listener::Admit(Worker& worker, Socket socket) {
    const Limits& limits = context_.options.limits;
    const std::string peer = PeerAddress(socket);
    if (peer.empty()) return;
    const std::size_t most_of_peer =
        context_.proxies.Contains(peer) ? 0 : limits.connections_per_address;
    if (!context_.connections.Enter(peer, limits.connections, most_of_peer)) return;
    error_code ignored;
    socket.set_option(Tcp::no_delay(true), ignored);
    auto connection = MakeConnection(worker.shared_from_this(), std::move(socket), peer, tls_);
    asio::post(worker.io(), [connection = std::move(connection)] { connection->Start(); });
}

}  // namespace zebtell::http
