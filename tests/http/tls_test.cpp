#include <gtest/gtest.h>
#include <openssl/pem.h>
#include <openssl/ssl.h>
#include <openssl/x509v3.h>
#include <unistd.h>

#include <filesystem>

#include "base/runtime_error.h"
#include "tests/http/test_server.h"

namespace zebtell::http {
namespace {

namespace fs = std::filesystem;

template <auto Free>
struct Freed {
    template <class T>
    void operator()(T* object) const {
        Free(object);
    }
};
using Key = std::unique_ptr<EVP_PKEY, Freed<EVP_PKEY_free>>;
using Certificate = std::unique_ptr<X509, Freed<X509_free>>;
using Bio = std::unique_ptr<BIO, Freed<BIO_free>>;
using Context = std::unique_ptr<SSL_CTX, Freed<SSL_CTX_free>>;
using Session = std::unique_ptr<SSL, Freed<SSL_free>>;

// A key and a certificate that it signed itself, as files.
class SelfSigned {
  public:
    SelfSigned() {
        fs::create_directories(folder_);
        Renew();
    }
    void Renew() const {
        const Key key(EVP_EC_gen("P-256"));
        const Certificate certificate(X509_new());
        ASN1_INTEGER_set(X509_get_serialNumber(certificate.get()), 1);
        X509_gmtime_adj(X509_getm_notBefore(certificate.get()), 0);
        X509_gmtime_adj(X509_getm_notAfter(certificate.get()), 3600);
        X509_set_pubkey(certificate.get(), key.get());
        X509_sign(certificate.get(), key.get(), EVP_sha256());
        const Bio certificate_out(BIO_new_file(certificate_file().c_str(), "w"));
        PEM_write_bio_X509(certificate_out.get(), certificate.get());
        const Bio key_out(BIO_new_file(key_file().c_str(), "w"));
        PEM_write_bio_PrivateKey(key_out.get(), key.get(), nullptr, nullptr, 0, nullptr, nullptr);
    }
    ~SelfSigned() { fs::remove_all(folder_); }
    SelfSigned(const SelfSigned&) = delete;
    SelfSigned& operator=(const SelfSigned&) = delete;

    std::string certificate_file() const { return folder_ / "certificate.pem"; }
    std::string key_file() const { return folder_ / "key.pem"; }

    ServerOptions Options() const {
        ServerOptions options = TwoThreads();
        options.certificate_file = certificate_file();
        options.key_file = key_file();
        return options;
    }

  private:
    static int Number() {
        static int number = 0;
        return ++number;
    }
    const fs::path folder_ =
        fs::temp_directory_path() /
        ("zebtell_tls_" + std::to_string(::getpid()) + "_" + std::to_string(Number()));
};

class TlsClient {
  public:
    explicit TlsClient(const TestServer& test, int newest = TLS1_3_VERSION)
        : client_(test.server.port()), context_(SSL_CTX_new(TLS_client_method())) {
        SSL_CTX_set_security_level(context_.get(), 0);  // so that old versions are offered at all
        SSL_CTX_set_min_proto_version(context_.get(), TLS1_VERSION);
        SSL_CTX_set_max_proto_version(context_.get(), newest);
        session_.reset(SSL_new(context_.get()));
        SSL_set_fd(session_.get(), client_.fd());
        connected_ = SSL_connect(session_.get()) == 1;
    }
    bool connected() const { return connected_; }
    // The server's, as its bytes.
    std::string certificate() const {
        const Certificate peer(SSL_get1_peer_certificate(session_.get()));
        unsigned char* bytes = nullptr;
        const int size = i2d_X509(peer.get(), &bytes);
        std::string copy(reinterpret_cast<char*>(bytes), static_cast<std::size_t>(size));
        OPENSSL_free(bytes);
        return copy;
    }
    std::string version() const { return SSL_get_version(session_.get()); }
    RawClient& socket() { return client_; }

    void Send(const std::string& bytes) {
        ASSERT_EQ(SSL_write(session_.get(), bytes.data(), static_cast<int>(bytes.size())),
                  static_cast<int>(bytes.size()));
    }
    // What comes until the text has ended so, or the server closes.
    std::string ReadUntil(const std::string& end) {
        std::string text;
        char bytes[4096];
        while (!text.ends_with(end)) {
            const int count = SSL_read(session_.get(), bytes, sizeof bytes);
            if (count <= 0) break;
            text.append(bytes, static_cast<std::size_t>(count));
        }
        return text;
    }
    bool IsClosedCleanly() {
        char byte;
        const int count = SSL_read(session_.get(), &byte, 1);
        return SSL_get_error(session_.get(), count) == SSL_ERROR_ZERO_RETURN;
    }

  private:
    RawClient client_;
    Context context_;
    Session session_;
    bool connected_ = false;
};

TEST(Tls, CarriesRequestsInBothVersions) {
    const SelfSigned files;
    TestServer test(
        [](const Request& request, const Responder& respond) {
            Response response;
            response.body = std::string(300'000, 'x') + (request.secure ? "secure" : "plain");
            respond(std::move(response));
        },
        files.Options());
    for (const int version : {TLS1_2_VERSION, TLS1_3_VERSION}) {
        TlsClient client(test, version);
        ASSERT_TRUE(client.connected());
        client.Send(Get("/") + Get("/", "Connection: close\r\n"));
        EXPECT_GT(client.ReadUntil("secure").size(), 300'000U);
        EXPECT_GT(client.ReadUntil("secure").size(), 300'000U);
        EXPECT_TRUE(client.IsClosedCleanly());
    }
}

TEST(Tls, RefusesOldVersionsAndPlainText) {
    const SelfSigned files;
    TestServer test(Echo, files.Options());
    EXPECT_FALSE(TlsClient(test, TLS1_1_VERSION).connected());
    RawClient plain = test.Connect();
    plain.Send(Get("/"));
    EXPECT_THROW(plain.Read(), std::runtime_error);
}

TEST(Tls, EarlyRefusalReachesAClientThatIsStillSending) {
    const SelfSigned files;
    TestServer test(Echo, files.Options());
    TlsClient client(test);
    client.Send("POST / HTTP/1.1\r\nHost: a\r\nContent-Length: 3000000\r\n\r\n");
    client.Send(std::string(3'000'000, 'x'));
    EXPECT_TRUE(client.ReadUntil("413 Content Too Large\n").starts_with("HTTP/1.1 413 "));
}

TEST(Tls, SlowClientsAreClosed) {
    const SelfSigned files;
    ServerOptions options = files.Options();
    options.timeouts.head = std::chrono::milliseconds(200);
    options.timeouts.linger = std::chrono::milliseconds(200);
    TestServer test(Echo, std::move(options));
    RawClient no_handshake = test.Connect();
    no_handshake.Send("\x16\x03\x01");
    TlsClient slow_head(test);
    slow_head.Send("GET / HT");
    EXPECT_TRUE(slow_head.ReadUntil("408 Request Timeout\n").starts_with("HTTP/1.1 408 "));
    EXPECT_TRUE(no_handshake.IsClosed());
    TlsClient forgotten(test);
    forgotten.Send(Get("/", "Connection: close\r\n"));
    EXPECT_NE(forgotten.ReadUntil("|/|"), "");
    const auto begin = std::chrono::steady_clock::now();
    test.server.Stop();
    EXPECT_LT(std::chrono::steady_clock::now() - begin, std::chrono::seconds(1));
}

TEST(Tls, TakesARenewedCertificateForNewConnections) {
    const SelfSigned files;
    TestServer test(Echo, files.Options());
    TlsClient before(test);
    const std::string first = before.certificate();
    files.Renew();
    test.server.ReloadCertificate();
    EXPECT_NE(TlsClient(test).certificate(), first);
    before.Send(Get("/still"));
    EXPECT_NE(before.ReadUntil("|/still|"), "");
    fs::remove(files.key_file());
    EXPECT_THROW(test.server.ReloadCertificate(), base::RuntimeError);
    EXPECT_TRUE(TlsClient(test).connected()) << "with what was read before";
    EXPECT_NO_THROW(TestServer().server.ReloadCertificate()) << "without TLS";
}

TEST(Tls, TellsFilesThatDoNotBelongTogether) {
    const SelfSigned files;
    const SelfSigned others;
    ServerOptions options = files.Options();
    options.key_file = others.key_file();
    EXPECT_THROW(Server(options, Echo).Start(), base::RuntimeError);
}

}  // namespace
}  // namespace zebtell::http
