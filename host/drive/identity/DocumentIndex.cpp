// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/identity/DocumentIndex.h"

#include <sqlite3.h>

#include <cerrno>
#include <random>
#include <span>

namespace host::drive {

using Use = IndexDatabase::Use;

namespace {

/// So many documents are noted in one transaction; other processes may read and write in between.
constexpr std::size_t batch = 500;

/// The bounds of the paths below a folder in the order of their bytes; `end` is behind the last one.
struct PathsBelow {
    explicit PathsBelow(const std::string& folder)
        : first(folder + '/')
        , end(folder + static_cast<char>('/' + 1))
    {
    }
    std::string first, end;
};

} // namespace

bool DocumentIndex::isReadyFor(Use use) const
{
    const auto state = _database.prepareFor(use);
    return state == State::Incomplete || state == State::Complete;
}

DocumentIndex::State DocumentIndex::state() const
{
    const std::lock_guard lock(_mutex);
    return _database.prepareFor(Use::Reading);
}

DocumentIndex::State DocumentIndex::prepareForWriting()
{
    const std::lock_guard lock(_mutex);
    return _database.prepareFor(Use::Writing);
}

system::SystemError DocumentIndex::failure() const
{
    const std::lock_guard lock(_mutex);
    const auto& failure = _database.failure();
    return (failure ? failure : system::SystemError(EBUSY)).ofDrive();
}

DocumentIndex::Answer DocumentIndex::lookUp(std::uint32_t identifier, Use use) const
{
    const std::lock_guard lock(_mutex);
    const auto state = _database.prepareFor(use);
    if (state == State::Missing)
        return {Answer::Kind::Unknown, {}};
    if (state != State::Incomplete && state != State::Complete)
        return {};
    auto query = _database.query("SELECT path, device, inode FROM documents WHERE identifier = ?");
    const int code = query.bind(1, identifier).step();
    if (code == SQLITE_DONE)
        return {Answer::Kind::Unknown, {}};
    if (code != SQLITE_ROW) {
        _database.judge(code);
        return {};
    }
    if (query.isNull(0))
        return {Answer::Kind::Removed, {}};
    return {Answer::Kind::Known,
        {query.bytes(0), static_cast<std::uint64_t>(query.number(1)),
            static_cast<std::uint64_t>(query.number(2))}};
}

std::vector<IdentifiedPlace> DocumentIndex::documentsWithin(const std::string& path) const
{
    const std::lock_guard lock(_mutex);
    if (!isReadyFor(Use::Reading))
        return {};
    const PathsBelow below(path);
    auto query = _database.query("SELECT identifier, path, device, inode FROM documents"
                                 " WHERE path = ?1 OR (path >= ?2 AND path < ?3)");
    query.bind(1, path).bind(2, below.first).bind(3, below.end);
    std::vector<IdentifiedPlace> found;
    int code = query.step();
    for (; code == SQLITE_ROW; code = query.step())
        found.push_back({static_cast<std::uint32_t>(query.number(0)),
            {query.bytes(1), static_cast<std::uint64_t>(query.number(2)),
                static_cast<std::uint64_t>(query.number(3))}});
    _database.judge(code);
    return found;
}

bool DocumentIndex::note(std::uint32_t identifier, const DocumentPlace& place)
{
    const std::lock_guard lock(_mutex);
    return isReadyFor(Use::Writing) && write(identifier, place);
}

bool DocumentIndex::write(std::uint32_t identifier, const DocumentPlace& place)
{
    auto query = _database.query("INSERT INTO documents VALUES (?1, ?2, ?3, ?4) ON CONFLICT (identifier)"
                                 " DO UPDATE SET path = ?2, device = ?3, inode = ?4 WHERE path IS NOT NULL");
    query.bind(1, identifier).bind(2, place.path);
    query.bind(3, static_cast<std::int64_t>(place.device)).bind(4, static_cast<std::int64_t>(place.inode));
    const int code = query.step();
    _database.judge(code);
    return code == SQLITE_DONE;
}

std::optional<std::uint32_t> DocumentIndex::reserve(const DocumentPlace& place)
{
    const std::lock_guard lock(_mutex);
    if (!isReadyFor(Use::Writing))
        return std::nullopt;
    // Identifiers are drawn at random and not in turn, so that a lost index rarely gives one of its
    // identifiers again.
    std::random_device random;
    std::uniform_int_distribution<std::uint32_t> anyIdentifier(1);
    for (int tries = 0; tries < 32; ++tries) {
        const auto identifier = anyIdentifier(random);
        auto query = _database.query("INSERT INTO documents VALUES (?1, ?2, ?3, ?4) ON CONFLICT DO NOTHING");
        query.bind(1, identifier).bind(2, place.path);
        query.bind(3, static_cast<std::int64_t>(place.device));
        query.bind(4, static_cast<std::int64_t>(place.inode));
        if (const int code = query.step(); code != SQLITE_DONE) {
            _database.judge(code);
            return std::nullopt;
        }
        if (_database.changes() == 1)
            return identifier;
    }
    return std::nullopt;
}

void DocumentIndex::release(std::uint32_t identifier)
{
    const std::lock_guard lock(_mutex);
    if (isReadyFor(Use::Writing))
        _database.judge(
            _database.query("DELETE FROM documents WHERE identifier = ?").bind(1, identifier).step());
}

void DocumentIndex::noteMove(const std::string& from, const std::string& to)
{
    const std::lock_guard lock(_mutex);
    // A missing index needs no change.
    if (_database.prepareFor(Use::Reading) == State::Missing || !isReadyFor(Use::Writing))
        return;
    const PathsBelow below(from);
    auto query = _database.query("UPDATE documents SET path = CAST(?4 || substr(path, ?5) AS BLOB)"
                                 " WHERE path = ?1 OR (path >= ?2 AND path < ?3)");
    query.bind(1, from).bind(2, below.first).bind(3, below.end);
    query.bind(4, to).bind(5, static_cast<std::int64_t>(from.size()) + 1);
    _database.judge(query.step());
}

void DocumentIndex::noteRemoval(std::uint32_t identifier)
{
    const std::lock_guard lock(_mutex);
    if (isReadyFor(Use::Writing))
        _database.judge(_database.query("UPDATE documents SET path = NULL, inode = 0 WHERE identifier = ?")
                            .bind(1, identifier)
                            .step());
}

bool DocumentIndex::complete(const std::vector<IdentifiedPlace>& all)
{
    for (std::span<const IdentifiedPlace> rest(all); !rest.empty();
         rest = rest.subspan(std::min(batch, rest.size()))) {
        const std::lock_guard lock(_mutex);
        if (!isReadyFor(Use::Writing) || !_database.run("BEGIN IMMEDIATE"))
            return false;
        for (const auto& document : rest.first(std::min(batch, rest.size()))) {
            if (!write(document.identifier, document.place)) {
                _database.run("ROLLBACK");
                return false;
            }
        }
        if (!_database.run("COMMIT")) {
            _database.run("ROLLBACK");
            return false;
        }
    }
    const std::lock_guard lock(_mutex);
    return isReadyFor(Use::Writing) && _database.setComplete() == State::Complete;
}

} // namespace host::drive
