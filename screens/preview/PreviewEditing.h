// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/FileChanges.h"
#include "platform/PagedDocumentEditing.h"
#include "platform/Url.h"
#include "screens/PlatformNames.h"

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace screens {

/// The file into which edits are to be written.
enum class EditsPlace { Document, Copy };

/// The outcome of keeping edits.
struct EditsKept {
    enum class Where {
        Document, ///< in the document itself
        Copy, ///< in a new document beside it, because another program has changed the document meanwhile
        Nowhere, ///< `error` says why
    };
    Where where = Where::Nowhere;
    Url place; ///< the document or the copy
    std::optional<Error> error;
    ItemVersion version{}; ///< the document's version after the save
};

/// A document that a preview changes: it collects the edits and writes them to the disk. Work runs in order
/// on a serial queue of its own and goes on when this object is released. Callbacks come on the main thread.
/// Main thread only.
class PreviewEditing : public std::enable_shared_from_this<PreviewEditing> {
public:
    using Opened = std::function<void(const Result<std::shared_ptr<PreviewEditing>>&)>;
    using Stepped = std::function<void(const std::optional<Error>&)>;
    using Kept = std::function<void(const EditsKept&)>;

    class Work;
    PreviewEditing(Url item, std::shared_ptr<Work> work); ///< use begin()

    /// Reads a document to change it. The errors are those of FileChanges::contentToReplace() and
    /// PagedDocumentOpener::openForEditing().
    static void begin(const Url& item, Opened opened);

    const Url& item() const { return _item; }
    /// Answers the document with its edits.
    const std::shared_ptr<PagedDocument>& pages() const { return _pages; }
    const PagesRights& rights() const { return _rights; }
    /// Answers the version of the document that was read from the disk.
    const ItemVersion& versionRead() const { return _versionRead; }

    void apply(PageEdit edit, Stepped done);
    void undo(Stepped done);
    bool canUndo() const { return !_steps.empty(); }
    /// Answers whether there are edits that are neither in the document nor in a copy.
    bool hasUnsavedEdits() const { return current() != _kept; }
    /// Answers whether a save is under way, whose callback is still to come.
    bool isBeingKept() const { return _savesUnderWay > 0; }
    /// Reads all fields of the form, page by page.
    void readFields(std::function<void(std::vector<FormField>)> completion);
    /// Answers whether the document's content differs from the one that was last read or saved here.
    void checkItem(std::function<void(bool isChanged)> completion);

    /// Replaces the document on the disk by the edited one. When another program has changed the document
    /// meanwhile, the edits go into a copy instead, and later ones are saved in that copy.
    void save(Kept kept);
    /// Writes the edits into a new document beside the original.
    void saveCopy(Kept kept);
    /// Says that the document may have been moved to another place.
    void follow(const Url& item) { _otherPlace = item; }
    /// Discards the edits.
    void discard() { _kept = current(); }
    /// Does the same as save() or saveCopy() at once and waits for the disk, because the program ends.
    EditsKept keepNow(EditsPlace place);

private:
    unsigned current() const { return _steps.empty() ? 0 : _steps.back(); }
    void keep(EditsPlace place, Kept kept);
    void post(std::function<std::function<void()>()> step);

    Url _item;
    std::optional<Url> _otherPlace;
    std::shared_ptr<Work> _work;
    std::shared_ptr<PagedDocument> _pages;
    PagesRights _rights;
    ItemVersion _versionRead;
    std::vector<unsigned> _steps; ///< numbers of the edits in force, in their order
    unsigned _lastStep = 0;
    unsigned _kept = 0; ///< the last step that was saved
    int _savesUnderWay = 0;
};

} // namespace screens
