// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/ListChanges.h"
#include "kit/values/Menu.h"
#include "platform/Url.h"

#include <cstddef>
#include <vector>

namespace kit {

class ListView;

/// Keys that act on a row, other than the key that opens it.
enum class RowCommand { Rename, Delete, DeleteForGood, Info, Peek, Copy };

/// Is told what the user does with a list. Main thread only.
class ListViewDelegate {
public:
    virtual ~ListViewDelegate() = default;

    /// An item was tapped while the list was not in selection mode.
    virtual void rowActivated(ListView&, std::size_t /*index*/) { }
    /// Answers the entries of the menu that a long press or the second mouse button asks for; empty means no
    /// menu.
    virtual Menu menuForRow(ListView&, std::size_t /*index*/) { return {}; }
    /// Answers the entries of the menu for the list itself, away from any row; empty means no menu.
    virtual Menu menuForList(ListView&) { return {}; }
    /// The user pressed a key that acts on a row. Answers false when the key means nothing here.
    virtual bool rowCommand(ListView&, std::size_t /*index*/, RowCommand) { return false; }
    /// Answers the files that the user drags from a row to another program; none when nothing can be dragged.
    virtual std::vector<platform::Url> filesToDrag(ListView&, std::size_t /*index*/) { return {}; }
    /// The user began to select by the keyboard while the list was not in selection mode. The delegate may
    /// answer by entering selection mode.
    virtual void selectionRequested(ListView&) { }
    /// Other rows are visible now, or the visible places hold other rows. The delegate begins to fetch their
    /// details and cancels fetching those of the rest.
    virtual void visibleRowsDidChange(ListView&, RowRange) { }
    /// The user changed the selection.
    virtual void selectionDidChange(ListView&) { }
    /// The user pulled the list down to refresh it. The delegate answers with `ListView::endRefreshing`.
    virtual void refreshRequested(ListView& list);

    /// The user holds a row, and the delegate shows the row's content over the list. Answers false when there
    /// is nothing to show, and the row's menu is shown instead.
    virtual bool rowHeld(ListView&, std::size_t /*index*/) { return false; }
    /// The finger that held a row pressed on, and the delegate opens what the row showed.
    virtual void heldRowPressedOn(ListView&) { }
};

} // namespace kit
