#include <gmock/gmock.h>

#include <latch>
#include <memory>
#include <thread>

#include "base/runtime_error.h"
#include "erp/connection_pool.h"
#include "erp/transaction.h"
#include "tests/odbc/postgres_server.h"

namespace zebtell::erp {
namespace {

using base::Value;
using std::chrono::milliseconds;
using std::chrono::steady_clock;

// One server for all tests, each with tables of its own.
class PostgresTest : public testing::Test {
  protected:
    static void SetUpTestSuite() {
        if (PostgresServer::IsInstalled()) {
            server_ = std::make_unique<PostgresServer>();
        }
    }
    static void TearDownTestSuite() { server_.reset(); }

    void SetUp() override {
        if (!server_) {
            GTEST_SKIP() << "PostgreSQL and its ODBC driver are not installed";
        }
    }

    static void Run(const std::string& sql) { writer()->Execute({sql, {}}); }
    static std::unique_ptr<Connection> writer() {
        return server_->Backend().Connect(Access::kWrite);
    }
    // Rows with ";" behind each, values with blanks between them.
    static std::string Show(Connection& connection,
                            const std::string& sql,
                            const std::vector<Value>& values = {}) {
        const auto cursor = connection.Query({sql, values});
        std::string shown;
        while (cursor->Next()) {
            for (std::size_t i = 0; i < cursor->Columns().size(); ++i) {
                const Value value = cursor->Get(i);
                shown += (i == 0 ? "" : " ") + (value.IsNull() ? "null" : value.ToPlainText());
            }
            shown += ";";
        }
        return shown;
    }
    static std::string Show(const std::string& sql) { return Show(*writer(), sql); }
    static std::string DescriptionOf(const std::function<void()>& work) {
        try {
            work();
        } catch (const base::RuntimeError& error) {
            return error.what();
        }
        return "no error";
    }

    static inline std::unique_ptr<PostgresServer> server_;
};

TEST_F(PostgresTest, ValuesComeBackAsTheyWere) {
    Run("create table kinds (id serial, n numeric(18,0), m numeric(19,4), d float8, b boolean,"
        " t date, s timestamp, c varchar(40), p char(10), l text)");
    const auto connection = writer();
    const auto insert = [&](const std::vector<Value>& values) {
        return connection->Insert(
            {"insert into kinds (n, m, d, b, t, s, c, p, l) values (?, ?, ?, ?, ?, ?, ?, ?, ?)",
             values});
    };
    const Value date = *base::DateTime::FromIso("2026-01-05");
    const Value time = *base::DateTime::FromIso("2026-01-05 23:59:59");
    const std::string letters = "Õli \xF0\x9F\x94\xA9 š";
    std::string text;
    for (int i = 0; i < 9000; ++i) {
        text += letters;
    }
    EXPECT_EQ(insert({std::int64_t{123456789012345678},
                      base::Currency::FromText("922337203685477.5807"),
                      1.0 / 3,
                      true,
                      date,
                      time,
                      letters,
                      "ab",
                      text}),
              1);
    EXPECT_EQ(insert(std::vector<Value>(9, Value::Null())), 2);
    EXPECT_EQ(Show("select m::text from kinds where id = 1"), "922337203685477.5807;");

    const auto row = connection->Query({"select * from kinds order by id", {}});
    ASSERT_TRUE(row->Next());
    const std::vector<Value> wanted = {std::int64_t{1},
                                       std::int64_t{123456789012345678},
                                       922337203685477.5807,
                                       1.0 / 3,
                                       true,
                                       date,
                                       time,
                                       letters,
                                       "ab",
                                       text};
    for (std::size_t i = 0; i < wanted.size(); ++i) {
        EXPECT_TRUE(row->Get(i) == wanted[i])
            << row->Columns()[i] << " " << row->Get(i).ToPlainText().substr(0, 60);
    }
    ASSERT_TRUE(row->Next());
    for (std::size_t i = 1; i < wanted.size(); ++i) {
        EXPECT_TRUE(row->Get(i).IsNull()) << row->Columns()[i];
    }
    EXPECT_EQ(row->GetInteger(1), 0);
    EXPECT_FALSE(row->Next());
}

TEST_F(PostgresTest, LongResultsComeInBlocks) {
    const auto connection = server_->Backend().Connect(Access::kRead);
    // The same statement again, with other values and a shorter result.
    for (const int count : {5000, 999, 1000, 1001, 0, 1}) {
        const auto rows = connection->Query(
            {"select i, case when i % 3 = 0 then null else 'r' || i end::varchar(20)"
             " from generate_series(1, ?) i",
             {count}});
        int i = 0;
        while (rows->Next()) {
            ++i;
            ASSERT_EQ(rows->GetInteger(0), i);
            ASSERT_TRUE(rows->Get(1) ==
                        (i % 3 == 0 ? Value::Null() : Value("r" + std::to_string(i))));
        }
        EXPECT_EQ(i, count);
    }
}

TEST_F(PostgresTest, OneResultIsOpenAtATime) {
    const auto connection = server_->Backend().Connect(Access::kRead);
    {
        const auto first = connection->Query({"select 1", {}});
        EXPECT_EQ(DescriptionOf([&] {
                      connection->Query({"select 2", {}});
                  }),
                  "The connection's last result is still open");
    }
    EXPECT_EQ(Show(*connection, "select 2"), "2;");
}

TEST_F(PostgresTest, TheCatalogueIsReadWithTheRightsOfAReader) {
    Run("create table GRTax (ID numeric(18,0) primary key, Name char(20), TaxPercent float8)");
    Run("create table GRArticle (ID numeric(18,0) primary key, Code varchar(40), Name text,"
        " IDGRTax numeric(18,0) references GRTax(ID), Picture bytea, Price decimal(18,4))");
    Run("create table SomethingElse (ID integer)");
    Run("create view SQPriceList5 as select ID, IDGRTax from GRArticle");
    Run("create schema other; create table other.GRTax (ID integer, Wrong integer)");
    Run("create role reader login password 'x'");
    Run("grant select on GRTax, GRArticle, SQPriceList5 to reader");
    const auto connection = server_->Backend("reader", "x").Connect(Access::kRead);
    const DatabaseDescription description = connection->Describe();
    std::string shown;
    for (const TableInfo& table : description.tables) {
        shown += table.name + (table.is_view ? " (view)" : "");
        for (const Column& column : table.columns) {
            shown += " " + column.name + ":" + std::to_string(static_cast<int>(column.type)) +
                     (column.links_to.empty() ? "" : ">" + column.links_to);
        }
        shown += "\n";
    }
    EXPECT_EQ(shown,
              "grarticle id:0 code:5 name:5 idgrtax:0>grtax price:1\n"
              "grtax id:0 name:5 taxpercent:1\n"
              "sqpricelist5 (view) id:0 idgrtax:0\n");
    EXPECT_EQ(description.lengths.at("GRArticle.Code"), 40);

    Run("insert into GRTax values (1, 'Full', 22)");
    EXPECT_EQ(Show(*connection, "select Name, TaxPercent from GRTax"), "Full 22;");
    EXPECT_EQ(DescriptionOf([&] { Show(*connection, "select * from SomethingElse"); }),
              "The portal's database user may not do that");
    EXPECT_EQ(DescriptionOf([&] {
                  connection->Execute({"delete from GRTax", {}});
              }),
              "The database may not be written to");
    EXPECT_THROW(server_->Backend("reader", "wrong").Connect(Access::kRead), base::RuntimeError);
}

TEST_F(PostgresTest, ACutConnectionIsReplaced) {
    auto backend = server_->Backend();
    ConnectionPool pool(backend);
    pool.Read();
    const auto end_others = [] {
        Run("select pg_terminate_backend(pid) from pg_stat_activity"
            " where pid <> pg_backend_pid() and usename = 'portal'");
    };
    end_others();
    EXPECT_EQ(pool.Reading([](Connection& connection) { return Show(connection, "select 5"); }),
              "5;");
    // In the middle of a page that reads twice.
    int reads = 0;
    EXPECT_EQ(pool.Reading([&](Connection& connection) {
        const std::string first = Show(connection, "select 6");
        if (++reads == 1) {
            end_others();
        }
        return first + Show(connection, "select 7");
    }),
              "6;7;");
    EXPECT_EQ(reads, 2);
}

TEST_F(PostgresTest, AStatementThatRunsTooLongEndsWithItsConnection) {
    auto backend = server_->Backend();
    const auto connection = backend.Connect(Access::kRead);
    const auto start = steady_clock::now();
    EXPECT_EQ(DescriptionOf([&] { Show(*connection, "select pg_sleep(?)", {20}); }),
              "The statement took too long");
    EXPECT_LT(steady_clock::now() - start, milliseconds(5000));
    EXPECT_TRUE(connection->IsBroken());
}

TEST_F(PostgresTest, ConnectionsWorkSideBySide) {
    auto backend = server_->Backend();
    std::latch ready(3);
    const auto sleep = [&] {
        const auto connection = backend.Connect(Access::kRead);
        ready.arrive_and_wait();
        Show(*connection, "select pg_sleep(?)", {0.4});
    };
    std::thread first(sleep);
    std::thread second(sleep);
    ready.arrive_and_wait();
    const auto start = steady_clock::now();
    first.join();
    second.join();
    EXPECT_LT(steady_clock::now() - start, milliseconds(750));
}

TEST_F(PostgresTest, OfTwoThatLockEachOtherOutBothAreStored) {
    Run("create table accounts (id integer, amount integer);"
        "insert into accounts values (1, 0), (2, 0)");
    auto backend = server_->Backend();
    std::atomic<int> runs = 0;
    std::latch both_hold_one(2);
    // Who notices the deadlock is its victim: only one looks for it in time.
    const auto store = [&](int first, int second, const char* looks_after) {
        ConnectionPool pool(backend);
        pool.Write()->Execute({std::string("set deadlock_timeout = '") + looks_after + "'", {}});
        bool met = false;
        InTransaction(pool, [&](Connection& connection) {
            ++runs;
            connection.Execute({"update accounts set amount = amount + 1 where id = ?", {first}});
            if (!std::exchange(met, true)) {
                both_hold_one.arrive_and_wait();
            }
            connection.Execute({"update accounts set amount = amount + 1 where id = ?", {second}});
            return 0;
        });
    };
    std::thread other([&] { store(2, 1, "20s"); });
    store(1, 2, "50ms");
    other.join();
    EXPECT_EQ(runs, 3);
    EXPECT_EQ(Show("select sum(amount) from accounts"), "4;");
}

TEST_F(PostgresTest, AServerThatStopsLosesWhatWasNotCommitted) {
    Run("create table orders (id integer)");
    auto backend = server_->Backend();
    ConnectionPool pool(backend);
    EXPECT_THROW(InTransaction(pool,
                               [&](Connection& connection) {
                                   connection.Execute({"insert into orders values (?)", {1}});
                                   server_->Stop();
                                   connection.Execute({"insert into orders values (?)", {2}});
                                   return 0;
                               }),
                 TransientError);
    EXPECT_EQ(DescriptionOf([&] { pool.Read(); }), "The database server does not answer");
    server_->Start();
    EXPECT_EQ(pool.Reading([](Connection& connection) {
        return Show(connection, "select count(*) from orders");
    }),
              "0;");
    InTransaction(pool, [&](Connection& connection) {
        connection.Execute({"insert into orders values (?)", {1}});
        return 0;
    });
    EXPECT_EQ(Show("select count(*) from orders"), "1;");
}

}  // namespace
}  // namespace zebtell::erp
