// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/FileSystem.h"
#include "platform/PagedDocumentEditing.h"
#include "platform/Url.h"
#include "screens/PlatformNames.h"

#include <functional>
#include <memory>
#include <optional>
#include <string>

namespace screens {

/// Where edits are to go.
enum class EditsPlace { Document, Copy };

/// What became of edits that were to be kept.
struct EditsKept {
    enum class Where {
        Document, ///< in the document itself
        Copy, ///< in a new document beside it, because another program has changed the document meanwhile
        Nowhere, ///< `error` says why
    };
    Where where = Where::Nowhere;
    Url place; ///< the document or the copy
    std::optional<Error> error;
    ItemVersion version{}; ///< of the document, where it was saved
};

/// A document that a preview changes: its edits, and their way to the disk. All work is done on a queue of
/// its own, in order; callbacks come on the main thread. Main thread only. Work that was asked for goes on
/// when this is let go.
class PreviewEditing : public std::enable_shared_from_this<PreviewEditing> {
public:
    using Opened = std::function<void(const Result<std::shared_ptr<PreviewEditing>>&)>;
    using Stepped = std::function<void(const std::optional<Error>&)>;
    using Kept = std::function<void(const EditsKept&)>;

    class Work;
    PreviewEditing(Url item, std::shared_ptr<Work> work); ///< use begin()

    /// Reads a document to change it. Errors: those of FileSystem::contentToReplace() and
    /// PagedDocumentOpener::openForEditing().
    static void begin(const Url& item, Opened opened);

    const Url& item() const { return _item; }
    /// The document as it is with its edits.
    const std::shared_ptr<PagedDocument>& pages() const { return _pages; }
    const PagesRights& rights() const { return _rights; }
    /// What lay on the disk when it was read.
    const ItemVersion& versionRead() const { return _versionRead; }

    void apply(PageEdit edit, Stepped done);
    void undo(Stepped done);
    bool canUndo() const { return !_steps.empty(); }
    /// Whether something was changed that is neither in the document nor in a copy.
    bool hasUnsavedEdits() const { return current() != _kept; }
    /// All fields of the form, page by page.
    void readFields(std::function<void(std::vector<FormField>)> completion);
    /// Whether the document's content is another one than was read or saved here last.
    void checkItem(std::function<void(bool isChanged)> completion);

    /// Puts the document with its edits in place of the one on the disk, unless another program has changed
    /// that: then the edits go into a copy.
    void save(Kept kept);
    /// Keeps the edits in a new document beside it.
    void saveCopy(Kept kept);
    /// The document may lie elsewhere now.
    void follow(const Url& item) { _otherPlace = item; }
    /// Gives the edits up.
    void discard() { _kept = current(); }
    /// The same as save() or saveCopy(), at once: for when the program ends. Waits for the disk.
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
    std::vector<unsigned> _steps; ///< a number for each edit that is in force, in their order
    unsigned _lastStep = 0;
    unsigned _kept = 0; ///< the last step in what was kept
};

} // namespace screens
