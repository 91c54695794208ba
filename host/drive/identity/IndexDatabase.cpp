// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/identity/IndexDatabase.h"

#include "platform/Log.h"

#include <sqlite3.h>
#include <unistd.h>

#include <cerrno>

namespace host::drive {

namespace {

constexpr int patience = 500; // milliseconds for which a writer waits for a writing process

// The versions of the file's format. This program did not write a file with any other number.
constexpr int incompleteVersion = 11;
constexpr int completeVersion = 12;

constexpr const char* tables =
    "BEGIN IMMEDIATE;"
    "CREATE TABLE documents (identifier INTEGER PRIMARY KEY, path BLOB, device INTEGER, inode INTEGER);"
    "CREATE INDEX places ON documents (path);"
    "PRAGMA user_version = 11;"
    "COMMIT";

} // namespace

void IndexDatabase::Close::operator()(sqlite3* database) const
{
    sqlite3_close(database);
}

void IndexDatabase::Finalize::operator()(sqlite3_stmt* statement) const
{
    sqlite3_finalize(statement);
}

IndexDatabase::Query::~Query()
{
    if (!_statement)
        return;
    sqlite3_reset(_statement);
    sqlite3_clear_bindings(_statement);
}

IndexDatabase::Query& IndexDatabase::Query::bind(int at, std::int64_t number)
{
    sqlite3_bind_int64(_statement, at, number);
    return *this;
}

IndexDatabase::Query& IndexDatabase::Query::bind(int at, const std::string& bytes)
{
    // Names are bytes and not necessarily text.
    sqlite3_bind_blob(_statement, at, bytes.data(), static_cast<int>(bytes.size()), SQLITE_STATIC);
    return *this;
}

int IndexDatabase::Query::step()
{
    return _statement ? sqlite3_step(_statement) : SQLITE_ERROR;
}

std::int64_t IndexDatabase::Query::number(int column) const
{
    return sqlite3_column_int64(_statement, column);
}

std::string IndexDatabase::Query::bytes(int column) const
{
    const void* bytes = sqlite3_column_blob(_statement, column);
    const auto size = static_cast<std::size_t>(sqlite3_column_bytes(_statement, column));
    return bytes ? std::string(static_cast<const char*>(bytes), size) : std::string();
}

bool IndexDatabase::Query::isNull(int column) const
{
    return sqlite3_column_type(_statement, column) == SQLITE_NULL;
}

IndexDatabase::State IndexDatabase::prepareFor(Use use)
{
    int isMoved = 0;
    if (_database) {
        sqlite3_file_control(_database.get(), "main", SQLITE_FCNTL_HAS_MOVED, &isMoved);
        sqlite3_busy_timeout(_database.get(), use == Use::Writing ? patience : 0);
    }
    // A damaged database counts as damaged until it is replaced, even if a part of it can be read.
    const bool isDamaged = _database && isMoved == 0 && _state == State::Damaged;
    const bool isUsable = _state == State::Complete || _state == State::Incomplete;
    if (!isDamaged && (!_database || isMoved != 0 || !isUsable))
        _state = open(use);
    if (use == Use::Writing && _state == State::Damaged) {
        discard();
        _state = open(use);
    }
    if (_state == State::Complete)
        _failure = {};
    return _state;
}

IndexDatabase::State IndexDatabase::open(Use use)
{
    close();
    sqlite3* opened = nullptr;
    const int create = use == Use::Writing ? SQLITE_OPEN_CREATE : 0;
    const int failure = sqlite3_open_v2(
        _path.c_str(), &opened, SQLITE_OPEN_READWRITE | SQLITE_OPEN_NOFOLLOW | create, nullptr);
    _database.reset(opened);
    if (failure != SQLITE_OK) {
        noteFailure(failure);
        close();
        return failure == SQLITE_CANTOPEN && ::access(_path.c_str(), F_OK) != 0 ? State::Missing
                                                                                : State::Unavailable;
    }
    sqlite3_extended_result_codes(opened, 1);
    sqlite3_busy_timeout(opened, use == Use::Writing ? patience : 0);
    // These settings make the library notice damage where it can.
    run("PRAGMA cell_size_check = ON; PRAGMA synchronous = NORMAL; PRAGMA trusted_schema = OFF");
    std::int64_t version = 0, count = 0;
    int code = SQLITE_OK;
    {
        auto query = this->query("PRAGMA user_version");
        if (code = query.step(); code == SQLITE_ROW)
            version = query.number(0);
    }
    if (code != SQLITE_ROW)
        return judge(code);
    if (version == incompleteVersion || version == completeVersion)
        return version == completeVersion ? State::Complete : State::Incomplete;
    {
        auto query = this->query("SELECT count(*) FROM sqlite_schema");
        if (code = query.step(); code == SQLITE_ROW)
            count = query.number(0);
    }
    if (code != SQLITE_ROW || version != 0 || count != 0)
        return code == SQLITE_ROW ? judge(SQLITE_NOTADB) : judge(code);
    return use == Use::Writing ? makeTables() : State::Missing;
}

IndexDatabase::State IndexDatabase::makeTables()
{
    run("PRAGMA journal_mode = WAL");
    if (run(tables))
        return State::Incomplete;
    // Another process may have created it meanwhile.
    const int code = sqlite3_extended_errcode(_database.get());
    run("ROLLBACK");
    auto query = this->query("PRAGMA user_version");
    return query.step() == SQLITE_ROW && query.number(0) != 0 ? State::Incomplete : judge(code);
}

IndexDatabase::State IndexDatabase::setComplete()
{
    if (_state == State::Incomplete && run("PRAGMA user_version = 12"))
        _state = State::Complete;
    return _state;
}

IndexDatabase::Query IndexDatabase::query(const char* text)
{
    auto& statement = _statements[text];
    if (!statement && _database) {
        sqlite3_stmt* prepared = nullptr;
        sqlite3_prepare_v3(_database.get(), text, -1, SQLITE_PREPARE_PERSISTENT, &prepared, nullptr);
        statement.reset(prepared);
    }
    return Query(statement.get());
}

int IndexDatabase::changes() const
{
    return sqlite3_changes(_database.get());
}

bool IndexDatabase::run(const char* text)
{
    const int code = sqlite3_exec(_database.get(), text, nullptr, nullptr, nullptr);
    if (code != SQLITE_OK)
        noteFailure(code);
    return code == SQLITE_OK;
}

void IndexDatabase::noteFailure(int code)
{
    const int number = _database ? sqlite3_system_errno(_database.get()) : 0;
    switch (code & 0xff) {
    case SQLITE_BUSY:
    case SQLITE_LOCKED:
        _failure = system::SystemError(EBUSY, _path);
        break;
    case SQLITE_FULL:
        _failure = system::SystemError(ENOSPC, _path);
        break;
    case SQLITE_READONLY: // the library opens what may not be written for reading, and keeps no number
        _failure = system::SystemError(::access(_path.c_str(), W_OK) == 0 ? EACCES : errno, _path);
        break;
    case SQLITE_IOERR:
    case SQLITE_CANTOPEN: // the library may have looked for a missing file since, so ENOENT tells nothing
        _failure = system::SystemError(number != 0 ? number : ENOENT, _path);
        break;
    default: // such as the end of a transaction that never began
        break;
    }
}

IndexDatabase::State IndexDatabase::judge(int code)
{
    static constexpr platform::Operation op{"-[IndexDatabase judge:]"};
    if (code == SQLITE_ROW || code == SQLITE_DONE || code == SQLITE_OK)
        return _state;
    // The connection knows why a statement could not be prepared.
    if (code == SQLITE_ERROR && _database)
        code = sqlite3_extended_errcode(_database.get());
    const int primary = code & 0xff;
    const bool isDamaged = primary == SQLITE_CORRUPT || primary == SQLITE_NOTADB || primary == SQLITE_ERROR
        || primary == SQLITE_FORMAT || primary == SQLITE_MISMATCH || code == SQLITE_IOERR_SHORT_READ;
    _state = isDamaged ? State::Damaged : State::Unavailable;
    noteFailure(code);
    op.error("Cannot use the index %@: %@", _path, std::string(sqlite3_errstr(code)));
    return _state;
}

void IndexDatabase::close()
{
    _statements.clear();
    _database.reset();
}

void IndexDatabase::discard()
{
    close();
    // The old file's write-ahead log must go as well, because it would be replayed into the new file.
    for (const char* suffix : {"-wal", "-shm", ""})
        ::unlink((_path + suffix).c_str());
}

} // namespace host::drive
