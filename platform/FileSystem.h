#pragma once

#include "platform/Attributes.h"
#include "platform/Error.h"

#include <functional>
#include <optional>
#include <string>

namespace platform {

enum class FileType { Regular, Directory, SymbolicLink, Other };

/// What the file system itself says of a path; a symbolic link is not followed.
struct FileAttributes {
    FileType type = FileType::Other;
    std::uint64_t size = 0; ///< bytes
    std::optional<Date> creationDate; ///< nothing where the file system keeps none
    Date modificationDate;
    bool extensionHidden = false;
};

/// The plain file system, without promises and without coordination. Any thread; every call is synchronous.
class FileSystem {
public:
    virtual ~FileSystem() = default;

    virtual Result<FileAttributes> attributesOfItem(const std::string& path) const = 0;
    virtual Result<std::string> destinationOfSymbolicLink(const std::string& path) const = 0;
    /// Whether something is at the path, links followed, and what: nothing there answers no value.
    virtual std::optional<FileType> typeOfItem(const std::string& path) const = 0;

    /// The user's own documents folder, outside the drive; nothing when none is set up.
    virtual std::optional<Url> userDocumentsFolder() const = 0;

    /// How an enumeration goes on after an entry or an error.
    enum class Continue { Yes, No };
    /// Calls `entry` for everything below a folder, at all levels, hidden files and packages' contents
    /// included, links reported but not followed. `error` hears of each folder that cannot be read.
    virtual void enumerateDeeply(const Url& folder,
        const std::function<Continue(const Url&, FileType)>& entry,
        const std::function<Continue(const Url&, const Error&)>& error) const = 0;
    /// The same for what lies directly in a folder, hidden files included.
    virtual void enumerateShallowly(const Url& folder,
        const std::function<Continue(const Url&, FileType)>& entry,
        const std::function<Continue(const Url&, const Error&)>& error) const = 0;
};

} // namespace platform
