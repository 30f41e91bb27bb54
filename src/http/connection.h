#pragma once

#include <boost/asio/ssl/context.hpp>
#include <chrono>
#include <memory>
#include <string>

#include "http/asio_types.h"
#include "http/message.h"
#include "http/worker.h"

namespace zebtell::http {

// One client's connection. Used by its worker's thread alone, Respond excepted; the worker keeps
// it until it is closed.
class Connection : public std::enable_shared_from_this<Connection> {
  public:
    Connection() = default;
    virtual ~Connection() = default;
    Connection(const Connection&) = delete;
    Connection& operator=(const Connection&) = delete;

    virtual void Start() = 0;
    // Answers the request that is being handled. From any thread.
    virtual void Respond(Response response) = 0;
    virtual void OnOverdue() = 0;
    virtual void CloseWhenIdle() = 0;
    virtual void Close() = 0;

    bool IsOverdue(Worker::Clock::time_point now, bool is_crowded) const {
        return now >= (is_crowded ? crowded_deadline_ : deadline_);
    }

  protected:
    void SetDeadlines(Worker::Clock::time_point usual, Worker::Clock::time_point crowded) {
        deadline_ = usual;
        crowded_deadline_ = crowded;
    }

  private:
    Worker::Clock::time_point deadline_ = Worker::Clock::time_point::max();
    Worker::Clock::time_point crowded_deadline_ = Worker::Clock::time_point::max();
};

// Takes over a socket that was counted in under `peer`; it is counted out when it is closed.
// `tls` may be null.
std::shared_ptr<Connection> MakeConnection(std::shared_ptr<Worker> worker,
                                           Socket socket,
                                           std::string peer,
                                           std::shared_ptr<asio::ssl::context> tls);

}  // namespace zebtell::http
