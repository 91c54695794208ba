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
    std::string name; ///< the app's own name of the kind
    /// Uniform type identifiers. An entry of the declaration that is no text stands here as nothing, so that
    /// the order of the declaration is kept.
    std::vector<std::optional<std::string>> contentTypes;
};

/// What is known of one cloud document container. A container is a part of the drive that belongs together:
/// the default container is the drive's top level, and every other one is an app library, the documents of
/// one app.
struct DocumentContainer {
    std::string identifier; ///< the name of the container's folder on disk
    /// The name in the user's language; where the container gives none, its identifier. Never empty.
    std::string localizedName;
    std::optional<Url> documentsURL; ///< the folder of its documents; nothing while that folder is missing
    std::vector<DocumentType> documentTypes; ///< the kinds of documents that its apps declare
    /// Limits the depth of its folders, as one of `folderLevels`; nothing when it declares none.
    std::optional<std::string> supportedFolderLevels;
    std::vector<std::string> owningApps; ///< application identifiers, the most important one first
    std::optional<std::string> iconName; ///< the icon of the owning app, in the icon theme
};

/// The values of DocumentContainer::supportedFolderLevels that the program knows. A container may declare
/// another text, which counts as an unknown option.
namespace folderLevels {
inline constexpr std::string_view any = "any"; ///< folders may lie within each other
inline constexpr std::string_view one = "one"; ///< folders may lie in the documents folder only
inline constexpr std::string_view none = "none"; ///< there are no folders
} // namespace folderLevels

/// The cloud document containers of the account. Any thread may call. A container's description is a small
/// local file that is read when it is needed first and again when it changed, so a call costs at most a few
/// system calls and one such reading.
class DocumentContainers {
public:
    virtual ~DocumentContainers() = default;

    /// The identifier of the default container, which never changes.
    virtual std::string defaultContainerIdentifier() const = 0;
    /// Answers the local folder of the default container, the drive's top level; nothing when nobody is
    /// signed in.
    virtual std::optional<Url> defaultContainerURL() const = 0;

    /// Whether a URL is the documents folder of a container, judged by its names; the folder need not be
    /// there.
    virtual bool isContainerTopFolder(const Url& url) const = 0;

    /// Answers the container that holds an item. Errors: the cloud's when the URL lies in no container, and
    /// when the container's description is there but damaged or unreadable. A missing description is no
    /// error: the container then goes by its identifier.
    virtual Result<std::shared_ptr<const DocumentContainer>> containerForItem(const Url& url) const = 0;

    /// Answers the identifier of the container that the names of a URL point to, whether the service knows it
    /// or not. It answers nothing when the URL lies outside of all containers. No file is read.
    virtual std::optional<std::string> containerIdentifierInURL(const Url& url) const = 0;
    /// Answers the container with an identifier; null when there is no folder of that name.
    virtual std::shared_ptr<const DocumentContainer> containerWithIdentifier(
        const std::string& identifier) const = 0;

    /// Answers the path of a URL below the root of all cloud documents, such as
    /// "BrindleDefault/Documents/Notes.txt"; it is empty for the root itself. It answers nothing when the URL
    /// lies outside. Names are compared as they stand, and links are not resolved.
    virtual std::optional<std::string> pathRelativeToSyncedRoot(const Url& url) const = 0;

    /// Whether items of one container can be moved to another as they are, so that contents that are only
    /// promised need not be downloaded first.
    virtual bool canMoveWithoutDownloading(
        const DocumentContainer& source, const DocumentContainer& destination) const = 0;

    /// Deletes a container with all its documents, on this device and in the cloud, and answers why that
    /// failed. All documents go or none. The call waits for the disk but for nobody who uses the documents,
    /// because it does not coordinate. Errors: FileErrorCode::Unsupported for the default container, which is
    /// never deleted; FileErrorCode::NoSuchItem; FileErrorCode::Cancelled when a document changed meanwhile;
    /// else the system's.
    virtual std::optional<Error> deleteContents(const DocumentContainer& container) = 0;

    /// Answers all containers that the service knows, the default container first, then by their localized
    /// names in the user's order. The answer is empty when the drive cannot be read. It reads one folder.
    virtual std::vector<std::shared_ptr<const DocumentContainer>> allContainers() const = 0;
};

} // namespace platform
