#include "fleet/ClickHouse.h"

#include "fleet/ServerStore.h"
#include "tests/fleet/FakeServer.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using doubles::FakeServer;

constexpr Patience kImpatient{
    std::chrono::milliseconds(500), std::chrono::milliseconds(100), {}, {}};

std::string answer(const std::string& body, const std::string& status = "200 OK") {
    return "HTTP/1.1 " + status + "\r\nContent-Length: " + std::to_string(body.size()) +
           "\r\nConnection: close\r\n\r\n" + body;
}

/// The sentence when a server is asked.
std::string sentence(const FakeServer& server, const Patience& patience = kImpatient) {
    const StoreAddress address{"127.0.0.1", server.port(), "fleet"};
    try {
        (void)ClickHouse(address, patience).rows("SELECT 1 AS n", 1);
    } catch (const StoreFailure& failure) {
        std::string text = failure.what();
        const std::string where = address.text();
        const std::size_t at = text.find(where);
        return at != std::string::npos ? text.replace(at, where.size(), "SERVER") : text;
    }
    return "";
}

TEST(ClickHouseTest, GivesRows) {
    const FakeServer server(answer("n\nUInt8\n1\n2\n"));
    ClickHouse house({"127.0.0.1", server.port(), "fleet"}, kImpatient);
    const auto rows = house.rows("SELECT 'a%b' AS n", 1);
    ASSERT_EQ(rows.size(), 2U);
    EXPECT_EQ(rows[1][0], QueryValue(std::int64_t{2}));
    EXPECT_TRUE(server.received().starts_with(
        "POST /?database=fleet&default_format=TabSeparatedWithNamesAndTypes&wait_end_of_query=1&"
        "readonly=2&enable_optimize_predicate_expression=1 HTTP/1.1\r\n"))
        << server.received();
    EXPECT_NE(server.received().find("SELECT 'a%b' AS n"), std::string::npos);
}

TEST(ClickHouseTest, RefusalsAreSentences) {
    const auto refused = [](const std::string& text) {
        return sentence(FakeServer(answer(text, "500 Internal Server Error")));
    };
    EXPECT_EQ(refused("Code: 62, e.displayText() = DB::Exception: Syntax error: failed at position "
                      "1., e.what() = DB::Exception\n"),
              "SERVER: Syntax error: failed at position 1.");
    EXPECT_EQ(refused("Code: 62. DB::Exception: Syntax error. (SYNTAX_ERROR) (version 26.7.2.1 "
                      "(official build))\n"),
              "SERVER: Syntax error. (SYNTAX_ERROR).");
    EXPECT_EQ(
        refused("Code: 60, e.displayText() = DB::Exception: Table fleet.store doesn't exist., "
                "e.what() = DB::Exception"),
        "There is no store SERVER (see pallax store setup): Table fleet.store doesn't exist.");
    EXPECT_EQ(refused("Code: 279, e.displayText() = DB::NetException: All connection tries failed. "
                      "Log: \n\n"),
              "SERVER: a server of the cluster does not answer, and without it nothing is whole.");
}

TEST(ClickHouseTest, NonsenseIsTold) {
    EXPECT_EQ(sentence(FakeServer(answer("<html><body>Welcome!</body></html>"))),
              "SERVER does not answer as a server of ClickHouse: it ends too early.");
    EXPECT_EQ(sentence(FakeServer(answer("n\tm\nUInt8\tUInt8\n1\t2\n"))),
              "SERVER does not answer as a server of ClickHouse: it has other columns.");
    EXPECT_EQ(sentence(FakeServer(answer("not here", "404 Not Found"))),
              "SERVER is no server of ClickHouse: it answers with status 404.");
    EXPECT_EQ(sentence(FakeServer(answer("", "302 Found\r\nLocation: http://127.0.0.1:1/"))),
              "SERVER is no server of ClickHouse: it answers with status 302.");
    EXPECT_EQ(sentence(FakeServer("220 mail.example ESMTP\r\n")),
              "SERVER cannot be used: Unsupported protocol.");
    EXPECT_EQ(sentence(FakeServer(answer(std::string(100'000, 'x'), "500 Error"))),
              "SERVER is no server of ClickHouse: it answers with status 500.");
}

TEST(ClickHouseTest, AnAnswerThatBreaksOffIsNone) {
    const std::string whole = answer("n\nUInt8\n1\n2\n");
    EXPECT_EQ(sentence(FakeServer(whole.substr(0, whole.size() - 2))),
              "SERVER has broken the connection off.");
    EXPECT_EQ(sentence(FakeServer("")), "SERVER has broken the connection off.");
}

TEST(ClickHouseTest, AServerThatStallsIsLeft) {
    const std::string whole = answer("n\nUInt8\n1\n2\n");
    for (const std::size_t size : {std::size_t{0}, std::size_t{20}, whole.size() - 2}) {
        EXPECT_EQ(sentence(FakeServer(whole.substr(0, size), FakeServer::Then::Stalls)),
                  "SERVER has not answered for 0.1 s.");
    }
    Patience late = kImpatient;
    late.silence = std::chrono::minutes(1);
    late.whole = std::chrono::milliseconds(100);
    EXPECT_EQ(sentence(FakeServer("", FakeServer::Then::Stalls), late),
              "The query was stopped after its time (--timeout).");
}

TEST(ClickHouseTest, WhereNobodyListensNothingCanBeReached) {
    std::uint16_t port = 0;
    { port = FakeServer("").port(); }
    const StoreAddress address{"127.0.0.1", port, "fleet"};
    try {
        const ServerStore store(address, kImpatient);
        ADD_FAILURE();
    } catch (const StoreFailure& failure) {
        EXPECT_EQ(failure.what(), address.text() + " cannot be reached: no server answers there.");
    }
}

TEST(ClickHouseTest, AStoreOfALaterVersionIsRefused) {
    const auto refusal = [](const std::string& row) {
        const FakeServer server(answer("version\tcluster\tcopies\nUInt32\tString\tUInt32\n" + row));
        const StoreAddress address{"127.0.0.1", server.port(), "fleet"};
        try {
            const ServerStore store(address, kImpatient);
        } catch (const StoreFailure& failure) {
            return std::string(failure.what()).substr(address.text().size());
        }
        return std::string();
    };
    EXPECT_EQ(refusal("1\tfleet\t2\n"), "");
    EXPECT_EQ(refusal("2\tfleet\t2\n"),
              " is a store of a later version of Pallax: its tables have version 2, and this "
              "program knows version 1.");
    EXPECT_EQ(refusal("0\tfleet\t2\n"), " has other tables than a store.");
    EXPECT_EQ(refusal(""), " has other tables than a store.");
}

TEST(ClickHouseTest, WhatGivesRowsMayFail) {
    const FakeServer server(answer(""));
    ClickHouse house({"127.0.0.1", server.port(), "fleet"}, kImpatient);
    EXPECT_THROW(house.insert("t", []() -> std::string_view { throw std::logic_error("x"); }),
                 std::logic_error);
}

TEST(ClickHouseTest, TextsAreQuoted) {
    EXPECT_EQ(clickHouseText("it's \\ \n"), "'it\\'s \\\\ \n'");
    EXPECT_EQ(clickHouseText(std::string_view("a\0b", 3)), "'a\\0b'");
}

} // namespace
} // namespace pallax
