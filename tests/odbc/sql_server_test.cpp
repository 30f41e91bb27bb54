#include <gmock/gmock.h>

#include <chrono>
#include <mutex>
#include <utility>
#include <vector>

#include "base/runtime_error.h"
#include "erp/connection_pool.h"
#include "erp/database.h"
#include "erp/odbc/backend.h"
#include "erp/transaction.h"
#include "tests/odbc/fake_sql_server.h"

namespace zebtell::erp {
namespace {

using base::Value;
using testing::HasSubstr;
using Answer = FakeSqlServer::Answer;
using Kind = Answer::Kind;
using std::chrono::seconds;
using std::chrono::steady_clock;

std::string DescriptionOf(const std::function<void()>& work) {
    try {
        work();
    } catch (const base::RuntimeError& error) {
        return error.what();
    }
    return "no error";
}

// What a free driver for SQL Server makes of the adapter's calls, and of what a server does. The
// answers hold for requests that contain a word; others are "done".
class SqlServerTest : public testing::Test {
  protected:
    struct Rule {
        std::string word;
        Answer answer;
        int times = 1000;
    };

    Answer AnswerTo(const std::string& request) {
        const std::lock_guard lock(mutex_);
        requests_ += request + "\n";
        for (Rule& rule : rules_) {
            const bool fits =
                rule.word.empty() ? request.empty() : request.find(rule.word) != std::string::npos;
            if (fits && rule.times-- > 0) {
                return rule.answer;
            }
        }
        return {};
    }
    void Script(std::vector<Rule> rules) {
        const std::lock_guard lock(mutex_);
        rules_ = std::move(rules);
    }
    std::string Requests() {
        const std::lock_guard lock(mutex_);
        return requests_;
    }

    std::mutex mutex_;
    std::vector<Rule> rules_;
    std::string requests_;
    FakeSqlServer server_{[this](const std::string& request) { return AnswerTo(request); }};
    odbc::OdbcBackend backend_{server_.connection_string(),
                               odbc::SqlServer(),
                               {.connect = seconds(2), .statement = seconds(1)}};
};

TEST_F(SqlServerTest, ValuesAreBoundAsWhatTheyAre) {
    const auto connection = backend_.Connect(Access::kWrite);
    connection->Execute({"UPDATE T SET a=?,b=?,c=?,d=?,e=?,f=?,g=?,h=?",
                         {"text",
                          5,
                          2.5,
                          base::Currency::FromText("12.34"),
                          Value::Null(),
                          *base::DateTime::FromIso("2026-01-05 10:11:12"),
                          true,
                          1.0 / 3}});
    EXPECT_THAT(Requests(),
                HasSubstr("@P1 NVARCHAR(4000),@P2 BIGINT,@P3 DECIMAL(19,4),@P4 DECIMAL(19,4),"
                          "@P5 NVARCHAR(4000),@P6 DATETIME2,@P7 BIT,@P8 FLOAT"));
    // 30,000 IDs in one value, which comes whole.
    const std::string list = "[" + std::string(180'000, '7') + "]";
    connection->Execute({"DELETE FROM T WHERE ID IN (SELECT value FROM OPENJSON(?))", {list}});
    EXPECT_THAT(Requests(), HasSubstr("@P1 NVARCHAR(MAX)"));
    EXPECT_THAT(Requests(), HasSubstr(list));
}

TEST_F(SqlServerTest, SettingsAndTransactionsAreBatchesOfTheirOwn) {
    Script({{"SCOPE_IDENTITY", {.kind = Kind::kInteger, .number = 4711}}});
    const auto connection = backend_.Connect(Access::kWrite);
    connection->Begin();
    EXPECT_EQ(connection->Insert({"INSERT INTO T (a) VALUES (?)", {1}}), 4711);
    connection->Commit();
    // A procedure's call would have its number before the text.
    const std::string requests = Requests();
    for (const char* batch : {"\nSET NOCOUNT ON; SET XACT_ABORT ON;",
                              "\nSET TRANSACTION ISOLATION LEVEL SERIALIZABLE\n",
                              "\nBEGIN TRANSACTION\n",
                              "\nCOMMIT TRANSACTION\n"}) {
        EXPECT_THAT(requests, HasSubstr(batch));
    }
    EXPECT_THAT(requests,
                HasSubstr("INSERT INTO T (a) VALUES (@P1); SELECT CAST(SCOPE_IDENTITY()"));
}

TEST_F(SqlServerTest, ErrorsOfTheServerHaveTheirMeanings) {
    const struct {
        int number;
        const char* words;
        int error;
        const char* description;
        bool broken;
    } rows[] = {
        {1222,
         "Lock request time out period exceeded.",
         base::errors::kUnspecified,
         "The database is busy",
         false},
        {229,
         "The SELECT permission was denied on the object 'GRTax'.",
         base::errors::kUnspecified,
         "The portal's database user may not do that",
         false},
        {2628,
         "String or binary data would be truncated in table 'erp.dbo.SDOrder', column "
         "'Explanation'. Truncated value: 'secret'.",
         base::errors::kInvalidCall,
         "Explanation is too long",
         false},
        {8152,
         "String or binary data would be truncated.",
         base::errors::kInvalidCall,
         "A text is longer than its column",
         false},
        {2627,
         "Violation of UNIQUE KEY constraint.",
         base::errors::kStatementFailed,
         "The record conflicts with another one",
         false},
        {208,
         "Invalid object name 'X'.",
         base::errors::kNoSuchTable,
         "No such table: Invalid object name &#39;X&#39;.",
         false},
        {9002,
         "The transaction log is full.",
         base::errors::kUnspecified,
         "There is no room left for the company database",
         false},
        {207,
         "Invalid column name 'a<b'.",
         base::errors::kStatementFailed,
         "The statement failed: Invalid column name &#39;a&lt;b&#39;.",
         false},
    };
    for (const auto& row : rows) {
        Script({{"SELECT a", {.kind = Kind::kError, .number = row.number, .text = row.words}}});
        const auto connection = backend_.Connect(Access::kRead);
        try {
            connection->Query({"SELECT a FROM T WHERE b = ?", {1}});
            ADD_FAILURE() << row.number;
        } catch (const base::RuntimeError& error) {
            EXPECT_EQ(error.number(), row.error) << row.number;
            EXPECT_STREQ(error.what(), row.description);
        }
        EXPECT_EQ(connection->IsBroken(), row.broken) << row.number;
        // The connection is of use again.
        Script({});
        connection->Execute({"SELECT a FROM T WHERE b = ?", {1}});
    }
}

TEST_F(SqlServerTest, ALogOnThatIsRefusedIsNotAServerThatIsAway) {
    for (const int number : {18456, 18470, 18488}) {
        Script({{"", {.kind = Kind::kError, .number = number, .text = "Login failed."}}});
        EXPECT_THROW(backend_.Connect(Access::kRead), LoginRefused) << number;
    }
    Script({{"", {.kind = Kind::kError, .number = 4060, .text = "Cannot open database."}}});
    EXPECT_EQ(DescriptionOf([&] { backend_.Connect(Access::kRead); }),
              "The company database is not there");
    Script({{"", {.kind = Kind::kHangUp}}});
    EXPECT_EQ(DescriptionOf([&] { backend_.Connect(Access::kRead); }),
              "The database server does not answer");
}

TEST_F(SqlServerTest, ConnectingEndsInTime) {
    const auto start = steady_clock::now();
    for (const Kind kind : {Kind::kSilence, Kind::kGarbage}) {
        Script({{"", {.kind = kind}}});
        EXPECT_EQ(DescriptionOf([&] { backend_.Connect(Access::kRead); }),
                  "The database server does not answer");
    }
    odbc::OdbcBackend nobody(std::string("Driver=") + ZEBTELL_FREETDS_ODBC +
                             ";Server=127.0.0.1;Port=1;UID=portal;PWD=x");
    EXPECT_EQ(DescriptionOf([&] { nobody.Connect(Access::kRead); }),
              "The database server does not answer");
    EXPECT_LT(steady_clock::now() - start, seconds(6));
}

TEST_F(SqlServerTest, AStatementWithoutAnswerBreaksItsConnection) {
    Script({{"SELECT slow", {.kind = Kind::kSilence}}});
    const auto connection = backend_.Connect(Access::kRead);
    const auto start = steady_clock::now();
    EXPECT_EQ(DescriptionOf([&] {
                  connection->Query({"SELECT slow FROM T", {}});
              }),
              "The statement took too long");
    EXPECT_LT(steady_clock::now() - start, seconds(4));
    EXPECT_TRUE(connection->IsBroken());
}

// Only the first connection is lost, so the second try succeeds.
TEST_F(SqlServerTest, ALostReadIsTriedAgainOnANewConnection) {
    Script({{"SELECT a", {.kind = Kind::kHangUp}, 1},
            {"SELECT a", {.kind = Kind::kInteger, .number = 7}}});
    ConnectionPool pool(backend_);
    const auto read = [](Connection& connection) {
        const auto cursor = connection.Query({"SELECT a FROM T WHERE b = ?", {1}});
        return cursor->Next() ? cursor->GetInteger(0) : 0;
    };
    EXPECT_EQ(pool.Reading(read), 7);
    EXPECT_EQ(server_.connections(), 2);
    EXPECT_EQ(pool.Reading(read), 7);
    EXPECT_EQ(server_.connections(), 2);
    Script({{"SELECT a", {.kind = Kind::kHangUp}}});
    EXPECT_THROW(pool.Reading(read), TransientError);
    EXPECT_EQ(server_.connections(), 3);
}

TEST_F(SqlServerTest, ADeadlockVictimIsRunOnceMore) {
    const Answer deadlock{.kind = Kind::kError, .number = 1205, .text = "deadlocked"};
    ConnectionPool pool(backend_);
    int runs = 0;
    const auto store = [&](Connection& connection) {
        connection.Execute({"UPDATE T SET a = ?", {1}});
        return ++runs;
    };
    Script({{"UPDATE T", deadlock, 1}});
    EXPECT_EQ(InTransaction(pool, store), 1);
    // As a whole: rolled back, begun anew, committed.
    const std::string requests = Requests();
    const std::size_t end = requests.find("IF @@TRANCOUNT > 0 ROLLBACK TRANSACTION\n");
    ASSERT_NE(end, std::string::npos);
    EXPECT_THAT(requests.substr(end), HasSubstr("\nBEGIN TRANSACTION\n"));
    EXPECT_THAT(requests.substr(end), testing::EndsWith("\nCOMMIT TRANSACTION\n"));
    Script({{"UPDATE T", deadlock, 2}});
    EXPECT_EQ(DescriptionOf([&] { InTransaction(pool, store); }), "The database is busy");
}

// Nobody knows what has become of it, so it is not run again.
TEST_F(SqlServerTest, ALostCommitIsNotRepeated) {
    Script({{"COMMIT", {.kind = Kind::kHangUp}}});
    ConnectionPool pool(backend_);
    int runs = 0;
    EXPECT_THROW(InTransaction(pool, [&](Connection&) { return ++runs; }), TransientError);
    EXPECT_EQ(runs, 1);
    Script({});
    EXPECT_EQ(InTransaction(pool, [&](Connection&) { return ++runs; }), 2);
    EXPECT_EQ(server_.connections(), 2);
}

TEST_F(SqlServerTest, AnIdleConnectionIsAskedBeforeItIsLent) {
    ConnectionPool pool(backend_, {.trusted = std::chrono::milliseconds(0)});
    { const Lease first = pool.Write(); }
    Script({{"SELECT 1", {.kind = Kind::kHangUp}, 1}});
    pool.Write()->Execute({"UPDATE T SET a = ?", {1}});
    EXPECT_EQ(server_.connections(), 2);
    { const Lease again = pool.Write(); }
    EXPECT_EQ(server_.connections(), 2);
}

TEST_F(SqlServerTest, APoolHasNoMoreReadersThanItsLimit) {
    ConnectionPool pool(backend_, {.readers = 2, .wait = std::chrono::milliseconds(50)});
    {
        const Lease first = pool.Read();
        const Lease second = pool.Read();
        EXPECT_EQ(DescriptionOf([&] { pool.Read(); }), "The database is busy");
    }
    pool.Read();
    EXPECT_EQ(server_.connections(), 2);
}

}  // namespace
}  // namespace zebtell::erp
