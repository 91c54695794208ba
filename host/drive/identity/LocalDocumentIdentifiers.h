// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/identity/DocumentFinder.h"
#include "platform/Dispatch.h"
#include "platform/DocumentIdentifiers.h"

#include <map>
#include <set>

namespace host::drive {

class IdentifiedItem;

/// Keeps document identifiers in an extended attribute of the items and in their promises, and finds
/// documents by them through an index.
///
/// The index only says where to look first: an answer is always read from the file that is then open. Moves
/// and removals by this program are noted at once. Moves by others are noted when the item is next read, or
/// else when it is looked up and is not in its place.
///
/// Identifiers are drawn at random, so that a lost index does not lead to one being given twice. The
/// identifier of a removed document is kept as removed. Of two items with one identifier the one at the known
/// inode keeps it, else the older one; the other gets a new identifier when it needs one.
///
/// A program that saves by putting a new file in a document's place leaves the identifier behind. The new
/// file inherits it when either is asked for, but only when no item of the drive, of its trash or in work
/// carries it, and all of them could be read.
class LocalDocumentIdentifiers : public platform::DocumentIdentifiers,
                                 public std::enable_shared_from_this<LocalDocumentIdentifiers> {
public:
    using Effort = DocumentFinder::Effort;

    static std::shared_ptr<LocalDocumentIdentifiers> create(
        const DriveLayout& layout, const std::shared_ptr<platform::Dispatch>& dispatch);

    std::optional<std::uint64_t> deviceIdentifier() override;
    platform::Result<File> resolve(std::uint32_t identifier) override;
    platform::Result<std::shared_ptr<const OpenFile>> open(const File& file) override;
    platform::Result<std::uint32_t> identify(const platform::Url& url) override;

    /// Works like identify() for the item at a path below the drive's home.
    platform::Result<std::uint32_t> identifyAt(const std::string& path);
    /// Answers the current place of the document, all steps at once. The search takes all the time that it
    /// needs.
    std::optional<platform::Url> find(std::uint32_t identifier);

    /// Tells that an item at an absolute path was read and carries an identifier. When nothing is new it
    /// costs a look into a small table; otherwise the index is corrected in the background. Any thread.
    void seen(std::uint32_t identifier, const std::string& path);
    /// Tells that an item was moved. The paths are absolute.
    void moved(const std::string& from, const std::string& to);
    /// Tells that the item at a path is another file now, because its content was downloaded. It is noted in
    /// the background.
    void replaced(const std::string& path);
    /// Answers the documents at a path and below it that really exist, for removed() when they are removed.
    std::vector<std::uint32_t> documentsWithin(const std::string& path) const;
    void removed(const std::vector<std::uint32_t>& identifiers);

private:
    LocalDocumentIdentifiers(const DriveLayout& layout, const std::shared_ptr<platform::Dispatch>& dispatch);

    platform::Result<File> resolve(std::uint32_t identifier, Effort effort);
    std::optional<DocumentPlace> locate(const IdentifiedPlace& known, Effort effort);
    void searchInBackground(const IdentifiedPlace& known);
    void searchFor(const IdentifiedPlace& known);
    void rebuild();
    void correct(std::uint32_t identifier, const std::string& path);
    platform::Result<std::uint32_t> identifyLocked(const std::string& path);
    std::optional<DocumentPlace> inherit(const IdentifiedPlace& known);
    std::optional<DocumentPlace> inheritLocked(const IdentifiedPlace& known);
    platform::Result<std::uint32_t> giveIdentifier(const IdentifiedItem& item);
    bool isOwner(const IdentifiedPlace& known, DocumentIndex::Answer::Kind kind, const DocumentPlace& place);
    bool isAt(const IdentifiedPlace& known) const;
    std::optional<std::string> relativePath(const std::string& path) const;

    DriveLayout _layout;
    DocumentIndex _index;
    DocumentFinder _finder;
    std::shared_ptr<platform::Dispatch> _dispatch;
    std::shared_ptr<platform::Queue> _queue;
    std::mutex _mutex; ///< guards the fields below
    std::optional<std::uint64_t> _device;
    std::map<std::uint32_t, std::string> _seen; ///< the paths where items were last read
    std::set<std::uint32_t> _searched; ///< searched for in the whole drive since the start
};

} // namespace host::drive
