#pragma once

#include "platform/ui/ListChanges.h"
#include "platform/ui/Menu.h"

#include <memory>

namespace platform::ui {

class ListView;
class ViewController;

/// Is told what the user does with a list. Main thread only.
class ListViewDelegate {
public:
    virtual ~ListViewDelegate() = default;

    /// An item was tapped while the list was not in selection mode.
    virtual void rowActivated(ListView&, std::size_t /*index*/) { }
    /// The entries of the menu that a long press or the second mouse button asks for; empty: no menu.
    virtual Menu menuForRow(ListView&, std::size_t /*index*/) { return {}; }
    /// Other rows are visible now, or other rows stand there: begin to fetch their details, cancel those of
    /// the rest.
    virtual void visibleRowsDidChange(ListView&, RowRange) { }
    /// The user changed the selection.
    virtual void selectionDidChange(ListView&) { }
    /// The list was pulled down to be refreshed; answer with `ListView::endRefreshing`.
    virtual void refreshRequested(ListView& list);

    /// The screen for a peek at a row; null: none.
    virtual std::shared_ptr<ViewController> peekForRow(ListView&, std::size_t /*index*/) { return nullptr; }
    /// The user went on from the peek.
    virtual void peekWasOpened(ListView&, std::size_t /*index*/) { }
};

} // namespace platform::ui
