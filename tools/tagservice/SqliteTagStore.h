#pragma once

#include <string>

#include "MemoryTagStore.h"
#include "SqliteDatabase.h"

namespace Korvane::Veldra::TagService {

// Tags in an SQLite file, one row a tag, with a copy in memory for reads.
// Each batch is one transaction, committed with a full sync before Apply
// returns; the copy in memory changes only after the commit.
class SqliteTagStore : public TagStore {
public:
    // Opens or creates the file and reads every tag; throws StoreError when
    // the file cannot be used or holds a row that does not read.
    explicit SqliteTagStore(const std::string& file);

    const StoredTag* Find(const std::string& path) const override;
    void ForEach(const std::function<void(const StoredTag&)>& visit) const override;
    void Apply(const StoreBatch& batch) override;

private:
    void Load();

    SqliteDatabase db_;
    SqliteStatement put_;
    SqliteStatement erase_;
    MemoryTagStore cache_;
};

}  // namespace Korvane::Veldra::TagService
