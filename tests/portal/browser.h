#pragma once

#include <gtest/gtest.h>

#include <cstdint>
#include <initializer_list>
#include <string>
#include <string_view>
#include <utility>

#include "http/url.h"
#include "tests/support/raw_client.h"

namespace zebtell {

// A browser without a window: keeps its cookie, follows redirects, and holds the page that it
// came to.
class Browser {
  public:
    using Fields = std::initializer_list<std::pair<std::string, std::string>>;

    explicit Browser(std::uint16_t port) : port_(port) {}

    // "" is the bare address, "Kaubainfo" a page, "Kaubainfo&event=Favorites" one of its events.
    const std::string& Get(std::string_view page) { return Follow(Address(page), "GET", {}); }
    const std::string& Post(std::string_view page, Fields fields) {
        return Follow(Address(page), "POST", Encoded(fields));
    }
    const std::string& PostBody(std::string_view page, const std::string& body) {
        return Follow(Address(page), "POST", body);
    }
    const std::string& GetPath(const std::string& path) { return Follow(path, "GET", {}); }

    const std::string& LogOn(const std::string& user, const std::string& password) {
        return Post("Logon&event=Logon",
                    {{"ZEB_IN_KASUTAJATUNNUS", user}, {"ZEB_IN_PAROOL", password}});
    }

    const std::string& page() const { return page_; }
    const std::string& address() const { return address_; }
    int status() const { return status_; }
    const std::string& cookie() const { return cookie_; }
    void set_cookie(std::string cookie) { cookie_ = std::move(cookie); }

    // One request without following redirects; thread-safe only for separate browsers.
    testing::RawResponse Ask(const std::string& path,
                             const std::string& method,
                             const std::string& body,
                             const std::string& more_headers = {}) {
        testing::RawClient client(port_);
        client.set_time_limit(std::chrono::seconds(20));
        std::string request = method + " " + path + " HTTP/1.1\r\nHost: 127.0.0.1\r\n" +
                              more_headers + "Connection: close\r\n";
        if (!cookie_.empty()) request += "Cookie: " + cookie_ + "\r\n";
        if (method == "POST") {
            request += "Content-Type: application/x-www-form-urlencoded\r\nContent-Length: " +
                       std::to_string(body.size()) + "\r\n";
        }
        auto response = client.Ask(request + "\r\n" + body);
        for (const auto& [name, value] : response.headers) {
            if (base::EqualNoCase(name, "Set-Cookie")) cookie_ = value.substr(0, value.find(';'));
        }
        return response;
    }

    static std::string Address(std::string_view page) {
        return page.empty() ? "/" : "/?page=" + std::string(page);
    }
    static std::string Encoded(Fields fields) {
        std::string body;
        for (const auto& [name, value] : fields) {
            if (!body.empty()) body += '&';
            body += http::EncodeComponent(name) + "=" + http::EncodeComponent(value);
        }
        return body;
    }

  private:
    const std::string& Follow(std::string path, std::string method, std::string body) {
        for (int hops = 0; hops < 6; ++hops) {
            auto response = Ask(path, method, body);
            address_ = path;
            status_ = response.status;
            page_ = std::move(response.body);
            if (status_ != 303) return page_;
            path = response.Header("Location");
            method = "GET";
            body.clear();
        }
        throw std::runtime_error("redirects without end");
    }

    std::uint16_t port_;
    std::string cookie_;
    std::string page_;
    std::string address_;
    int status_ = 0;
};

}  // namespace zebtell
