#include "http/server.h"

#include <algorithm>
#include <mutex>
#include <thread>

#include "http/listener.h"
#include "http/tls.h"
#include "http/worker.h"

namespace zebtell::http {

class Server::Impl {
  public:
    Impl(ServerOptions options, Handler handler)
        : context_(std::make_shared<ServerContext>(std::move(options), std::move(handler))) {}

    void Start();
    void Stop();
    void ReloadCertificate();
    std::uint16_t port() const { return listener_ ? listener_->port() : 0; }

  private:
    // Null without TLS.
    std::shared_ptr<asio::ssl::context> MakeTls() const;

    const std::shared_ptr<ServerContext> context_;
    std::mutex mutex_;
    bool is_running_ = false;
    std::vector<std::shared_ptr<Worker>> workers_;
    std::unique_ptr<Listener> listener_;
};

std::shared_ptr<asio::ssl::context> Server::Impl::MakeTls() const {
    const ServerOptions& options = context_->options;
    if (options.certificate_file.empty() && options.key_file.empty()) return nullptr;
    return MakeTlsContext(options.certificate_file, options.key_file);
}

void Server::Impl::ReloadCertificate() {
    const std::lock_guard lock(mutex_);
    auto tls = MakeTls();
    if (is_running_ && tls) listener_->UseTls(std::move(tls));
}

void Server::Impl::Start() {
    const std::lock_guard lock(mutex_);
    if (is_running_) return;
    const ServerOptions& options = context_->options;
    auto tls = MakeTls();
    const unsigned threads = options.io_threads > 0
                                 ? options.io_threads
                                 : std::max(1U, std::thread::hardware_concurrency());
    listener_.reset();
    workers_.clear();
    for (unsigned i = 0; i < threads; ++i) workers_.push_back(std::make_shared<Worker>(context_));
    listener_ = std::make_unique<Listener>(workers_, std::move(tls));
    for (const auto& worker : workers_) worker->Start();
    listener_->Start();
    is_running_ = true;
}

void Server::Impl::Stop() {
    const std::lock_guard lock(mutex_);
    if (!is_running_) return;
    is_running_ = false;
    listener_->Stop();
    for (const auto& worker : workers_) worker->BeginStop();
    for (const auto& worker : workers_) worker->Join();
}

Server::Server(ServerOptions options, Handler handler)
    : impl_(std::make_unique<Impl>(std::move(options), std::move(handler))) {}

Server::~Server() {
    Stop();
}

void Server::Start() {
    impl_->Start();
}
void Server::Stop() {
    impl_->Stop();
}
void Server::ReloadCertificate() {
    impl_->ReloadCertificate();
}
std::uint16_t Server::port() const {
    return impl_->port();
}

}  // namespace zebtell::http
