#include "tests/odbc/fake_sql_server.h"

#include <netinet/in.h>
#include <poll.h>
#include <sys/socket.h>
#include <unistd.h>

#include <algorithm>
#include <stdexcept>
#include <vector>

namespace zebtell::erp {
namespace {

constexpr char kLogin = 16;
constexpr char kPreLogin = 18;
constexpr std::size_t kHeader = 8;

template <class Number>
std::string Little(Number number) {
    std::string bytes;
    for (std::size_t i = 0; i < sizeof number; ++i) {
        bytes += static_cast<char>(static_cast<std::uint64_t>(number) >> (8 * i));
    }
    return bytes;
}

std::string Wide(const std::string& ascii) {
    std::string bytes;
    for (const char c : ascii) {
        bytes += {c, '\0'};
    }
    return bytes;
}

// A part of an answer: its mark, its length, its contents.
std::string Token(char mark, const std::string& contents) {
    return mark + Little(static_cast<std::uint16_t>(contents.size())) + contents;
}

std::string Done(std::uint16_t status) {
    return '\xfd' + Little(status) + Little(std::uint16_t{0}) + Little(std::uint64_t{0});
}

std::string LoginTaken() {
    const std::string program = "Microsoft SQL Server";
    return Token('\xad',
                 std::string("\x01\x74\x00\x00\x04", 5) + static_cast<char>(program.size()) +
                     Wide(program) + std::string("\x0f\x00\x00\x00", 4)) +
           Done(0);
}

std::string Error(std::int32_t number, const std::string& text) {
    const std::string words =
        Little(static_cast<std::uint16_t>(text.size())) + Wide(text) + std::string(2, '\0');
    return Token('\xaa', Little(number) + "\x01\x10" + words + Little(std::int32_t{1})) + Done(2);
}

// One row of one column of integers.
std::string Integer(std::int32_t number) {
    return '\x81' + Little(std::uint16_t{1}) + std::string(4, '\0') + std::string(2, '\0') +
           '\x38' + std::string(1, '\0') + '\xd1' + Little(number) + Done(0x10);
}

// No encryption, no instances.
std::string PreLoginTaken() {
    const std::string version("\x0f\x00\x07\xd0\x00\x00", 6);
    return std::string("\x00\x00\x0b\x00\x06\x01\x00\x11\x00\x01\xff", 11) + version + '\x02';
}

bool ReadBytes(int client, std::string& bytes, std::size_t count) {
    bytes.resize(count);
    std::size_t read = 0;
    while (read < count) {
        const ssize_t got = recv(client, bytes.data() + read, count - read, 0);
        if (got <= 0) {
            return false;
        }
        read += static_cast<std::size_t>(got);
    }
    return true;
}

// A message, whose packets say how long they are and which is the last. Its type; 0: no more.
char ReadMessage(int client, std::string& message) {
    message.clear();
    std::string header;
    std::string packet;
    while (ReadBytes(client, header, kHeader)) {
        const std::size_t length = static_cast<std::size_t>(static_cast<unsigned char>(header[2]))
                                       << 8 |
                                   static_cast<unsigned char>(header[3]);
        if (length < kHeader || !ReadBytes(client, packet, length - kHeader)) {
            return 0;
        }
        message += packet;
        if (header[1] & 1) {
            return header[0];
        }
    }
    return 0;
}

std::string Printable(const std::string& bytes) {
    std::string text;
    std::copy_if(bytes.begin(), bytes.end(), std::back_inserter(text), [](char c) {
        return c >= ' ' && c <= '~';
    });
    return text;
}

}  // namespace

FakeSqlServer::FakeSqlServer(Script script)
    : script_(std::move(script)), listener_(socket(AF_INET, SOCK_STREAM, 0)) {
    sockaddr_in address{};
    address.sin_family = AF_INET;
    address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    socklen_t size = sizeof address;
    auto* any = reinterpret_cast<sockaddr*>(&address);
    if (bind(listener_, any, size) != 0 || listen(listener_, 8) != 0 ||
        getsockname(listener_, any, &size) != 0) {
        throw std::runtime_error("no port to listen at");
    }
    port_ = ntohs(address.sin_port);
    thread_ = std::thread([this] { Accept(); });
}

FakeSqlServer::~FakeSqlServer() {
    stopping_ = true;
    shutdown(listener_, SHUT_RDWR);
    thread_.join();
    close(listener_);
}

std::string FakeSqlServer::connection_string() const {
    return std::string("Driver=") + ZEBTELL_FREETDS_ODBC +
           ";Server=127.0.0.1;Port=" + std::to_string(port_) +
           ";Database=erp;UID=portal;PWD=x;TDS_Version=7.4";
}

void FakeSqlServer::Accept() {
    std::vector<std::thread> clients;
    std::vector<int> open;
    while (true) {
        const int client = accept(listener_, nullptr, nullptr);
        if (client < 0) {
            break;
        }
        ++connections_;
        open.push_back(client);
        clients.emplace_back([this, client] { Serve(client); });
    }
    for (const int client : open) {
        shutdown(client, SHUT_RDWR);
    }
    for (auto& client : clients) {
        client.join();
    }
    for (const int client : open) {
        close(client);
    }
}

void FakeSqlServer::Serve(int client) {
    std::string message;
    while (const char type = ReadMessage(client, message)) {
        if (type == kPreLogin) {
            Reply(client, 4, PreLoginTaken());
            continue;
        }
        const Answer answer = script_(type == kLogin ? "" : Printable(message));
        switch (answer.kind) {
            case Answer::Kind::kDone:
                Reply(client, 4, type == kLogin ? LoginTaken() : Done(0));
                break;
            case Answer::Kind::kInteger:
                Reply(client, 4, Integer(answer.number));
                break;
            case Answer::Kind::kError:
                Reply(client, 4, Error(answer.number, answer.text));
                break;
            case Answer::Kind::kSilence:
                break;
            case Answer::Kind::kGarbage:
                Reply(client, 'x', "HTTP/1.1 400 Bad Request");
                break;
            case Answer::Kind::kHangUp:
                shutdown(client, SHUT_RDWR);
                return;
        }
    }
}

bool FakeSqlServer::Reply(int client, char type, const std::string& message) {
    const auto length = static_cast<std::uint16_t>(message.size() + kHeader);
    const std::string packet = std::string{type, '\x01'} + static_cast<char>(length >> 8) +
                               static_cast<char>(length & 0xFF) + std::string(4, '\0') + message;
    return send(client, packet.data(), packet.size(), MSG_NOSIGNAL) ==
           static_cast<ssize_t>(packet.size());
}

}  // namespace zebtell::erp
