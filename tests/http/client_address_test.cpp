#include "http/client_address.h"

#include <gtest/gtest.h>

#include "base/runtime_error.h"

namespace zebtell::http {
namespace {

struct Row {
    const char* label;
    const char* peer;
    std::vector<Header> headers;
    const char* address;
    bool secure;
};

TEST(TrustedProxies, TellTheClientsAddress) {
    const TrustedProxies proxies({"10.0.0.0/8", "192.168.1.7", "fd00::/9"});
    const std::string kFor = "X-Forwarded-For";
    const std::string kProto = "X-Forwarded-Proto";
    const Row rows[] = {
        {"stranger", "8.8.8.8", {{kFor, "1.1.1.1"}, {kProto, "https"}}, "8.8.8.8", false},
        {"network's end", "11.0.0.0", {{kFor, "1.1.1.1"}}, "11.0.0.0", false},
        {"neighbour", "192.168.1.6", {{kFor, "1.1.1.1"}}, "192.168.1.6", false},
        {"outside 9 bits", "fd80::1", {{kFor, "1.1.1.1"}}, "fd80::1", false},
        {"proxy", "10.9.9.9", {{kFor, "1.1.1.1"}, {kProto, "https"}}, "1.1.1.1", true},
        {"proxy without a word", "10.9.9.9", {}, "10.9.9.9", false},
        {"proxy over IPv6",
         "fd7f::1",
         {{"x-forwarded-for", "2001:DB8::0:1"}},
         "2001:db8::1",
         false},
        {"made up on the left", "10.0.0.1", {{kFor, "6.6.6.6, 1.1.1.1"}}, "1.1.1.1", false},
        {"through two proxies",
         "10.0.0.1",
         {{kFor, "6.6.6.6,1.1.1.1,\t10.0.0.2"}},
         "1.1.1.1",
         false},
        {"several headers", "10.0.0.1", {{kFor, "1.1.1.1"}, {kFor, "10.0.0.2"}}, "1.1.1.1", false},
        {"proxies only", "10.0.0.1", {{kFor, "10.0.0.3, 10.0.0.2"}}, "10.0.0.3", false},
        {"no address", "10.0.0.1", {{kFor, "1.1.1.1, unknown"}}, "10.0.0.1", false},
        {"no address beyond a proxy", "10.0.0.1", {{kFor, "<b>, 10.0.0.2"}}, "10.0.0.2", false},
        {"with ports", "10.0.0.1", {{kFor, "1.1.1.1:80, [fd00::1]:80"}}, "1.1.1.1", false},
        {"IPv4 over IPv6", "10.0.0.1", {{kFor, "::ffff:1.1.1.1"}}, "1.1.1.1", false},
        {"last protocol", "10.0.0.1", {{kProto, "https, http"}}, "10.0.0.1", false},
    };
    for (const Row& row : rows) {
        SCOPED_TRACE(row.label);
        Request request;
        request.headers = row.headers;
        proxies.SetClient(request, row.peer, false);
        EXPECT_EQ(request.remote_address, row.address);
        EXPECT_EQ(request.secure, row.secure);
    }
}

TEST(TrustedProxies, KnowTlsOfTheirOwnConnection) {
    Request request;
    request.headers = {{"X-Forwarded-Proto", "http"}};
    TrustedProxies().SetClient(request, "1.1.1.1", true);
    EXPECT_TRUE(request.secure);
}

TEST(TrustedProxies, RefuseWhatIsNoNetwork) {
    for (const char* text : {"",
                             "proxy",
                             "10.0.0",
                             "10.0.0.0/",
                             "10.0.0.0/33",
                             "10.0.0.0/-1",
                             "10.0.0.0/8x",
                             "fd00::/129"}) {
        EXPECT_THROW(TrustedProxies({text}), base::RuntimeError) << text;
    }
}

}  // namespace
}  // namespace zebtell::http
