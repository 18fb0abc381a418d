// SQLite's databases: connections, statements and transactions.
//
// Operations throw SqliteError, which does not leave the store: sqliteResult() turns it into a Result.
#pragma once

#include <sqlite3.h>

#include <cstdint>
#include <filesystem>
#include <memory>
#include <stdexcept>
#include <string>
#include <string_view>

#include "Foundation/Result.h"

namespace plume {

// what() is the sentence for the user.
class SqliteError : public std::runtime_error {
  public:
    SqliteError(const std::filesystem::path& file, sqlite3* database);
    SqliteError(const std::filesystem::path& file, int code, const std::string& reason);

    // The file is no database, or not a whole one.
    bool isDamage() const { return code_ == SQLITE_CORRUPT || code_ == SQLITE_NOTADB; }

  private:
    int code_;
};

// One thread at a time.
class SqliteConnection {
  public:
    // An existing database. Waits at most so long for what others have locked.
    SqliteConnection(std::filesystem::path file, double busySeconds);

    void run(const char* sql);
    std::int64_t integer(const char* sql);
    // What is in the file stays as it is when the connection ends.
    void leaveAsItIs() const;

    // Gives the memory back that pages of the file are kept in: a library is read once, and written seldom.
    void freePages() const { sqlite3_db_release_memory(handle()); }

    const std::filesystem::path& file() const { return file_; }
    sqlite3* handle() const { return database_.get(); }

  private:
    struct Closer {
        void operator()(sqlite3* database) const { sqlite3_close_v2(database); }
    };
    std::filesystem::path file_;
    std::unique_ptr<sqlite3, Closer> database_;
};

// Parameters are numbered from 1, columns from 0.
class SqliteStatement {
  public:
    // The connection outlives it.
    SqliteStatement(const SqliteConnection& connection, const char* sql);

    // The text and the bytes stay where they are until the statement goes.
    SqliteStatement& bind(int parameter, std::int64_t value);
    SqliteStatement& bindText(int parameter, std::string_view text);
    SqliteStatement& bindBytes(int parameter, std::string_view bytes);
    // False when there are no more rows.
    bool step();
    std::int64_t integer(int column) const { return sqlite3_column_int64(statement_.get(), column); }
    std::string bytes(int column) const;

  private:
    struct Finalizer {
        void operator()(sqlite3_stmt* statement) const { sqlite3_finalize(statement); }
    };
    void require(int code) const;

    const SqliteConnection& connection_;
    std::unique_ptr<sqlite3_stmt, Finalizer> statement_;
};

template <typename Operation>
auto sqliteResult(Operation operation) -> Result<decltype(operation())> {
    try {
        if constexpr (std::is_void_v<decltype(operation())>) {
            operation();
            return {};
        } else {
            return operation();
        }
    } catch (const SqliteError& error) {
        return Error{error.what()};
    }
}

}  // namespace plume
