#pragma once

#include <boost/asio/ssl/context.hpp>
#include <memory>
#include <string>

namespace zebtell::http {

// TLS 1.2 and later with forward secrecy only. RuntimeError for files that can't be used.
std::shared_ptr<boost::asio::ssl::context> MakeTlsContext(const std::string& certificate_file,
                                                          const std::string& key_file);

}  // namespace zebtell::http
