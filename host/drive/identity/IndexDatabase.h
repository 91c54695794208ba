// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <cstdint>
#include <map>
#include <memory>
#include <string>

struct sqlite3;
struct sqlite3_stmt;

namespace host::drive {

/// A connection to the database file of the document index; one thread at a time. The file may be removed or
/// replaced by others meanwhile: the next use then opens the one that is there.
///
/// The database keeps a write-ahead log: a reader never waits for a writer, which matters on the main thread,
/// a writer that is killed leaves nothing half done, and a commit needs no sync (a power cut costs the last
/// changes, which the next look at those documents makes up for). A damaged database is discarded, and the
/// index is made anew from a walk through the drive; while another process keeps it locked, that walk
/// answers.
class IndexDatabase {
public:
    enum class Use : std::uint8_t { Reading, Writing };
    enum class State : std::uint8_t {
        Missing, ///< there is none, or an empty file
        Incomplete, ///< documents with an identifier may be missing from it
        Complete,
        Damaged, ///< must be discarded
        Unavailable, ///< locked by another process, or not accessible
    };

    explicit IndexDatabase(std::string path)
        : _path(std::move(path))
    {
    }

    /// Opens the database where that is needed; for writing a missing one is made and a damaged one replaced
    /// by an empty one. Answers Incomplete or Complete when it can be used. Reading waits for nobody.
    State prepareFor(Use use);
    State setComplete();

    /// A statement that is used once: reset at the end, kept prepared for the next time.
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
        /// One step; sqlite's code.
        int step();
        std::int64_t number(int column) const;
        std::string bytes(int column) const;
        bool isNull(int column) const;

    private:
        sqlite3_stmt* _statement;
    };
    /// `text` must be a literal.
    Query query(const char* text);
    int changes() const;
    /// Runs statements without parameters; whether they succeeded.
    bool run(const char* text);

    /// What a code that ended a query says of the database; a damaged one is noted in the log.
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

    std::string _path;
    std::unique_ptr<sqlite3, Close> _database;
    std::map<const char*, std::unique_ptr<sqlite3_stmt, Finalize>> _statements; // end before the database
    State _state = State::Missing;
};

} // namespace host::drive
