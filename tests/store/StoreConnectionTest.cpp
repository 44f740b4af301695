#include "store/StoreConnection.h"

#include "tests/doubles/Files.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <sqlite3.h>

namespace pallax {
namespace {

using doubles::contentOf;

class StoreConnectionTest : public testing::Test {
protected:
    std::string refusalOf(const std::string& path) const {
        try {
            (void)StoreConnection::open(path);
        } catch (const StoreFailure& failure) {
            return failure.what();
        }
        return "";
    }
    /// Runs statements on a file as another program would.
    static void run(const std::string& path, const char* sql) {
        sqlite3* connection = nullptr;
        ASSERT_EQ(sqlite3_open(path.c_str(), &connection), SQLITE_OK);
        EXPECT_EQ(sqlite3_exec(connection, sql, nullptr, nullptr, nullptr), SQLITE_OK)
            << sqlite3_errmsg(connection);
        sqlite3_close(connection);
    }
    /// That both ways to open it say so and leave the file as it is.
    void expectRefused(const std::string& path, const std::string& sentence) const {
        const std::string before = contentOf(path);
        EXPECT_EQ(refusalOf(path), sentence);
        EXPECT_EQ(StoreConnection::refusal(path), sentence);
        EXPECT_EQ(contentOf(path), before);
    }

    doubles::TemporaryFolder folder;
    std::string file = folder.path("store.db");
};

TEST_F(StoreConnectionTest, MakesAFileThatOnlyItsUserMayRead) {
    EXPECT_EQ(refusalOf(file), "");
    EXPECT_EQ(StoreConnection::refusal(file), std::nullopt);
    EXPECT_EQ(std::filesystem::status(file).permissions(),
              std::filesystem::perms::owner_read | std::filesystem::perms::owner_write);
    EXPECT_EQ(refusalOf(file), "") << "and opens it again";
}

TEST_F(StoreConnectionTest, TakesAnEmptyFile) {
    const std::string empty = folder.write("empty.db", "");
    EXPECT_EQ(refusalOf(empty), "");
    EXPECT_EQ(StoreConnection::refusal(empty), std::nullopt);
}

TEST_F(StoreConnectionTest, TheNameMayHoldAnything) {
    for (const char* name : {"it's \"a\" store;--", "two\nlines", "?mode=memory", "%41"}) {
        const std::string path = folder.path(name);
        EXPECT_EQ(refusalOf(path), "") << name;
        EXPECT_TRUE(std::filesystem::exists(path)) << name;
    }
}

TEST_F(StoreConnectionTest, RefusesAFileOfAnotherProgram) {
    run(file, "CREATE TABLE notes (text); INSERT INTO notes VALUES ('mine')");
    expectRefused(file, file + " is no store of measurements, but a file of another program.");
}

TEST_F(StoreConnectionTest, RefusesWhatIsNoFileOfSqlite) {
    const std::string text = folder.write("notes.txt", std::string(2000, 'x'));
    expectRefused(text, text + " is no file of SQLite.");
}

TEST_F(StoreConnectionTest, RefusesALaterVersion) {
    ASSERT_EQ(refusalOf(file), "");
    run(file, "PRAGMA user_version = 2");
    expectRefused(file, file + " is a store of a later version of Pallax: its tables have version "
                               "2, and this program knows version 1.");
}

TEST_F(StoreConnectionTest, RefusesOtherTables) {
    ASSERT_EQ(refusalOf(file), "");
    run(file, "CREATE TRIGGER mine AFTER INSERT ON events BEGIN DELETE FROM cells; END");
    expectRefused(file, file + " has other tables than a store.");
}

TEST_F(StoreConnectionTest, ThereIsNoStoreToAskBeforeOneIsMade) {
    EXPECT_EQ(StoreConnection::refusal(file),
              "There is no store " + file + " (see pallax store load).");
    EXPECT_FALSE(std::filesystem::exists(file));
}

TEST_F(StoreConnectionTest, ATransactionThatIsNotCommittedHasNoEffect) {
    const auto store = StoreConnection::open(file);
    {
        StoreConnection::Transaction transaction(*store);
        store->run("INSERT INTO texts (text) VALUES ('gone')");
    }
    {
        StoreConnection::Transaction transaction(*store);
        store->run("INSERT INTO texts (text) VALUES ('kept')");
        transaction.commit();
    }
    Statement texts = store->prepare("SELECT text FROM texts");
    ASSERT_TRUE(texts.step());
    EXPECT_EQ(texts.text(0), "kept");
    EXPECT_FALSE(texts.step());
}

TEST_F(StoreConnectionTest, AWaitForAnotherWriterIsTold) {
    const auto writer = StoreConnection::open(file);
    const auto store = StoreConnection::open(file);
    writer->run("BEGIN IMMEDIATE");
    int told = 0;
    store->setWaiting([&] {
        ++told;
        writer->run("COMMIT");
    });
    StoreConnection::Transaction transaction(*store);
    EXPECT_EQ(told, 1);
}

TEST_F(StoreConnectionTest, AFullDiskIsASentence) {
    const auto store = StoreConnection::open(file);
    store->run("PRAGMA max_page_count = 40");
    try {
        StoreConnection::Transaction transaction(*store);
        Statement add = store->prepare("INSERT INTO texts (text) VALUES (?)");
        for (int row = 0; row < 1000; ++row) {
            add.bind(1, std::string(1000, 'x')).run();
        }
        FAIL() << "there is no room";
    } catch (const StoreFailure& failure) {
        EXPECT_EQ(failure.what(), file + " cannot be written: the disk is full.");
    }
    EXPECT_FALSE(store->prepare("SELECT 1 FROM texts").step());
}

TEST(StoreConnectionToRead, ChangesNothingAndLeavesNothingBeside) {
    const doubles::TemporaryFolder folder;
    const std::string file = folder.path("s.db");
    { const auto made = StoreConnection::open(file); }
    {
        const auto store = StoreConnection::openToRead(file);
        EXPECT_FALSE(store->prepare("SELECT id FROM recordings").step());
        EXPECT_THROW(store->run("DELETE FROM recordings"), StoreFailure);
    }
    EXPECT_FALSE(std::filesystem::exists(file + "-wal"));
    EXPECT_THROW((void)StoreConnection::openToRead(folder.path("missing.db")), StoreFailure);
    EXPECT_FALSE(std::filesystem::exists(folder.path("missing.db")));
}

} // namespace
} // namespace pallax
