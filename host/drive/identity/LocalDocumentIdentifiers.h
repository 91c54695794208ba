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

/// Document identifiers in an extended attribute of the items and in their promises, found through an index.
///
/// The index only says where to look first: an answer is always read from the file that is then open. What
/// this program moves and removes is noted at once; what others do is noted when the item is next read, and
/// else when it is looked up and is not where it was.
///
/// Numbers are drawn by chance, so that an index that was lost does not lead to one being given twice; one
/// whose document was removed is kept as removed. Of two items with one number the one at the known inode has
/// it, else the older one; the other gets a new number when it needs one.
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

    /// As identify(), of what is at a path below the drive's home.
    platform::Result<std::uint32_t> identifyAt(const std::string& path);
    /// Where the document is now, all steps at once; the search takes all the time it needs.
    std::optional<platform::Url> find(std::uint32_t identifier);

    /// An item at an absolute path was read and carries an identifier. Costs a look into a small table where
    /// nothing is new; the index is corrected in the background. Any thread.
    void seen(std::uint32_t identifier, const std::string& path);
    /// An item is elsewhere now; the paths are absolute.
    void moved(const std::string& from, const std::string& to);
    /// An item is where it was, but is another file now (its content came from the cloud). Noted in the
    /// background.
    void replaced(const std::string& path);
    /// The documents at a path and below it that are really there, to be told of when they are removed.
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
    platform::Result<std::uint32_t> giveIdentifier(const IdentifiedItem& item);
    bool isOwner(const IdentifiedPlace& known, DocumentIndex::Answer::Kind kind, const DocumentPlace& place);
    bool isAt(const IdentifiedPlace& known) const;
    std::optional<std::string> relativePath(const std::string& path) const;

    DriveLayout _layout;
    DocumentIndex _index;
    DocumentFinder _finder;
    std::shared_ptr<platform::Dispatch> _dispatch;
    std::shared_ptr<platform::Queue> _queue;
    std::mutex _mutex; ///< for what follows
    std::optional<std::uint64_t> _device;
    std::map<std::uint32_t, std::string> _seen; ///< where items were read last
    std::set<std::uint32_t> _searched; ///< looked for in the whole drive since the start
};

} // namespace host::drive
