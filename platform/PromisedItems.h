// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Attributes.h"
#include "platform/Error.h"

#include <optional>
#include <string>
#include <vector>

namespace platform {

/// What one look at an item found.
struct ItemReading {
    std::optional<Error> unreachable; ///< as PromisedItems::checkPromisedItemIsReachable()
    Result<AttributeMap> values; ///< as promisedItemResourceValues()
    Url physicalURL; ///< as physicalURLForPromise()
    std::vector<std::string> tagNames; ///< as tagNames(); empty on failure
};

/// Items of the drive by their logical location, whether they are here or only promised.
///
/// A promise stands for an item whose content is still in the cloud. Its logical location is where the item
/// shows in the drive, its physical location is the placeholder file. No call here downloads anything. Any
/// thread.
class PromisedItems {
public:
    virtual ~PromisedItems() = default;

    /// Nothing when an item is at this logical location, present or promised; else why not
    /// (FileErrorCode::NoSuchItem, or the system's error).
    virtual std::optional<Error> checkPromisedItemIsReachable(const Url& url) const = 0;

    /// Reads attributes of an item that may be a promise, from what is known of it here. Keys that the item
    /// has no value for are left out. Errors: FileErrorCode::NoSuchItem when there is none; others when its
    /// record is damaged.
    virtual Result<AttributeMap> promisedItemResourceValues(const Url& url, AttributeKeys keys) const = 0;

    /// Reachability, attributes, place and tags of an item in one go: quicker than asking for each, and all
    /// of the same moment.
    virtual ItemReading readItem(const Url& url, AttributeKeys keys) const;

    /// Reads attributes of what lies at a location in the file system; a promise is not looked for.
    virtual Result<AttributeMap> resourceValues(const Url& url, AttributeKeys keys) const = 0;

    /// Where the promise of this logical location lies; the very same object when the item is no promise.
    virtual Url physicalURLForPromise(const Url& url) const = 0;

    /// Whether this is the physical location of a promise.
    virtual bool isItemPromise(const Url& url) const = 0;
    /// The logical location of the promise at a physical location; the same URL when it is none.
    virtual Url logicalURLForPromise(const Url& url) const = 0;

    /// Whether the file at a location refers to a document kept elsewhere (by its name's extension and
    /// content).
    virtual bool isExternalDocumentReference(const Url& url) const = 0;
    /// The document that a reference stands for; it need not be there. Errors when the reference cannot be
    /// read.
    virtual Result<Url> resolveExternalDocumentReference(const Url& url) const = 0;

    /// The target of an alias file, found without asking the user and without mounting anything.
    virtual Result<Url> resolveAliasFile(const Url& url) const = 0;

    /// The names of the item's tags, in the user's order; empty when it has none.
    virtual Result<std::vector<std::string>> tagNames(const Url& url) const = 0;
};

} // namespace platform
