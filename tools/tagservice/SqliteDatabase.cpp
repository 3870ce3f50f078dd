#include "SqliteDatabase.h"

namespace Korvane::Veldra::TagService {

namespace {

[[noreturn]] void Fail(sqlite3* db, const std::string& what) {
    throw StoreError(what + ": " + (db != nullptr ? sqlite3_errmsg(db) : "out of memory"));
}

}  // namespace

SqliteStatement::SqliteStatement(sqlite3* db, const char* sql)
    : db_(db), statement_(nullptr, sqlite3_finalize) {
    sqlite3_stmt* raw = nullptr;
    if (sqlite3_prepare_v2(db, sql, -1, &raw, nullptr) != SQLITE_OK) {
        sqlite3_finalize(raw);
        Fail(db, std::string("cannot prepare \"") + sql + "\"");
    }
    statement_.reset(raw);
}

SqliteStatement& SqliteStatement::Bind(int index, const std::string& text) {
    if (sqlite3_bind_text(statement_.get(), index, text.data(), static_cast<int>(text.size()),
                          SQLITE_TRANSIENT) != SQLITE_OK) {
        Fail(db_, "cannot bind a value");
    }
    return *this;
}

int SqliteStatement::Step() {
    const int result = sqlite3_step(statement_.get());
    if (result != SQLITE_ROW && result != SQLITE_DONE) Fail(db_, "statement failed");
    return result;
}

std::string SqliteStatement::ColumnText(int index) const {
    const auto* text = sqlite3_column_text(statement_.get(), index);
    const int size = sqlite3_column_bytes(statement_.get(), index);
    return text == nullptr ? std::string() : std::string(reinterpret_cast<const char*>(text),
                                                         static_cast<std::size_t>(size));
}

void SqliteStatement::Reset() {
    sqlite3_reset(statement_.get());
    sqlite3_clear_bindings(statement_.get());
}

SqliteDatabase::SqliteDatabase(const std::string& file) : db_(nullptr, sqlite3_close) {
    sqlite3* raw = nullptr;
    const int result = sqlite3_open_v2(file.c_str(), &raw,
                                       SQLITE_OPEN_READWRITE | SQLITE_OPEN_CREATE |
                                           SQLITE_OPEN_NOMUTEX, nullptr);
    db_.reset(raw);
    if (result != SQLITE_OK) Fail(raw, "cannot open " + file);
    sqlite3_busy_timeout(raw, 1000);
}

void SqliteDatabase::Execute(const char* sql) {
    char* message = nullptr;
    if (sqlite3_exec(db_.get(), sql, nullptr, nullptr, &message) != SQLITE_OK) {
        const std::string text = message != nullptr ? message : "unknown error";
        sqlite3_free(message);
        throw StoreError(std::string("\"") + sql + "\" failed: " + text);
    }
}

}  // namespace Korvane::Veldra::TagService
