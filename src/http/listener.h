#pragma once

#include <boost/asio/ssl/context.hpp>
#include <boost/asio/steady_timer.hpp>
#include <cstdint>
#include <memory>
#include <vector>

#include "http/asio_types.h"
#include "http/worker.h"

namespace zebtell::http {

// Accepts connections on the first worker's thread and deals them out to all workers in turn.
class Listener {
  public:
    // Binds at once: RuntimeError when the address can't be had. `tls` may be null.
    Listener(std::vector<std::shared_ptr<Worker>> workers, std::shared_ptr<asio::ssl::context> tls);

    void Start();
    void UseTls(std::shared_ptr<asio::ssl::context> tls);  // any thread; for new connections
    void Stop();  // any thread; returns when no further connection is passed to a worker

    std::uint16_t port() const { return port_; }

  private:
    void Accept();
    void OnAccepted(const error_code& error, Worker& worker, Socket socket);
    void Admit(Worker& worker, Socket socket);

    const std::vector<std::shared_ptr<Worker>> workers_;
    ServerContext& context_;
    std::shared_ptr<asio::ssl::context> tls_;  // only on the acceptor's thread
    Acceptor acceptor_;
    asio::steady_timer pause_;
    std::uint16_t port_ = 0;
    std::size_t next_ = 0;
};

}  // namespace zebtell::http
