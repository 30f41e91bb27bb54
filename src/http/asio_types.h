#pragma once

#include <boost/asio/io_context.hpp>
#include <boost/asio/ip/tcp.hpp>
#include <boost/system/error_code.hpp>

// Only for the few files of this layer that talk to sockets: what it includes is slow to compile.
namespace zebtell::http {

namespace asio = boost::asio;
using boost::system::error_code;

// With the executor's own type: the general one costs a call through a pointer each time.
using Executor = asio::io_context::executor_type;
using Socket = asio::basic_stream_socket<asio::ip::tcp, Executor>;
using Acceptor = asio::basic_socket_acceptor<asio::ip::tcp, Executor>;

}  // namespace zebtell::http
