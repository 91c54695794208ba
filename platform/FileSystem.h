// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Attributes.h"
#include "platform/Error.h"

#include <cstdint>
#include <functional>
#include <optional>
#include <string>

namespace platform {

/// What kind of thing a name of the file system stands for. Other is a pipe, a socket or a device.
enum class FileType { Regular, Directory, SymbolicLink, Other };

/// What the file system itself says of a path; a symbolic link is not followed.
struct FileAttributes {
    FileType type = FileType::Other;
    std::uint64_t size = 0; ///< bytes; without meaning for a folder
    std::optional<Date> creationDate; ///< nothing where the file system keeps none
    Date modificationDate; ///< when the content was changed last
    bool extensionHidden = false; ///< the person does not want to see the name's extension
};

/// The questions to the file system, without coordination: who needs others kept out asks inside an accessor
/// of the FileCoordinator. They know nothing of promises; FileChanges changes what they tell of. Paths are
/// absolute, and are bytes as the system has them; one that holds a NUL is refused. Any thread may ask; every
/// call is synchronous and waits for the disk. Unless a comment says otherwise errors are the system's:
/// FileErrorCode::NoSuchItem and InvalidName where they fit, else the errno. Each has a sentence for the
/// user.
class FileSystem {
public:
    virtual ~FileSystem() = default;

    /// Answers what the file system says of a path.
    virtual Result<FileAttributes> attributesOfItem(const std::string& path) const = 0;
    /// Answers the text of a symbolic link, which may be relative and may lead nowhere. Errors: EINVAL for
    /// what is no link.
    virtual Result<std::string> destinationOfSymbolicLink(const std::string& path) const = 0;
    /// Answers what is at a path, links followed. It answers nothing when nothing is there, and when that
    /// cannot be told.
    virtual std::optional<FileType> typeOfItem(const std::string& path) const = 0;

    /// Answers the user's own documents folder, which lies outside the drive; nothing when none is set up.
    virtual std::optional<Url> userDocumentsFolder() const = 0;

    /// Whether an enumeration goes on after an entry or an error.
    enum class Continue { Yes, No };
    /// Calls `entry`, on the caller's thread, for everything below a folder, at all levels and in no promised
    /// order: a folder's entries come together, before those of its subfolders. Hidden files and the contents
    /// of packages are included, links are reported but not followed. `error` hears of each folder that
    /// cannot be read, the first one too.
    virtual void enumerateDeeply(const Url& folder,
        const std::function<Continue(const Url&, FileType)>& entry,
        const std::function<Continue(const Url&, const Error&)>& error) const = 0;
    /// Does the same for what lies directly in a folder.
    virtual void enumerateShallowly(const Url& folder,
        const std::function<Continue(const Url&, FileType)>& entry,
        const std::function<Continue(const Url&, const Error&)>& error) const = 0;
};

} // namespace platform
