#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <map>
#include <optional>
#include <set>
#include <thread>

#include "tests/http/test_server.h"
#include "tests/support/portal_process.h"
#include "tests/support/source_folder.h"

namespace zebtell::http {
namespace {

using std::chrono::milliseconds;
using testing::Process;

constexpr const char* kClient = "127.0.0.2";  // unlike the proxies', which are believed

// What came to the server behind the proxies: how often each target was asked for.
class Arrivals {
  public:
    void Add(const Request& request) {
        const std::lock_guard lock(mutex_);
        targets_.insert(request.target);
        if (request.remote_address != kClient || request.secure)
            wrong_clients_.push_back(request.target + " from " + request.remote_address);
    }
    std::multiset<std::string> Of(const std::string& prefix) const {
        const std::lock_guard lock(mutex_);
        std::multiset<std::string> found;
        for (const std::string& target : targets_) {
            if (target.starts_with(prefix)) found.insert(target);
        }
        return found;
    }
    std::vector<std::string> wrong_clients() const {
        const std::lock_guard lock(mutex_);
        return wrong_clients_;
    }

  private:
    mutable std::mutex mutex_;
    std::multiset<std::string> targets_;
    std::vector<std::string> wrong_clients_;
};

struct Row {
    const char* label;
    std::string bytes;      // "@" stands for the row's own path
    bool is_clean = false;  // must pass, all of its requests; others may be refused
    std::vector<std::string> meant = {"@outer"};  // no other request may arrive
};

std::string PostOuter(const std::string& headers, const std::string& body) {
    return "POST @outer HTTP/1.1\r\nHost: shop\r\n" + headers + "\r\n" + body;
}

const std::string kInner = "GET @smuggled HTTP/1.1\r\nHost: shop\r\n\r\n";
const std::string kEnd = "0\r\n\r\n";
const std::string kLength =
    "Content-Length: " + std::to_string(kEnd.size() + kInner.size()) + "\r\n";

// Ways to make two readers disagree where the first request ends.
std::vector<Row> Rows() {
    const std::vector<std::string> kBoth = {"@outer", "@smuggled"};
    std::vector<Row> rows = {
        {"one", PostOuter("Content-Length: 2\r\n", "ab"), true},
        {"pipelined", PostOuter("Content-Length: 2\r\n", "ab") + kInner, true, kBoth},
        {"chunked", PostOuter("Transfer-Encoding: chunked\r\n", "2\r\nab\r\n" + kEnd), true},
        {"chunk extension",
         PostOuter("Transfer-Encoding: chunked\r\n", "2;a=b\r\nab\r\n" + kEnd),
         true},
        {"body like a request",
         PostOuter("Content-Length: " + std::to_string(kInner.size()) + "\r\n", kInner),
         true},
        {"forged client",
         PostOuter("X-Forwarded-For: 6.6.6.6\r\nX-Forwarded-For: 7.7.7.7, 127.0.0.1\r\n"
                   "X-Forwarded-Proto: https\r\nForwarded: for=6.6.6.6;proto=https\r\n"
                   "X-Real-IP: 6.6.6.6\r\nContent-Length: 0\r\n",
                   ""),
         true},
        {"forged client, underscores",
         PostOuter("X_Forwarded_For: 6.6.6.6\r\nX_Forwarded_Proto: https\r\nContent-Length: 0\r\n",
                   ""),
         true},
        {"forged client, hop by hop",
         PostOuter("Connection: X-Forwarded-For, close\r\nX-Forwarded-For: 6.6.6.6\r\n"
                   "Content-Length: 0\r\n",
                   "")},
        {"length, coding", PostOuter(kLength + "Transfer-Encoding: chunked\r\n", kEnd + kInner)},
        {"coding, length", PostOuter("Transfer-Encoding: chunked\r\n" + kLength, kEnd + kInner)},
        {"two lengths", PostOuter("Content-Length: 0\r\n" + kLength, kEnd + kInner)},
        {"two lengths, other order", PostOuter(kLength + "Content-Length: 0\r\n", kEnd + kInner)},
        // The next two have one meaning for those who take them, with the second request in it.
        {"length list", PostOuter("Content-Length: 0, 0\r\n", kInner), false, kBoth},
        {"chunk size ended by a line feed",
         PostOuter("Transfer-Encoding: chunked\r\n", "0\n\r\n" + kInner),
         false,
         kBoth},
        {"signed length", PostOuter("Content-Length: +0\r\n", kInner)},
        {"hex length", PostOuter("Content-Length: 0x0\r\n", kInner)},
        {"blank before colon", PostOuter("Content-Length : 0\r\n" + kLength, kEnd + kInner)},
        {"folded coding", PostOuter(kLength + "Transfer-Encoding:\r\n chunked\r\n", kEnd + kInner)},
        {"bare line feeds", "POST @outer HTTP/1.1\nHost: shop\n" + kLength + "\n" + kEnd + kInner},
        {"line feed hides a coding",
         PostOuter(kLength + "X: a\nTransfer-Encoding: chunked\r\n", kEnd + kInner)},
        {"carriage return hides a coding",
         PostOuter(kLength + "X: a\rTransfer-Encoding: chunked\r\n", kEnd + kInner)},
        {"NUL in a header", PostOuter(kLength + std::string("X: a\0b\r\n", 8), kEnd + kInner)},
        {"line feed in a chunk extension",
         PostOuter("Transfer-Encoding: chunked\r\n", "2;\nxx\r\n48\r\n" + kEnd + kInner)},
        {"chunk longer than it says",
         PostOuter("Transfer-Encoding: chunked\r\n", "1\r\nab\r\n" + kEnd + kInner)},
        {"huge chunk size",
         PostOuter("Transfer-Encoding: chunked\r\n", "10000000000000000\r\n" + kInner)},
        {"trailer that frames",
         PostOuter("Transfer-Encoding: chunked\r\n", "0\r\n" + kLength + "\r\n")},
        {"coding in 1.0",
         "POST @outer HTTP/1.0\r\nHost: shop\r\nConnection: keep-alive\r\nTransfer-Encoding: "
         "chunked\r\n" +
             kLength + "\r\n" + kEnd + kInner},
        {"body on a get",
         "GET @outer HTTP/1.1\r\nHost: shop\r\n" + kLength + "\r\n" + kEnd + kInner},
        {"absolute address", "GET http://other@outer HTTP/1.1\r\nHost: shop\r\n\r\n"},
        {"two hosts", "GET @outer HTTP/1.1\r\nHost: shop\r\nHost: other\r\n\r\n"},
        {"line break in the target",
         "GET @outer%0d%0aX:a HTTP/1.1\r\nHost: shop\r\n\r\n",
         false,
         {"@outer%0d%0aX:a"}},
    };
    for (const char* coding : {"xchunked",
                               "chunked, identity",
                               "identity, chunked",
                               "\"chunked\"",
                               "chunked;q=1",
                               "\tchunked",
                               "chunked\t",
                               "\x0b"
                               "chunked",
                               "gzip, chunked"}) {
        rows.push_back(
            {coding, PostOuter(kLength + "Transfer-Encoding: " + coding + "\r\n", kEnd + kInner)});
    }
    for (const char* line : {"Transfer-Encoding : chunked",
                             " Transfer-Encoding: chunked",
                             "Transfer_Encoding: chunked",
                             "X: x\r\n\tTransfer-Encoding: chunked",
                             "Transfer-Encoding: chunked\r\nTransfer-Encoding: x"}) {
        rows.push_back({line, PostOuter(kLength + line + "\r\n", kEnd + kInner)});
    }
    return rows;
}

std::uint16_t FreePort() {
    return TestServer().server.port();
}

// The example as it is delivered, but on free ports and without TLS.
std::string Deployed(const std::string& file, std::uint16_t listens, std::uint16_t portal) {
    std::ifstream in(SourceFolder() / "deploy" / file);
    std::string text;
    for (std::string line; std::getline(in, line);) {
        if (line.find("ssl_certificate") == line.npos) text += line + "\n";
    }
    const std::string here = "127.0.0.1:" + std::to_string(listens);
    for (const auto& [from, to] : std::map<std::string, std::string>{
             {"listen 443 ssl;", "listen " + here + ";"},
             {"bind :443 ssl crt /etc/ssl/orders/chain-and-key.pem", "bind " + here},
             {"maxconn 20000", "maxconn 200"},
             {"127.0.0.1:8080", "127.0.0.1:" + std::to_string(portal)}}) {
        text = base::Replaced(text, from, to);
    }
    EXPECT_THAT(text, ::testing::HasSubstr(here));
    return text;
}

class Smuggling : public ::testing::Test {
  protected:
    static ServerOptions Options() {
        ServerOptions options = TwoThreads();
        options.trusted_proxies = {"127.0.0.1"};
        return options;
    }

    void StartNginx() {
        const std::string around =
            "daemon off; master_process off; pid nginx.pid; error_log stderr;\n"
            "events {} http { access_log off; client_body_temp_path t1;\n"
            "proxy_temp_path t2; fastcgi_temp_path t3; uwsgi_temp_path t4;\n"
            "scgi_temp_path t5;\n";
        folder.Write("nginx.conf",
                     around + Deployed("nginx.conf", nginx_port, test.server.port()) + "}\n");
        nginx.emplace(
            std::vector<std::string>{"/usr/sbin/nginx", "-p", folder.path(), "-c", "nginx.conf"},
            folder.path() / "nginx.out");
    }
    void StartHaproxy() {
        folder.Write("haproxy.cfg", Deployed("haproxy.cfg", haproxy_port, test.server.port()));
        haproxy.emplace(
            std::vector<std::string>{
                "/usr/sbin/haproxy", "-db", "-f", folder.path() / "haproxy.cfg"},
            folder.path() / "haproxy.out");
    }
    void AwaitProxy(std::uint16_t port, const std::string& output) const {
        for (int tries = 0; tries < 100; ++tries) {
            try {
                const RawClient client(port);
                return;
            } catch (const std::runtime_error&) {
                std::this_thread::sleep_for(milliseconds(50));
            }
        }
        FAIL() << folder.Read(output);
    }

    Arrivals arrivals;
    TestServer test{[this](const Request& request, const Responder& respond) {
                        arrivals.Add(request);
                        Response response;
                        response.body = "(" + request.target + ")";
                        respond(std::move(response));
                    },
                    Options()};
    TempFolder folder;
    const std::uint16_t nginx_port = FreePort();
    const std::uint16_t haproxy_port = FreePort();
    std::optional<Process> nginx, haproxy;
};

// The targets that the answers on a connection are about.
std::multiset<std::string> Answered(const std::string& received) {
    std::multiset<std::string> targets;
    for (std::size_t at = 0; (at = received.find("\r\n\r\n(", at)) != received.npos; ++at) {
        const std::size_t begin = at + 5;
        targets.insert(received.substr(begin, received.find(')', begin) - begin));
    }
    return targets;
}

// Sends every row on a connection of its own, and looks what came when all is quiet.
void CheckRows(const std::vector<Row>& rows,
               const std::string& way,
               std::uint16_t port,
               const Arrivals& arrivals) {
    std::vector<std::unique_ptr<RawClient>> clients;
    const auto path = [&](std::size_t row) { return "/" + way + "/" + std::to_string(row) + "/"; };
    for (std::size_t i = 0; i < rows.size(); ++i) {
        clients.push_back(std::make_unique<RawClient>(port, kClient));
        clients.back()->Send(base::Replaced(rows[i].bytes, "@", path(i)));
    }
    for (std::size_t i = 0; i < rows.size(); ++i) {
        SCOPED_TRACE(way + ": " + rows[i].label);
        const std::string received = clients[i]->ReadUntilQuiet(milliseconds(i == 0 ? 1000 : 10));
        const auto arrived = arrivals.Of(path(i));
        std::multiset<std::string> meant;
        for (const std::string& target : rows[i].meant)
            meant.insert(base::Replaced(target, "@", path(i)));
        EXPECT_TRUE(std::includes(meant.begin(), meant.end(), arrived.begin(), arrived.end()))
            << ::testing::PrintToString(arrived) << " arrived";
        EXPECT_EQ(Answered(received), arrived) << received;
        if (rows[i].is_clean) {
            EXPECT_EQ(arrived, meant) << received;
        }
    }
}

// Whoever comes after the rows gets his own answer.
void CheckVictims(const std::string& way, std::uint16_t port) {
    for (int i = 0; i < 20; ++i) {
        const std::string target = "/victim/" + way + std::to_string(i);
        RawClient client(port, kClient);
        EXPECT_EQ(client.Ask(Get(target)).body, "(" + target + ")");
    }
}

TEST_F(Smuggling, NoRequestIsReadInTwoWays) {
    StartNginx();
    StartHaproxy();
    AwaitProxy(nginx_port, "nginx.out");
    AwaitProxy(haproxy_port, "haproxy.out");
    const auto rows = Rows();
    for (const auto& [way, port] : std::map<std::string, std::uint16_t>{
             {"direct", test.server.port()}, {"nginx", nginx_port}, {"haproxy", haproxy_port}}) {
        CheckRows(rows, way, port, arrivals);
        CheckVictims(way, port);
    }
    EXPECT_THAT(arrivals.wrong_clients(), ::testing::IsEmpty());
}

}  // namespace
}  // namespace zebtell::http
