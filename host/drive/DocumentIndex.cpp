#include "host/drive/DocumentIndex.h"

#include "platform/Log.h"

#include <sqlite3.h>

namespace host::drive {

namespace {

struct Finalize {
    void operator()(sqlite3_stmt* statement) const { sqlite3_finalize(statement); }
};
using Statement = std::unique_ptr<sqlite3_stmt, Finalize>;

constexpr int patience = 1000; // milliseconds to wait for another process that writes

Statement prepare(sqlite3* database, const char* text)
{
    sqlite3_stmt* statement = nullptr;
    sqlite3_prepare_v2(database, text, -1, &statement, nullptr);
    return Statement(statement);
}

} // namespace

void DocumentIndex::Close::operator()(sqlite3* database) const
{
    sqlite3_close(database);
}

sqlite3* DocumentIndex::open(int flags) const
{
    sqlite3* opened = nullptr;
    const int failure = sqlite3_open_v2(_path.c_str(), &opened, flags, nullptr);
    _database.reset(opened);
    if (failure != SQLITE_OK) {
        _database.reset();
        return nullptr;
    }
    sqlite3_busy_timeout(opened, patience);
    return opened;
}

std::optional<std::string> DocumentIndex::pathOf(std::uint32_t identifier) const
{
    static constexpr platform::Operation op{"-[DocumentIndex pathOf:]"};
    const std::lock_guard lock(_mutex);
    sqlite3* database = _database ? _database.get() : open(SQLITE_OPEN_READONLY);
    if (!database)
        return std::nullopt;
    const auto query = prepare(database, "SELECT path FROM documents WHERE identifier = ?");
    if (!query) {
        op.error("Cannot read the index %@: %@", _path, std::string(sqlite3_errmsg(database)));
        _database.reset();
        return std::nullopt;
    }
    sqlite3_bind_int64(query.get(), 1, identifier);
    if (sqlite3_step(query.get()) != SQLITE_ROW)
        return std::nullopt;
    const void* path = sqlite3_column_blob(query.get(), 0);
    const auto length = static_cast<std::size_t>(sqlite3_column_bytes(query.get(), 0));
    return path ? std::optional(std::string(static_cast<const char*>(path), length)) : std::nullopt;
}

bool DocumentIndex::note(std::uint32_t identifier, const std::string& path)
{
    const std::lock_guard lock(_mutex);
    sqlite3* database = open(SQLITE_OPEN_READWRITE | SQLITE_OPEN_CREATE);
    if (!database)
        return false;
    sqlite3_exec(database,
        "CREATE TABLE IF NOT EXISTS documents (identifier INTEGER PRIMARY KEY, path BLOB NOT NULL)", nullptr,
        nullptr, nullptr);
    const auto insert = prepare(database, "INSERT OR REPLACE INTO documents VALUES (?, ?)");
    if (!insert)
        return false;
    sqlite3_bind_int64(insert.get(), 1, identifier);
    // Names are bytes, not necessarily text.
    sqlite3_bind_blob(insert.get(), 2, path.data(), static_cast<int>(path.size()), SQLITE_STATIC);
    return sqlite3_step(insert.get()) == SQLITE_DONE;
}

} // namespace host::drive
