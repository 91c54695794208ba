// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/move/MoveTargetScreen.h"

#include "kit/controllers/AlertController.h"
#include "kit/controllers/NavigationItem.h"
#include "kit/views/ListView.h"
#include "platform/FileChanges.h"
#include "platform/FileCoordinator.h"
#include "platform/FileSystem.h"
#include "platform/Localization.h"
#include "platform/Services.h"
#include "platform/Weakly.h"
#include "screens/DisplayName.h"
#include "screens/DrivePlaces.h"
#include "screens/ErrorWords.h"
#include "screens/FolderPlaces.h"
#include "screens/PlaceholderView.h"
#include "screens/move/FolderNameAlert.h"
#include "screens/move/MoveTargetPicker.h"
#include "screens/move/RecentMoveTargets.h"

#include <algorithm>
#include <utility>

namespace screens {

namespace {

/// With more rows than this the exact difference of two states would take longer than a frame.
constexpr std::size_t differenceLimit = 2000;

void fill(kit::View& parent, const std::shared_ptr<kit::View>& view)
{
    view->setAutoresizing({.flexibleWidth = true, .flexibleHeight = true});
    view->setFrame(parent.bounds());
    parent.addSubview(view);
}

} // namespace

MoveTargetScreen::MoveTargetScreen(std::weak_ptr<MoveTargetPicker> picker, Url folder)
    : _picker(std::move(picker))
    , _folder(std::move(folder))
    , _queue(services().dispatch().makeOperationQueue("move destinations", QualityOfService::UserInitiated))
{
    const auto asking = _picker.lock();
    const auto title = asking ? asking->places().folderTitle(_folder) : std::nullopt;
    setTitle(title.value_or(displayName(_folder.lastPathComponent())));
    _isTitleKnown = title.has_value();
}

/// Looks up the title of a folder that was entered from its row.
void MoveTargetScreen::findTitle()
{
    const auto main = services().dispatch().mainQueue();
    _queue->addOperation([weak = std::weak_ptr(self()), folder = _folder, main] {
        main->async(weakly(weak, [title = folderTitle(folder)](MoveTargetScreen& found) {
            found.setTitle(title);
            found._listView->setAccessibility({.label = title, .hint = {}});
        }));
    });
}

MoveTargetScreen::~MoveTargetScreen() = default;

std::shared_ptr<MoveTargetScreen> MoveTargetScreen::self()
{
    return std::static_pointer_cast<MoveTargetScreen>(shared_from_this());
}

void MoveTargetScreen::loadView()
{
    const auto view = std::make_shared<kit::View>();
    _listView = std::make_shared<kit::ListView>();
    _listView->setAccessibility({.label = title(), .hint = {}});
    _placeholder = PlaceholderView::create();
    _placeholder->setHidden(true);
    fill(*view, _listView);
    fill(*view, _placeholder);
    setView(view);
}

void MoveTargetScreen::viewDidLoad()
{
    makeBars();
    const auto picker = _picker.lock();
    if (!picker)
        return;
    const bool showsLibraries = picker->scope() == MoveTargetScope::AllContainers;
    _rows = std::make_shared<MoveTargetRows>(
        showsLibraries ? MoveTargetRows::Libraries::Shown : MoveTargetRows::Libraries::Hidden,
        weaklyOr(false, _picker, &MoveTargetPicker::isToBeMoved), picker->sharedPlaces());
    _listView->setDataSource(_rows);
    _listView->setListDelegate(
        std::shared_ptr<kit::ListViewDelegate>(self(), static_cast<kit::ListViewDelegate*>(this)));
    _listing = services().folderLister().list(_folder,
        showsLibraries ? picker->places().extraItemsOf(_folder) : std::vector<FolderSnapshot::ExtraItem>(),
        FolderGrouping::FoldersFirst, weakly(this, &MoveTargetScreen::snapshotArrived));
    findRecents();
    if (!_isTitleKnown)
        findTitle();
}

void MoveTargetScreen::viewDidAppear(bool animated)
{
    kit::ViewController::viewDidAppear(animated);
    _hasTakenKeyboard = false;
    takeKeyboard();
}

void MoveTargetScreen::takeKeyboard()
{
    if (_hasTakenKeyboard || appearanceState() != kit::AppearanceState::Appeared || !_rows
        || _rows->ids().empty() || presentedViewController())
        return;
    _hasTakenKeyboard = true;
    _listView->becomeFirstResponder();
}

void MoveTargetScreen::makeBars()
{
    const auto picker = _picker.lock();
    if (!picker)
        return;
    const auto count = static_cast<std::int64_t>(picker->itemsToMove().size());
    navigationItem().setSubtitle(localizedPlural(".DICT.MOVE_ITEMS.%d", {count}));
    navigationItem().setRightItem(std::make_shared<kit::BarButtonItem>(
        kit::SystemItem::Cancel, weakly(_picker, &MoveTargetPicker::cancel)));
    const auto newFolder = std::make_shared<kit::BarButtonItem>(
        localized("New Folder"), weakly(this, &MoveTargetScreen::askForNewFolder));
    _moveButton = std::make_shared<kit::BarButtonItem>(
        localized("Move Here"), weakly(_picker, &MoveTargetPicker::choose, _folder));
    _moveButton->setEnabled(picker->canChoose(_folder));
    setToolbarItems(
        {newFolder, std::make_shared<kit::BarButtonItem>(kit::SystemItem::FlexibleSpace), _moveButton});
}

bool MoveTargetScreen::backRequested()
{
    // Every screen of the picker has a Cancel button, which the default would press. Below the first screen,
    // going back leads to the folder above instead.
    const auto picker = _picker.lock();
    if (!picker || picker->viewControllers().front() != shared_from_this())
        return false;
    return kit::ViewController::backRequested();
}

void MoveTargetScreen::snapshotArrived(const std::shared_ptr<const FolderSnapshot>& snapshot)
{
    const auto before = _rows->ids();
    _rows->setSnapshot(snapshot);
    const auto after = _rows->ids();
    if (std::max(before.size(), after.size()) <= differenceLimit)
        _listView->apply(kit::ListChanges::between(before, after));
    else
        _listView->reloadAll();
    const auto picker = _picker.lock();
    const bool hasFailed = snapshot->stage() == ListingStage::Failed;
    _moveButton->setEnabled(!hasFailed && picker && picker->canChoose(_folder));
    showState(hasFailed ? snapshot->error() : std::nullopt);
    takeKeyboard();
}

void MoveTargetScreen::showState(const std::optional<Error>& error)
{
    _placeholder->setHidden(!_rows->ids().empty());
    if (error)
        _placeholder->setContent({.iconName = "dialog-warning-symbolic",
            .title = localized("This folder cannot be shown"),
            .message = errorWords(*error)});
    else
        _placeholder->setContent({.iconName = "folder-open-symbolic",
            .title = localized("No folders here"),
            .message = _moveButton->isEnabled()
                ? localized("Move the items into this folder, or make a new folder for them.")
                : localized("Make a new folder for the items, or go back to another one.")});
}

void MoveTargetScreen::findRecents()
{
    const auto picker = _picker.lock();
    if (!picker || picker->topViewController() != shared_from_this())
        return;
    std::vector<Url> candidates;
    for (const auto& folder : RecentMoveTargets::folders()) {
        if (picker->offers(folder) && picker->canChoose(folder))
            candidates.push_back(folder);
    }
    const auto main = services().dispatch().mainQueue();
    _queue->addOperation([weak = std::weak_ptr(self()), candidates = std::move(candidates), main] {
        std::vector<Url> present;
        for (const auto& folder : candidates) {
            if (services().fileSystem().typeOfItem(folder.path()) == FileType::Directory
                && present.size() < shownRecents)
                present.push_back(folder);
        }
        if (!present.empty())
            main->async(weakly(weak, &MoveTargetScreen::showRecents, std::move(present)));
    });
}

void MoveTargetScreen::showRecents(std::vector<Url> recents)
{
    _rows->setRecents(std::move(recents));
    _listView->reloadAll();
    _placeholder->setHidden(true);
}

void MoveTargetScreen::rowActivated(kit::ListView&, std::size_t index)
{
    const auto picker = _picker.lock();
    const auto folder = _rows->destination(index);
    if (!picker || !folder)
        return;
    if (_rows->isRecent(index))
        picker->show(*folder);
    else
        picker->enter(*folder);
}

void MoveTargetScreen::askForNewFolder()
{
    const auto alert = makeFolderNameAlert(weakly(this, &MoveTargetScreen::makeFolder));
    presentViewController(alert, true);
}

void MoveTargetScreen::makeFolder(const std::string& name)
{
    const auto made = _folder.appendingPathComponent(name, PathKind::Directory);
    const auto main = services().dispatch().mainQueue();
    _queue->addOperation([weak = std::weak_ptr(self()), made, main] {
        std::optional<Error> failed;
        const auto refused = services().fileCoordinator().coordinateWriting(
            made, WritingOptions::None, [&failed](const Url& location) {
                failed = services().fileChanges().createFolder(location.path());
            });
        main->async(weakly(weak, &MoveTargetScreen::folderWasMade, made, refused ? refused : failed));
    });
}

void MoveTargetScreen::folderWasMade(const Url& made, const std::optional<Error>& error)
{
    const auto picker = _picker.lock();
    if (!error && picker && picker->topViewController() == shared_from_this())
        picker->enter(made);
    if (!error)
        return;
    const auto alert = std::make_shared<kit::AlertController>(
        localized("The folder cannot be made"), errorWords(*error), kit::AlertStyle::Alert);
    alert->addAction(std::make_shared<kit::AlertAction>(localized("OK"), kit::AlertActionStyle::Cancel));
    presentViewController(alert, true);
}

} // namespace screens
