#include "ports/posix/store/SqliteConnection.h"

#include <utility>

namespace plume {

namespace {

constexpr int PrimaryCode = 0xFF;  // what is above says more, to nobody here

std::string explanation(int code, sqlite3* database) {
    switch (code) {
        case SQLITE_BUSY:
        case SQLITE_LOCKED:
            return "another program keeps it locked";
        case SQLITE_READONLY:
        case SQLITE_CANTOPEN:
            return "it, or the folder that it is in, cannot be written to";
        default:
            return sqlite3_errmsg(database);
    }
}

}  // namespace

SqliteError::SqliteError(const std::filesystem::path& file, int code, const std::string& reason)
    : std::runtime_error(file.string() + " cannot be used: " + reason), code_(code) {}

SqliteError::SqliteError(const std::filesystem::path& file, sqlite3* database)
    : SqliteError(file, sqlite3_errcode(database) & PrimaryCode,
                  explanation(sqlite3_errcode(database) & PrimaryCode, database)) {}

SqliteConnection::SqliteConnection(std::filesystem::path file, double busySeconds) : file_(std::move(file)) {
    sqlite3* opened = nullptr;
    const int code = sqlite3_open_v2(file_.c_str(), &opened, SQLITE_OPEN_READWRITE | SQLITE_OPEN_FULLMUTEX, nullptr);
    database_.reset(opened);
    if (code != SQLITE_OK) throw SqliteError(file_, opened);
    constexpr double Milliseconds = 1000;
    sqlite3_busy_timeout(opened, static_cast<int>(busySeconds * Milliseconds));
    // The file may come from anybody.
    sqlite3_db_config(opened, SQLITE_DBCONFIG_DEFENSIVE, 1, nullptr);
    run("PRAGMA trusted_schema = OFF");
    run("PRAGMA cell_size_check = ON");
}

void SqliteConnection::run(const char* sql) {
    if (sqlite3_exec(handle(), sql, nullptr, nullptr, nullptr) != SQLITE_OK) throw SqliteError(file_, handle());
}

std::int64_t SqliteConnection::integer(const char* sql) {
    SqliteStatement statement(*this, sql);
    return statement.step() ? statement.integer(0) : 0;
}

void SqliteConnection::leaveAsItIs() const {
    sqlite3_db_config(handle(), SQLITE_DBCONFIG_NO_CKPT_ON_CLOSE, 1, nullptr);
}

SqliteStatement::SqliteStatement(const SqliteConnection& connection, const char* sql) : connection_(connection) {
    sqlite3_stmt* prepared = nullptr;
    const int code = sqlite3_prepare_v2(connection.handle(), sql, -1, &prepared, nullptr);
    statement_.reset(prepared);
    require(code);
}

void SqliteStatement::require(int code) const {
    if (code != SQLITE_OK) throw SqliteError(connection_.file(), connection_.handle());
}

SqliteStatement& SqliteStatement::bind(int parameter, std::int64_t value) {
    require(sqlite3_bind_int64(statement_.get(), parameter, value));
    return *this;
}

SqliteStatement& SqliteStatement::bindText(int parameter, std::string_view text) {
    require(sqlite3_bind_text64(statement_.get(), parameter, text.data(), text.size(), SQLITE_STATIC, SQLITE_UTF8));
    return *this;
}

SqliteStatement& SqliteStatement::bindBytes(int parameter, std::string_view bytes) {
    // Without a place, no bytes would be bound as nothing at all.
    const char* place = bytes.empty() ? "" : bytes.data();
    require(sqlite3_bind_blob64(statement_.get(), parameter, place, bytes.size(), SQLITE_STATIC));
    return *this;
}

bool SqliteStatement::step() {
    const int code = sqlite3_step(statement_.get());
    if (code != SQLITE_ROW && code != SQLITE_DONE) throw SqliteError(connection_.file(), connection_.handle());
    return code == SQLITE_ROW;
}

std::string SqliteStatement::bytes(int column) const {
    const void* place = sqlite3_column_blob(statement_.get(), column);
    const int size = sqlite3_column_bytes(statement_.get(), column);
    return place ? std::string(static_cast<const char*>(place), static_cast<std::size_t>(size)) : std::string();
}

}  // namespace plume
