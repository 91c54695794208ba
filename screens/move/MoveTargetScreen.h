// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/controllers/ViewController.h"
#include "kit/views/ListViewDelegate.h"
#include "platform/Dispatch.h"
#include "platform/FolderLister.h"
#include "screens/PlatformNames.h"
#include "screens/move/MoveTargetRows.h"

#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace kit {
class ListView;
} // namespace kit

namespace screens {

class MoveTargetPicker;
class PlaceholderView;

/// One folder of a MoveTargetPicker. It shows the folder's subfolders, and on the picker's first screen the
/// recent destinations above them. Main thread only.
class MoveTargetScreen : public kit::ViewController, private kit::ListViewDelegate {
public:
    /// At most so many destinations are shown as recent.
    static constexpr std::size_t shownRecents = 3;

    MoveTargetScreen(std::weak_ptr<MoveTargetPicker> picker, Url folder);
    ~MoveTargetScreen() override;

    const Url& folder() const { return _folder; }
    const std::shared_ptr<kit::ListView>& listView() const { return _listView; }
    const std::shared_ptr<PlaceholderView>& placeholder() const { return _placeholder; }

    /// Asks for a name, creates the folder and enters it.
    void askForNewFolder();

    void loadView() override;
    void viewDidLoad() override;
    void viewDidAppear(bool animated) override;
    bool backRequested() override;

private:
    void rowActivated(kit::ListView& list, std::size_t index) override;

    std::shared_ptr<MoveTargetScreen> self();
    void makeBars();
    void snapshotArrived(const std::shared_ptr<const FolderSnapshot>& snapshot);
    void showState(const std::optional<Error>& error);
    void findRecents();
    void findTitle();
    /// Takes the keyboard from the list under the picker, as soon as there are rows.
    void takeKeyboard();
    void showRecents(std::vector<Url> recents);
    void makeFolder(const std::string& name);
    void folderWasMade(const Url& made, const std::optional<Error>& error);

    std::weak_ptr<MoveTargetPicker> _picker;
    Url _folder;
    bool _isTitleKnown = false, _hasTakenKeyboard = false;
    std::shared_ptr<kit::ListView> _listView;
    std::shared_ptr<PlaceholderView> _placeholder;
    std::shared_ptr<kit::BarButtonItem> _moveButton;
    std::shared_ptr<MoveTargetRows> _rows;
    std::shared_ptr<FolderListing> _listing;
    std::shared_ptr<OperationQueue> _queue;
};

} // namespace screens
