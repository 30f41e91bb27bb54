#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "http/limits.h"
#include "http/message.h"

namespace zebtell::http {

struct ServerOptions {
    std::string address = "127.0.0.1";  // or a name; "0.0.0.0" and "::" are all addresses
    std::uint16_t port = 0;             // 0: any free one
    unsigned io_threads = 0;            // 0: one for each core
    Limits limits;
    Timeouts timeouts;
    // PEM files; both or none. With them the port speaks TLS 1.2 and later only.
    std::string certificate_file;
    std::string key_file;
    // Addresses and networks whose X-Forwarded-For and X-Forwarded-Proto are believed.
    std::vector<std::string> trusted_proxies;
    // Told what nobody else hears of, on an IO thread: a handler that threw, accept that failed.
    std::function<void(std::string_view)> log;
};

// Speaks HTTP/1.1 and 1.0 with many clients. Each connection belongs to one IO thread for its whole
// life, and its requests are handled one at a time on that thread, in the order they came.
//
// The Responder that a handler gets may outlive the connection and the server. When the last copy
// is dropped without a call, and when the handler throws, the client is answered 500. A response
// given on the IO thread is sent at once; from another thread it is passed to the connection's.
class Server {
  public:
    // RuntimeError for trusted proxies that are no addresses.
    Server(ServerOptions options, Handler handler);
    ~Server();  // stops
    Server(const Server&) = delete;
    Server& operator=(const Server&) = delete;

    // Listens and begins to answer. RuntimeError when the address or the certificate can't be used.
    void Start();

    // Stops listening, closes idle connections, gives requests under way the stop timeout, closes
    // what is left and ends all threads. Not to be called from a handler. A second call does
    // nothing.
    void Stop();

    // Reads the certificate and its key anew, for connections from now on. RuntimeError when they
    // can't be used: the old ones stay. Does nothing without TLS.
    void ReloadCertificate();

    std::uint16_t port() const;  // after Start

  private:
    class Impl;
    std::unique_ptr<Impl> impl_;
};

}  // namespace zebtell::http
