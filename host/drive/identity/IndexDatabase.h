// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/files/SystemError.h"

#include <cstdint>
#include <map>
#include <memory>
#include <string>

struct sqlite3;
struct sqlite3_stmt;

namespace host::drive {

/// A connection to the database file of the document index, for one thread at a time. Other processes may
/// remove or replace the file meanwhile; the next use then opens the file that exists.
///
/// The database keeps a write-ahead log. A reader then never waits for a writer, which matters on the main
/// thread; a writer that is killed leaves nothing half done; and a commit needs no sync (a power cut costs
/// the last changes, which are found again when those documents are next read). A damaged database is
/// discarded, and the index is made anew from a walk through the drive; while another process keeps it
/// locked, that walk answers.
class IndexDatabase {
public:
    enum class Use : std::uint8_t { Reading, Writing };
    enum class State : std::uint8_t {
        Missing, ///< there is no file, or an empty one
        Incomplete, ///< documents with an identifier may be missing from it
        Complete,
        Damaged, ///< must be discarded
        Unavailable, ///< locked by another process, or not accessible
    };

    explicit IndexDatabase(std::string path)
        : _path(std::move(path))
    {
    }

    /// Opens the database if needed. For writing, a missing one is created and a damaged one is replaced by
    /// an empty one. Answers Incomplete or Complete when the database can be used. Reading never waits for
    /// another process.
    State prepareFor(Use use);
    State setComplete();

    /// A statement for one use. The destructor resets it, and it stays prepared for the next use.
    class Query {
    public:
        explicit Query(sqlite3_stmt* statement)
            : _statement(statement)
        {
        }
        Query(const Query&) = delete;
        Query& operator=(const Query&) = delete;
        ~Query();

        Query& bind(int at, std::int64_t number);
        /// The bytes must live as long as the query.
        Query& bind(int at, const std::string& bytes);
        /// Runs one step and answers sqlite's code.
        int step();
        std::int64_t number(int column) const;
        std::string bytes(int column) const;
        bool isNull(int column) const;

    private:
        sqlite3_stmt* _statement;
    };
    /// `text` must be a literal, because its address is the key of the prepared statement.
    Query query(const char* text);
    int changes() const;
    /// Runs statements without parameters and answers whether they succeeded.
    bool run(const char* text);

    /// Answers why the database could not be used or changed last; none once it is complete and usable.
    /// Another process that keeps it locked is EBUSY.
    const system::SystemError& failure() const { return _failure; }

    /// Answers the database's state after a query ended with a code. Damage is logged.
    State judge(int code);

private:
    struct Close {
        void operator()(sqlite3* database) const;
    };
    struct Finalize {
        void operator()(sqlite3_stmt* statement) const;
    };
    State open(Use use);
    State makeTables();
    void close();
    void discard();
    void noteFailure(int code);

    std::string _path;
    std::unique_ptr<sqlite3, Close> _database;
    std::map<const char*, std::unique_ptr<sqlite3_stmt, Finalize>>
        _statements; // destroyed before the database
    State _state = State::Missing;
    system::SystemError _failure;
};

} // namespace host::drive
