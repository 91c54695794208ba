// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/ListChanges.h"
#include "kit/values/Menu.h"

#include <cstddef>

namespace kit {

class ListView;

/// What the keyboard asks for at a row, beside to open it.
enum class RowCommand { Rename, Delete, Info, Peek };

/// Is told what the user does with a list. Main thread only.
class ListViewDelegate {
public:
    virtual ~ListViewDelegate() = default;

    /// An item was tapped while the list was not in selection mode.
    virtual void rowActivated(ListView&, std::size_t /*index*/) { }
    /// The entries of the menu that a long press or the second mouse button asks for; empty: no menu.
    virtual Menu menuForRow(ListView&, std::size_t /*index*/) { return {}; }
    /// The entries of the menu for the list itself, away from any row; empty: no menu.
    virtual Menu menuForList(ListView&) { return {}; }
    /// A key of the row's; false: it means nothing here.
    virtual bool rowCommand(ListView&, std::size_t /*index*/, RowCommand) { return false; }
    /// The user began to select by the keyboard while the list was not in selection mode. Answer by entering
    /// it, or not at all.
    virtual void selectionRequested(ListView&) { }
    /// Other rows are visible now, or other rows stand there: begin to fetch their details, cancel those of
    /// the rest.
    virtual void visibleRowsDidChange(ListView&, RowRange) { }
    /// The user changed the selection.
    virtual void selectionDidChange(ListView&) { }
    /// The list was pulled down to be refreshed; answer with `ListView::endRefreshing`.
    virtual void refreshRequested(ListView& list);

    /// A row is held: show what it has to say, over the list. False: there is nothing, and the row's menu
    /// is shown instead.
    virtual bool rowHeld(ListView&, std::size_t /*index*/) { return false; }
    /// The finger that held a row presses on: open what the row showed.
    virtual void heldRowPressedOn(ListView&) { }
};

} // namespace kit
