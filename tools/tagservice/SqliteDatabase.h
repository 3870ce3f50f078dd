#pragma once

#include <sqlite3.h>

#include <memory>
#include <stdexcept>
#include <string>

namespace Korvane::Veldra::TagService {

// A failure of the store on disk, with SQLite's own text.
class StoreError : public std::runtime_error {
public:
    using std::runtime_error::runtime_error;
};

// One prepared statement; reset before each use.
class SqliteStatement {
public:
    SqliteStatement(sqlite3* db, const char* sql);
    SqliteStatement& Bind(int index, const std::string& text);
    // SQLITE_ROW or SQLITE_DONE; anything else throws StoreError.
    int Step();
    std::string ColumnText(int index) const;
    void Reset();

private:
    sqlite3* db_;
    std::unique_ptr<sqlite3_stmt, int (*)(sqlite3_stmt*)> statement_;
};

// An open database file, closed on destruction.
class SqliteDatabase {
public:
    // Opens or creates the file; throws StoreError with the reason.
    explicit SqliteDatabase(const std::string& file);
    // Runs statements without results; throws StoreError.
    void Execute(const char* sql);
    sqlite3* Handle() const { return db_.get(); }

private:
    std::unique_ptr<sqlite3, int (*)(sqlite3*)> db_;
};

}  // namespace Korvane::Veldra::TagService
