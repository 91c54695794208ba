// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "items/Downloads.h"
#include "kit/controllers/ViewController.h"
#include "kit/views/ListViewDataSource.h"
#include "kit/views/ListViewDelegate.h"

#include <memory>
#include <vector>

namespace kit {
class ListView;
}
namespace screens {
class PlaceholderView;
}

namespace tarrow {

/// The list of the downloads that run and wait, in which each can be cancelled. Main thread only.
class DownloadsScreen : public kit::ViewController,
                        public kit::ListViewDataSource,
                        public kit::ListViewDelegate {
public:
    /// Shows the list over a screen.
    static std::shared_ptr<DownloadsScreen> present(
        const std::shared_ptr<kit::ViewController>& parent, const std::shared_ptr<Downloads>& downloads);
    explicit DownloadsScreen(std::shared_ptr<Downloads> downloads);

    /// Something about the downloads has changed.
    void update();

    const std::shared_ptr<kit::ListView>& listView() const { return _listView; } ///< null: not loaded
    const std::shared_ptr<screens::PlaceholderView>& placeholder() const { return _placeholder; }

    void loadView() override;
    void viewDidLoad() override;

    std::size_t numberOfRows(const kit::ListView& list) const override;
    kit::ListRow rowAtIndex(const kit::ListView& list, std::size_t index) const override;
    kit::RowId rowIdAtIndex(const kit::ListView& list, std::size_t index) const override;
    void rowActivated(kit::ListView& list, std::size_t index) override;
    kit::Menu menuForRow(kit::ListView& list, std::size_t index) override;
    bool rowCommand(kit::ListView& list, std::size_t index, kit::RowCommand command) override;

private:
    std::shared_ptr<DownloadsScreen> self();
    void showRows();

    const std::shared_ptr<Downloads> _downloads;
    std::vector<Downloads::Entry> _entries; ///< what the list shows
    std::shared_ptr<kit::ListView> _listView;
    std::shared_ptr<screens::PlaceholderView> _placeholder;
};

} // namespace tarrow
