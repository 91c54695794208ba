// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/records/ContainerRecord.h"
#include "kit/views/ListViewObserver.h"
#include "screens/list/DocumentListController.h"
#include "screens/list/DocumentListControllerDelegate.h"
#include "tests/screens/support/ScreensFixture.h"

namespace testing_support {

/// Records what a folder list reports, one line for each call.
class RecordingListDelegate : public screens::DocumentListControllerDelegate {
public:
    void documentListControllerDidSelectContainerWithViewController(
        const List& list, const List& container) override;
    void documentListControllerDidSelectItemAtURL(const List& list, const platform::Url& url) override;
    void documentListControllerItemsChanged(const List& list) override;
    void documentListControllerURLWasRemoved(const List& list) override;
    void documentListControllerPerformActionURLOriginatingViewCompletion(const List& list, int action,
        const platform::Url& url, const std::shared_ptr<kit::View>& view,
        const Completion& completion) override;
    void documentListControllerRequestsEditing(const List& list) override;
    std::shared_ptr<kit::ViewController> documentListControllerViewControllerForPreviewingItemAtURL(
        const List&, const platform::Url&) override
    {
        return preview;
    }

    Lines take() { return std::exchange(_lines, {}); }

    std::shared_ptr<kit::ViewController> preview; ///< the screen for a peek
    bool allowsEditing = false;
    std::vector<Completion> completions; ///< those of the actions so far, which the test calls

private:
    Lines _lines;
};

/// Lists of folders whose listings the test delivers.
class DocumentList : public ScreensFixture {
protected:
    using List = std::shared_ptr<screens::DocumentListController>;

    /// Answers a list of a folder with room for about ten rows, loaded, shown and watched by `delegate`.
    List shownList(const platform::Url& folder) const;
    void deliver(const List& list, const HandLister::Entries& entries) const;
    platform::Url makePaintLibrary() const;
    static HandLister::Entries documents(std::size_t count)
    {
        HandLister::Entries entries;
        for (std::size_t i = 0; i < count; ++i)
            entries.push_back({"item " + std::to_string(100'000 + i)});
        return entries;
    }

    std::shared_ptr<RecordingListDelegate> delegate = std::make_shared<RecordingListDelegate>();
};

/// Records the exact changes that a list's peer is told.
struct RecordingListObserver : kit::ListViewObserver {
    using ListView = kit::ListView;

    void rowsWereReset(ListView&) override { ++resets; }
    void rowsDidChange(ListView&, const kit::ListChanges& changes) override { last = changes; }
    void rowDidChange(ListView&, std::size_t index) override { changedRows.push_back(index); }
    void selectionDidChange(ListView&) override { }
    void scrollToRow(ListView&, std::size_t, kit::RowPosition, bool) override { }
    void focusRow(ListView&, std::size_t index) override { focused.push_back(index); }
    void refreshStateDidChange(ListView&) override { }

    int resets = 0;
    kit::ListChanges last;
    std::vector<std::size_t> changedRows, focused;
};

} // namespace testing_support
