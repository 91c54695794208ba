// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Attributes.h"
#include "platform/Error.h"

#include <optional>
#include <string>
#include <vector>

namespace platform {

/// What one look at an item found. All parts are of the same moment.
struct ItemReading {
    std::optional<Error> unreachable; ///< as PromisedItems::checkPromisedItemIsReachable()
    Result<AttributeMap> values; ///< as promisedItemResourceValues()
    Url physicalURL; ///< as physicalURLForPromise(); the item's own location when it is unreachable
    std::vector<std::string> tagNames; ///< in the user's order; empty also when they could not be read
};

/// Reads the items of the drive by their logical location, whether they are here or only promised.
///
/// A promise stands for an item whose content is still in the cloud. Its logical location is where the item
/// shows in the drive, its physical location is the placeholder file. Where an item and its promise lie side
/// by side the item counts. No call here downloads anything, and none opens a document. Any thread may call;
/// each call costs a few system calls.
class PromisedItems {
public:
    virtual ~PromisedItems() = default;

    /// Answers nothing when an item is at this logical location, present or promised, and otherwise why it is
    /// not: FileErrorCode::NoSuchItem, or the system's error. A promise that is damaged is reachable.
    virtual std::optional<Error> checkPromisedItemIsReachable(const Url& url) const = 0;

    /// Reads attributes of an item that may be a promise, from what is known of it here. A key that the item
    /// has no value for is left out. Errors: FileErrorCode::NoSuchItem when there is no item; the cloud's
    /// when its promise is damaged; else the system's.
    virtual Result<AttributeMap> promisedItemResourceValues(const Url& url, AttributeKeys keys) const = 0;

    /// Reads reachability, attributes, place and tags of an item with one look at the disk, so that the
    /// answers fit each other. Rows are read by it, which is how the index of identifiers learns where an
    /// item went that another program has moved. It gives no identifier to an item that has none.
    virtual ItemReading readItem(const Url& url, AttributeKeys keys) const = 0;

    /// Reads attributes of what lies at a location in the file system itself; a promise is not looked for,
    /// and a link is not followed. Errors: as above.
    virtual Result<AttributeMap> resourceValues(const Url& url, AttributeKeys keys) const = 0;

    /// Answers where the promise of this logical location lies. It answers the very same object when the item
    /// itself is here, and when neither is.
    virtual Url physicalURLForPromise(const Url& url) const = 0;

    /// Whether this is the physical location of a promise that is there, judged by its name.
    virtual bool isItemPromise(const Url& url) const = 0;
    /// Answers the logical location of the promise at a physical location; the same URL when there is no
    /// promise.
    virtual Url logicalURLForPromise(const Url& url) const = 0;

    /// Whether the file at a location is a reference, a small file that stands for a document in another
    /// place. It is judged by the name's extension and by the content, which must be readable.
    virtual bool isExternalDocumentReference(const Url& url) const = 0;
    /// Answers the document that a reference stands for, which need not be there. Errors: the cloud's when
    /// the file is no reference, is damaged or leads out of its container; else the system's.
    virtual Result<Url> resolveExternalDocumentReference(const Url& url) const = 0;

    /// Answers the target of an alias file, without asking the user and without mounting anything. Errors: as
    /// for a reference, and FileErrorCode::NoSuchItem when the target is not there.
    virtual Result<Url> resolveAliasFile(const Url& url) const = 0;
};

} // namespace platform
