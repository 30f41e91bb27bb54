#include <gtest/gtest.h>

#include "erp/connection_pool.h"
#include "erp/key_table.h"
#include "erp/result_cache.h"

namespace zebtell::erp {
namespace {

struct Sized : Result {
    explicit Sized(std::size_t bytes) : bytes(bytes) {}
    std::size_t Bytes() const override { return bytes; }
    std::size_t bytes;
};

std::string Held(ResultCache& cache, std::int64_t version) {
    std::string held;
    for (const char* key : {"a", "b", "c", "d"}) {
        held += cache.Find(key, version) ? key : "-";
    }
    return held;
}

TEST(ResultCacheTest, UnusedResultsGoFirst) {
    ResultCache cache(2000);
    for (const char* key : {"a", "b", "c"}) {
        cache.Keep(key, 1, std::make_shared<Sized>(400));
    }
    EXPECT_EQ(Held(cache, 1), "abc-");
    cache.Find("a", 1);
    cache.Keep("d", 1, std::make_shared<Sized>(400));
    EXPECT_EQ(Held(cache, 1), "a-cd");
    EXPECT_LE(cache.bytes(), 2000U);
    // What would push out most of the others is not kept.
    cache.Keep("b", 1, std::make_shared<Sized>(1500));
    EXPECT_EQ(Held(cache, 1), "a-cd");
}

TEST(ResultCacheTest, ResultsOfAnotherVersionDoNotCount) {
    ResultCache cache(10000);
    cache.Keep("a", 1, std::make_shared<Sized>(1));
    EXPECT_EQ(Held(cache, 2), "----");
    // A reader who looked at the version before it changed comes late.
    cache.Keep("b", 1, std::make_shared<Sized>(1));
    EXPECT_EQ(Held(cache, 1), "----");
    cache.Keep("c", 2, std::make_shared<Sized>(1));
    EXPECT_EQ(Held(cache, 1), "----");
    EXPECT_EQ(Held(cache, 2), "--c-");
}

TEST(ResultCacheTest, KeysTellValuesApart) {
    const auto key = [](const char* text, std::vector<base::Value> values) {
        return ResultKey('q', {text, std::move(values)});
    };
    EXPECT_EQ(key("x ?", {1}), key("x ?", {1}));
    EXPECT_NE(key("x ?", {1}), key("x ?", {"1"}));
    EXPECT_NE(key("x ?", {1, 23}), key("x ?", {12, 3}));
    EXPECT_NE(key("x ?", {1}), ResultKey('k', {"x ?", {1}}));
}

struct Numbers : Cursor {
    explicit Numbers(std::vector<std::vector<std::int64_t>> rows) : rows(std::move(rows)) {}
    const std::vector<std::string>& Columns() const override { return columns; }
    bool Next() override { return ++at < static_cast<std::int64_t>(rows.size()); }
    base::Value Get(std::size_t column) const override { return GetInteger(column); }
    std::int64_t GetInteger(std::size_t column) const override {
        return rows[static_cast<std::size_t>(at)][column];
    }
    std::vector<std::string> columns;
    std::vector<std::vector<std::int64_t>> rows;
    std::int64_t at = -1;
};

TEST(KeyTableTest, FindsTheFirstRowOfANumber) {
    constexpr std::int64_t kWide = 5'000'000'000;
    Numbers cursor({{7, 3}, {kWide, 3}, {-2, kWide}, {9, 0}});
    const KeyTable keys(cursor, {"IDGRArticle"});
    EXPECT_EQ(keys.Get(1, 0), kWide);
    EXPECT_EQ(keys.Get(0, 0), 7);
    EXPECT_EQ(keys.Find(0, kWide), 1U);
    EXPECT_EQ(keys.Find(0, -2), 2U);
    EXPECT_EQ(keys.Find(0, 8), std::nullopt);
    EXPECT_EQ(keys.Find(*keys.ColumnOf("idgrarticle"), 3), 0U);
    EXPECT_EQ(keys.Find(*keys.ColumnOf("idgrarticle"), kWide), 2U);
    EXPECT_EQ(keys.ColumnOf("Price"), std::nullopt);
    EXPECT_EQ(KeyTable().Find(0, 1), std::nullopt);
    EXPECT_EQ(KeyTable(5).Find(0, 5), 0U);
}

TEST(KeyTableTest, EveryOfManyKeysIsFound) {
    std::vector<std::vector<std::int64_t>> rows;
    for (std::int64_t i = 0; i < 5000; ++i) {
        rows.push_back({i * 4096});
    }
    Numbers cursor(rows);
    const KeyTable keys(cursor, {});
    for (std::size_t i = 0; i < rows.size(); ++i) {
        ASSERT_EQ(keys.Find(0, rows[i][0]), i);
        ASSERT_EQ(keys.Find(0, rows[i][0] + 1), std::nullopt);
    }
}

// A database whose every statement is a commit.
struct Counting : Connection {
    explicit Counting(std::int64_t& commits) : commits(commits) {}
    std::unique_ptr<Cursor> Query(const BoundSql&) override { return nullptr; }
    void Execute(const BoundSql&) override { ++commits; }
    std::int64_t Insert(const BoundSql&) override { return 0; }
    void Begin() override {}
    void Commit() override {}
    void Rollback() noexcept override {}
    DatabaseDescription Describe() override { return {}; }
    std::int64_t& commits;
};

struct CountingWatch : CommitWatch {
    explicit CountingWatch(std::int64_t& commits) : commits(commits) {}
    std::int64_t DataVersion() override { return commits; }
    std::int64_t& commits;
};

struct CountingBackend : Backend {
    std::unique_ptr<Connection> Connect(Access) override {
        ++connections;
        return std::make_unique<Counting>(commits);
    }
    std::unique_ptr<CommitWatch> WatchCommits() override {
        return std::make_unique<CountingWatch>(commits);
    }
    Dialect dialect() const override { return Dialect::kSqlite; }
    std::int64_t commits = 0;
    int connections = 0;
};

TEST(ConnectionPoolTest, WhatThePoolHasWrittenIsNoticedAtOnce) {
    CountingBackend backend;
    ConnectionPool pool(backend);
    std::int64_t version = pool.DataVersion();
    for (int i = 0; i < 1000; ++i) {
        pool.Write()->Execute({});
        const std::int64_t next = pool.DataVersion();
        ASSERT_GT(next, version);
        version = next;
    }
    EXPECT_EQ(pool.DataVersion(), version);
    {
        const Lease first = pool.Read();
        const Lease second = pool.Read();
    }
    pool.Read();
    // One that writes, two that read.
    EXPECT_EQ(backend.connections, 3);
    pool.Write().Drop();
    pool.Write();
    EXPECT_EQ(backend.connections, 4);
}

}  // namespace
}  // namespace zebtell::erp
