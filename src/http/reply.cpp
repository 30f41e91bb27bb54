#include "http/reply.h"

#include <atomic>

#include "http/connection.h"
#include "http/response_head.h"

namespace zebtell::http {
namespace {

class Reply {
  public:
    explicit Reply(std::weak_ptr<Connection> connection) : connection_(std::move(connection)) {}
    ~Reply() {
        if (!is_given_) Give(ErrorResponse(500));
    }
    Reply(const Reply&) = delete;
    Reply& operator=(const Reply&) = delete;

    void Give(Response response) {
        if (is_given_.exchange(true)) return;
        if (const auto connection = connection_.lock()) connection->Respond(std::move(response));
    }

  private:
    std::weak_ptr<Connection> connection_;
    std::atomic<bool> is_given_ = false;
};

}  // namespace

Responder MakeResponder(std::weak_ptr<Connection> connection) {
    return [reply = std::make_shared<Reply>(std::move(connection))](Response response) {
        reply->Give(std::move(response));
    };
}

}  // namespace zebtell::http
