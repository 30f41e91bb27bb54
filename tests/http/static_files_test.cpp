#include "http/static_files.h"

#include <gtest/gtest.h>
#include <unistd.h>

#include <fstream>
#include <set>
#include <thread>

namespace zebtell::http {
namespace {

namespace fs = std::filesystem;

class StaticFilesTest : public ::testing::Test {
  protected:
    StaticFilesTest() {
        fs::create_directories(root_ / "site/css");
        fs::create_directories(root_ / "more/css");
        Write("site/css/style.css", "body {}");
        for (const char* name : {"site/page.htm",
                                 "site/zebtell.ini",
                                 "site/a.log",
                                 "site/a.db",
                                 "site/.hidden.css",
                                 "site/plain",
                                 "outside.css"}) {
            Write(name, "secret");
        }
    }
    ~StaticFilesTest() override { fs::remove_all(root_); }

    void Write(const fs::path& name, const std::string& bytes) const {
        std::ofstream(root_ / name, std::ios::binary) << bytes;
    }
    std::optional<Response> Ask(const std::string& target, std::vector<Header> headers = {}) {
        Request request;
        request.method = "GET";
        request.target = target;
        request.headers = std::move(headers);
        return files_.Serve(request);
    }
    int Status(const std::string& target, std::vector<Header> headers = {}) {
        return Ask(target, std::move(headers))->status;
    }
    static std::string HeaderOf(const Response& response, const std::string& name) {
        for (const auto& [header, value] : response.headers) {
            if (header == name) return value;
        }
        return {};
    }

    const fs::path root_ =
        fs::temp_directory_path() / ("zebtell_static_" + std::to_string(::getpid()));
    StaticFiles files_{{root_ / "site", root_ / "more"}, "/static/"};
};

TEST_F(StaticFilesTest, ServesWithTypeAndValidators) {
    const auto response = Ask("/static/css/st%79le.css?v=2");
    ASSERT_TRUE(response);
    EXPECT_EQ(response->status, 200);
    EXPECT_EQ(*response->shared_body, "body {}");
    EXPECT_EQ(HeaderOf(*response, "Content-Type"), "text/css; charset=utf-8");
    EXPECT_EQ(HeaderOf(*response, "Cache-Control"), "public, max-age=3600");
    EXPECT_FALSE(Ask("/other"));
    EXPECT_FALSE(Ask("/static"));
    Request post;
    post.method = "POST";
    post.target = "/static/css/style.css";
    EXPECT_EQ(files_.Serve(post)->status, 405);
}

TEST_F(StaticFilesTest, AnswersWhetherACopyIsStillGood) {
    const auto response = Ask("/static/css/style.css");
    const std::string tag = HeaderOf(*response, "ETag");
    const std::string date = HeaderOf(*response, "Last-Modified");
    const std::string old = "Sun, 06 Nov 1994 08:49:37 GMT";
    struct Row {
        std::vector<Header> headers;
        int status;
    };
    const Row rows[] = {
        {{{"If-None-Match", tag}}, 304},
        {{{"If-None-Match", "\"x\", W/" + tag}}, 304},
        {{{"If-None-Match", "*"}}, 304},
        {{{"If-None-Match", "\"x\""}}, 200},
        {{{"If-None-Match", "\"x\""}, {"If-Modified-Since", date}}, 200},
        {{{"If-Modified-Since", date}}, 304},
        {{{"If-Modified-Since", old}}, 200},
        {{{"If-Modified-Since", "yesterday"}}, 200},
    };
    for (const Row& row : rows) {
        const auto answer = Ask("/static/css/style.css", row.headers);
        EXPECT_EQ(answer->status, row.status) << row.headers.front().second;
        EXPECT_EQ(HeaderOf(*answer, "ETag"), tag);
        EXPECT_EQ(answer->shared_body == nullptr, row.status == 304);
    }
}

TEST_F(StaticFilesTest, LetsAnAddressWithItsVersionBeKept) {
    const auto kept = [&](const std::string& query) {
        return HeaderOf(*Ask("/static/css/style.css" + query), "Cache-Control");
    };
    const std::string version = files_.Version("css/style.css");
    EXPECT_EQ(version.size(), 8U);
    EXPECT_EQ(kept("?v=" + version), "public, max-age=31536000, immutable");
    EXPECT_EQ(kept("?v=0" + version), "public, max-age=3600");
    EXPECT_EQ(kept("?v="), "public, max-age=3600");
    EXPECT_EQ(files_.Version("page.htm"), "");
    EXPECT_EQ(files_.Version("../outside.css"), "");
}

TEST_F(StaticFilesTest, PacksTextsForThoseWhoTakeIt) {
    const std::string style(5000, 's');
    Write("site/long.css", style);
    Write("site/long.png", style);
    std::set<std::string> tags;
    for (const char* coding : {"", "gzip", "br"}) {
        const std::vector<Header> accept = {{"Accept-Encoding", coding}};
        const auto packed = Ask("/static/long.css", accept);
        EXPECT_EQ(HeaderOf(*packed, "Content-Encoding"), coding);
        EXPECT_EQ(HeaderOf(*packed, "Vary"), "Accept-Encoding");
        EXPECT_EQ(packed->shared_body->size() < 100, *coding != '\0');
        const std::string tag = HeaderOf(*packed, "ETag");
        EXPECT_TRUE(tags.insert(tag).second) << "other bytes, other tag: " << tag;
        EXPECT_EQ(Status("/static/long.css", {accept[0], {"If-None-Match", tag}}), 304);
        for (const char* as_it_is : {"/static/long.png", "/static/css/style.css"}) {
            EXPECT_EQ(HeaderOf(*Ask(as_it_is, accept), "Content-Encoding"), "") << as_it_is;
        }
    }
}

TEST_F(StaticFilesTest, StaysInsideItsFolderAndKinds) {
    fs::create_symlink(root_ / "outside.css", root_ / "site/link.css");
    fs::create_symlink(root_ / "site/zebtell.ini", root_ / "site/settings.css");
    fs::create_directory_symlink(root_, root_ / "site/up");
    fs::create_directory(root_ / "site/folder.css");
    Write("site/large.js", std::string(4 * 1024 * 1024 + 1, 'x'));
    for (const char* name : {"",
                             "css",
                             "css/",
                             "page.htm",
                             "page.htm%00.css",
                             "zebtell.ini",
                             "a.log",
                             "a.db",
                             "plain",
                             ".hidden.css",
                             "css/../.hidden.css",
                             "../outside.css",
                             "%2e%2e/outside.css",
                             "css/..%2f..%2foutside.css",
                             "..%5coutside.css",
                             "/css/style.css",
                             "css//style.css",
                             "link.css",
                             "settings.css",
                             "up/outside.css",
                             "folder.css",
                             "large.js",
                             "none.css"}) {
        EXPECT_EQ(Status("/static/" + std::string(name)), 404) << name;
    }
    fs::create_symlink("css/style.css", root_ / "site/inside.css");
    EXPECT_EQ(Status("/static/inside.css"), 200);
}

TEST_F(StaticFilesTest, NoticesChanges) {
    const auto before = Ask("/static/css/style.css");
    Write("site/css/style.css", "p {}");
    fs::last_write_time(root_ / "site/css/style.css",
                        fs::file_time_type::clock::now() + std::chrono::seconds(5));
    EXPECT_EQ(*Ask("/static/css/style.css")->shared_body, "body {}") << "within a second";
    std::this_thread::sleep_for(std::chrono::milliseconds(1050));
    const auto after = Ask("/static/css/style.css");
    EXPECT_EQ(*after->shared_body, "p {}");
    EXPECT_NE(HeaderOf(*after, "ETag"), HeaderOf(*before, "ETag"));
    EXPECT_EQ(*before->shared_body, "body {}") << "still being sent somewhere";
    fs::remove(root_ / "site/css/style.css");
    Write("more/css/gone.css", "i {}");
    EXPECT_EQ(Status("/static/css/gone.css"), 200);
    fs::rename(root_ / "more/css/gone.css", root_ / "more/css/style.css");
    std::this_thread::sleep_for(std::chrono::milliseconds(1050));
    EXPECT_EQ(*Ask("/static/css/style.css")->shared_body, "i {}") << "of the second folder";
    EXPECT_EQ(Status("/static/css/gone.css"), 404);
}

}  // namespace
}  // namespace zebtell::http
