// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Error.h"
#include "platform/Url.h"

#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace platform {

/// A kind of document that a container's apps declare.
struct DocumentType {
    std::string name;
    /// Uniform type identifiers; an entry of the declaration that is no text is nothing here.
    std::vector<std::optional<std::string>> contentTypes;
};

/// What is known of one cloud document container: an app library, or the default container (the drive's top
/// level).
struct DocumentContainer {
    std::string identifier;
    std::string localizedName;
    std::optional<Url> documentsURL; ///< its documents folder
    std::vector<DocumentType> documentTypes;
    std::optional<std::string> supportedFolderLevels; ///< nothing: no depth declared
    std::vector<std::string> owningApps; ///< application identifiers, in the service's order
    std::optional<std::string> iconName; ///< icon of the owning app
};

/// Values of DocumentContainer::supportedFolderLevels; any other text is an unknown option.
namespace folderLevels {
inline constexpr std::string_view any = "any";
inline constexpr std::string_view one = "one";
inline constexpr std::string_view none = "none";
} // namespace folderLevels

/// The cloud document containers of the account. Any thread; descriptions are read from small local files and
/// kept.
class DocumentContainers {
public:
    virtual ~DocumentContainers() = default;

    virtual std::string defaultContainerIdentifier() const = 0;
    /// The local folder of the default container; nothing when signed out.
    virtual std::optional<Url> defaultContainerURL() const = 0;

    /// Whether a URL is the documents folder of a container.
    virtual bool isContainerTopFolder(const Url& url) const = 0;

    /// The container that holds an item; an error when the URL lies in none or the container's description is
    /// damaged.
    virtual Result<std::shared_ptr<const DocumentContainer>> containerForItem(const Url& url) const = 0;

    /// The container that the names of a URL say it belongs to, known or not; nothing when they say none. No
    /// file is read.
    virtual std::optional<std::string> containerIdentifierInURL(const Url& url) const = 0;
    /// The container with an identifier; null when the service knows none.
    virtual std::shared_ptr<const DocumentContainer> containerWithIdentifier(
        const std::string& identifier) const = 0;

    /// The path of a URL below the root of all cloud documents, such as "BrindleDefault/Documents/Notes.txt"
    /// (empty for the root itself); nothing when the URL lies outside.
    virtual std::optional<std::string> pathRelativeToSyncedRoot(const Url& url) const = 0;

    /// Whether files of one container can be moved to another as they are, without fetching what is only
    /// promised.
    virtual bool canMoveWithoutDownloading(
        const DocumentContainer& source, const DocumentContainer& destination) const = 0;

    /// Deletes a container with all its documents, on this device and on the server. The default container is
    /// never deleted (FileErrorCode::Unsupported). Synchronous; waits for nobody who uses the documents.
    virtual std::optional<Error> deleteContents(const DocumentContainer& container) = 0;

    /// All containers that the service knows, the default container first, then by localized name.
    virtual std::vector<std::shared_ptr<const DocumentContainer>> allContainers() const = 0;
};

} // namespace platform
