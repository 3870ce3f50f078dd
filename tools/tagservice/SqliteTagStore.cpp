#include "SqliteTagStore.h"

#include "StoredTagJson.h"

namespace Korvane::Veldra::TagService {

namespace {

SqliteDatabase& Prepared(SqliteDatabase& db) {
    // One service a file: the first write lock is kept until the file is
    // closed, and taken here, so that a second service on the file fails at
    // its start instead of serving tags that the first one changes.
    db.Execute("PRAGMA locking_mode=EXCLUSIVE");
    db.Execute("PRAGMA journal_mode=WAL");
    db.Execute("PRAGMA synchronous=FULL");
    db.Execute("BEGIN EXCLUSIVE");
    db.Execute("CREATE TABLE IF NOT EXISTS tags (path TEXT PRIMARY KEY NOT NULL, body TEXT NOT NULL)");
    db.Execute("COMMIT");
    return db;
}

}  // namespace

SqliteTagStore::SqliteTagStore(const std::string& file)
    : db_(file),
      put_(Prepared(db_).Handle(), "INSERT OR REPLACE INTO tags (path, body) VALUES (?1, ?2)"),
      erase_(db_.Handle(), "DELETE FROM tags WHERE path = ?1") {
    Load();
}

void SqliteTagStore::Load() {
    SqliteStatement select(db_.Handle(), "SELECT path, body FROM tags");
    StoreBatch all;
    while (select.Step() == SQLITE_ROW) {
        const std::string path = select.ColumnText(0);
        try {
            all.put.push_back(StoredTagFromJson(select.ColumnText(1)));
        } catch (const std::exception& error) {
            throw StoreError("the stored tag '" + path + "' does not read: " + error.what());
        }
        if (all.put.back().Path() != path) {
            throw StoreError("the stored tag '" + path + "' holds another path");
        }
    }
    cache_.Apply(all);
}

const StoredTag* SqliteTagStore::Find(const std::string& path) const {
    return cache_.Find(path);
}

void SqliteTagStore::ForEach(const std::function<void(const StoredTag&)>& visit) const {
    cache_.ForEach(visit);
}

void SqliteTagStore::Apply(const StoreBatch& batch) {
    if (batch.Empty()) return;
    db_.Execute("BEGIN IMMEDIATE");
    try {
        for (const std::string& path : batch.erase) {
            erase_.Reset();
            erase_.Bind(1, path).Step();
        }
        for (const StoredTag& tag : batch.put) {
            put_.Reset();
            put_.Bind(1, tag.Path()).Bind(2, StoredTagToJson(tag)).Step();
        }
        put_.Reset();
        erase_.Reset();
        db_.Execute("COMMIT");
    } catch (...) {
        put_.Reset();
        erase_.Reset();
        sqlite3_exec(db_.Handle(), "ROLLBACK", nullptr, nullptr, nullptr);
        throw;
    }
    cache_.Apply(batch);
}

}  // namespace Korvane::Veldra::TagService
