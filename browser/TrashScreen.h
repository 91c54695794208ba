// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "browser/TrashRows.h"
#include "items/ItemChange.h"
#include "kit/controllers/ViewController.h"
#include "kit/views/ListViewDataSource.h"
#include "kit/views/ListViewDelegate.h"
#include "platform/Dispatch.h"
#include "platform/NotificationCenter.h"

#include <functional>
#include <memory>
#include <set>
#include <string>
#include <vector>

namespace kit {
class ListView;
}
namespace screens {
class PlaceholderView;
}

namespace tarrow {

/// The list of what is in the trash. Items can be put back and deleted for good, one or many. It follows the
/// trash, and begins changes on the queue of all changes. Main thread only.
class TrashScreen : public kit::ViewController, public kit::ListViewDataSource, public kit::ListViewDelegate {
public:
    /// Is told of the changes that the screen begins, and that one has ended.
    struct Handlers {
        std::function<void(const std::shared_ptr<ItemChange>&)> begun;
        std::function<void()> ended;
    };
    /// Shows the list over a screen.
    static std::shared_ptr<TrashScreen> present(
        const std::shared_ptr<kit::ViewController>& parent, Handlers handlers);
    explicit TrashScreen(Handlers handlers);

    const std::shared_ptr<kit::ListView>& listView() const { return _listView; } ///< null: not loaded
    const std::shared_ptr<screens::PlaceholderView>& placeholder() const { return _placeholder; }
    /// Answers whether the user is selecting several items.
    bool isSelecting() const { return _isSelecting; }
    void setSelecting(bool selecting);

    void loadView() override;
    void viewDidLoad() override;
    void viewDidAppear(bool animated) override;

    std::size_t numberOfRows(const kit::ListView&) const override { return _rows.size(); }
    kit::ListRow rowAtIndex(const kit::ListView& list, std::size_t index) const override;
    kit::RowId rowIdAtIndex(const kit::ListView&, std::size_t index) const override
    {
        return _rows[index].id();
    }
    void rowActivated(kit::ListView& list, std::size_t index) override;
    kit::Menu menuForRow(kit::ListView& list, std::size_t index) override;
    bool rowCommand(kit::ListView& list, std::size_t index, kit::RowCommand command) override;
    void selectionDidChange(kit::ListView&) override { showBars(); }
    void selectionRequested(kit::ListView&) override { setSelecting(true); }

private:
    using Items = std::vector<TrashedItem>;

    std::shared_ptr<TrashScreen> self();
    void readAgain();
    void arrived(TrashContent content);
    void showState(const std::optional<Error>& error);
    void showBars();
    void takeKeyboard();
    Items selectedItems() const;
    /// Answers the items that a key or a menu at a row is about: the selected ones if the row is one of them.
    Items itemsAt(std::size_t index) const;
    void restore(const Items& items, IfTaken ifTaken);
    void restored(const RestoringOutcome& outcome);
    void askToKeepBoth(const Items& items);
    void askBeforeRemoval(const Items& items, const std::shared_ptr<kit::BarButtonItem>& button);
    void remove(const Items& items);
    template <typename Work, typename Ended>
    void begin(const Items& items, Work work, Ended ended);

    const Handlers _handlers;
    const AccountSession _asked;
    std::vector<TrashRow> _rows;
    std::set<std::string> _busy; ///< identifiers of the items that are being changed
    std::shared_ptr<kit::ListView> _listView;
    std::shared_ptr<screens::PlaceholderView> _placeholder;
    std::shared_ptr<platform::Queue> _queue;
    platform::Observation _onChange;
    bool _isSelecting = false, _isKnown = false, _hasTakenKeyboard = false;
};

} // namespace tarrow
