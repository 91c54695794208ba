#pragma once

#include <cstdint>
#include <memory>
#include <mutex>
#include <optional>
#include <string>

struct sqlite3;

namespace host::drive {

/// Where documents with an identifier were last seen. It is a hint only: who asks must look whether the
/// document still carries the identifier. Any thread.
class DocumentIndex {
public:
    /// Nothing is opened before it is needed.
    explicit DocumentIndex(std::string path)
        : _path(std::move(path))
    {
    }

    /// The path below the drive's home; nothing when the index has none, is missing or cannot be read.
    std::optional<std::string> pathOf(std::uint32_t identifier) const;
    /// Notes where a document is, making the index when there is none; whether it was noted.
    bool note(std::uint32_t identifier, const std::string& path);

private:
    struct Close {
        void operator()(sqlite3* database) const;
    };
    sqlite3* open(int flags) const;

    std::string _path;
    mutable std::mutex _mutex;
    mutable std::unique_ptr<sqlite3, Close> _database;
};

} // namespace host::drive
