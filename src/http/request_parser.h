#pragma once

#include <cstddef>
#include <memory>
#include <string_view>

#include "http/limits.h"
#include "http/message.h"

namespace zebtell::http {

// Reads requests off a connection's bytes, one after another, and refuses whatever two parties on
// the way could understand differently (which is how requests are smuggled past a proxy).
class RequestParser {
  public:
    enum class State { kHead, kBody, kDone, kRefused };

    // The limits must outlive the parser.
    explicit RequestParser(const Limits& limits);
    ~RequestParser();
    RequestParser(const RequestParser&) = delete;
    RequestParser& operator=(const RequestParser&) = delete;

    // Takes what it can of `bytes` and returns how many. The others are to be handed in again,
    // together with what follows them.
    std::size_t Take(std::string_view bytes);

    State state() const;
    int refusal() const;            // the status to answer when the state is kRefused
    bool has_begun() const;         // a byte of the current request has come
    std::size_t body_size() const;  // what has come of the body

    // From kBody on:
    bool keep_alive() const;  // what the client wishes
    bool is_http10() const;
    bool expects_continue() const;  // and its body has not begun

    bool is_head() const;  // the method is HEAD; known from the request line on

    Request TakeRequest();  // when kDone
    void Reset();           // makes it ready for the connection's next request

  private:
    class Impl;
    std::unique_ptr<Impl> impl_;
};

}  // namespace zebtell::http
