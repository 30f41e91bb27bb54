#include "http/tls.h"

#include "base/runtime_error.h"

namespace zebtell::http {
namespace {

using Context = boost::asio::ssl::context;

void Check(const boost::system::error_code& error, const std::string& what) {
    if (!error) return;
    throw base::RuntimeError(base::errors::kUnspecified, what + ": " + error.message());
}

}  // namespace

std::shared_ptr<Context> MakeTlsContext(const std::string& certificate_file,
                                        const std::string& key_file) {
    auto context = std::make_shared<Context>(Context::tls_server);
    SSL_CTX* const native = context->native_handle();
    SSL_CTX_set_min_proto_version(native, TLS1_2_VERSION);
    SSL_CTX_set_options(native,
                        SSL_OP_NO_COMPRESSION | SSL_OP_NO_RENEGOTIATION |
                            SSL_OP_CIPHER_SERVER_PREFERENCE | SSL_OP_PRIORITIZE_CHACHA);
    SSL_CTX_set_cipher_list(native, "ECDHE+AESGCM:ECDHE+CHACHA20");
    boost::system::error_code error;
    context->use_certificate_chain_file(certificate_file, error);
    Check(error, "Certificate file " + certificate_file);
    context->use_private_key_file(key_file, Context::pem, error);
    Check(error, "Key file " + key_file);
    if (SSL_CTX_check_private_key(native) != 1) {
        throw base::RuntimeError(base::errors::kUnspecified,
                                 "Key file " + key_file + " does not belong to the certificate");
    }
    return context;
}

}  // namespace zebtell::http
