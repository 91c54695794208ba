// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/preview/PreviewController.h"

#include "kit/controllers/NavigationController.h"
#include "kit/controllers/NavigationItem.h"
#include "kit/views/Button.h"
#include "kit/views/TextField.h"
#include "platform/Dispatch.h"
#include "platform/FileChanges.h"
#include "platform/ItemDownload.h"
#include "platform/Localization.h"
#include "platform/Services.h"
#include "platform/Weakly.h"
#include "screens/DisplayName.h"
#include "screens/PlaceholderView.h"
#include "screens/preview/PreviewEditor.h"
#include "screens/preview/PreviewLoader.h"
#include "screens/preview/PreviewPictureView.h"
#include "screens/preview/PreviewScreenView.h"
#include "screens/preview/PreviewSearchBar.h"
#include "screens/preview/PreviewToolbar.h"
#include "screens/preview/PreviewViewChoice.h"

#include <algorithm>
#include <chrono>
#include <utility>

namespace screens {

namespace {

/// The screen shows that it is loading only after this time, because a short flash would disturb.
constexpr auto loadingDelay = std::chrono::milliseconds(300);

std::shared_ptr<PlaceholderView> summaryView(const PlaceholderView::Content& content)
{
    const auto view = PlaceholderView::create();
    view->setContent(content);
    return view;
}

bool isMedia(const PreviewContent& content)
{
    return content.kind == PreviewContent::Kind::Sound || content.kind == PreviewContent::Kind::Film;
}

} // namespace

PreviewController::PreviewController() = default;

PreviewController::~PreviewController()
{
    cancelLoad();
}

std::shared_ptr<PreviewController> PreviewController::self()
{
    return std::static_pointer_cast<PreviewController>(shared_from_this());
}

void PreviewController::setDataSource(std::weak_ptr<PreviewControllerDataSource> dataSource)
{
    _dataSource = std::move(dataSource);
}

void PreviewController::setAdditionalRightBarButtonItems(kit::BarButtonItems items)
{
    _additionalItems = std::move(items);
    navigationItem().setRightItems(_additionalItems);
}

void PreviewController::setOpenInHandler(OpenInHandler handler)
{
    _openIn = std::move(handler);
    if (_content)
        showContent();
}

void PreviewController::loadView()
{
    _screen = PreviewScreenView::create();
    _screen->toolbar()->setOnFind(weakly(this, &PreviewController::beginSearch));
    _screen->toolbar()->setOnEdit(weakly(this, &PreviewController::beginEditing));
    _screen->searchBar()->setOnClose(weakly(this, &PreviewController::endSearch));
    setView(_screen);
}

void PreviewController::viewDidLoad()
{
    if (_content)
        showContent();
    else if (_item)
        showLoadingAfterDelay();
    else
        showNothing();
}

void PreviewController::viewWillAppear(bool animated)
{
    ViewController::viewWillAppear(animated);
    // The content was dropped or its load was cancelled when the user left the screen.
    if (_item && !_content && (!_cancelled || *_cancelled)) {
        load(previewLimitsForMainScreen());
        showLoadingAfterDelay();
    }
}

void PreviewController::viewDidAppear(bool animated)
{
    ViewController::viewDidAppear(animated);
    if (_content)
        startDownload();
}

void PreviewController::viewDidDisappear(bool animated)
{
    ViewController::viewDidDisappear(animated);
    if (_previewView)
        _previewView->stop();
    // A screen that only lies under another one keeps its content and its place.
    const auto navigation = navigationController();
    if (!navigation || std::ranges::count(navigation->viewControllers(), shared_from_this()) == 0)
        close();
}

void PreviewController::didMoveToParentViewController(const std::shared_ptr<ViewController>& parent)
{
    ViewController::didMoveToParentViewController(parent);
    if (!parent)
        close();
    else if (_screen)
        showToolbar();
}

/// Ends all work and keeps nothing of the document except its URL.
void PreviewController::close()
{
    leaveEditing();
    cancelLoad();
    leaveDownload();
    forgetContent();
}

bool PreviewController::backRequested()
{
    if (_editor && _editor->backRequested())
        return true;
    if (!_screen || !_screen->isSearching())
        return ViewController::backRequested();
    endSearch();
    return true;
}

void PreviewController::reloadData()
{
    const auto source = _dataSource.lock();
    const bool hasItem = source && source->numberOfPreviewItemsInPreviewController(*this) > 0;
    const auto next =
        hasItem ? std::optional(source->previewControllerPreviewItemAtIndex(*this, 0)) : std::nullopt;
    leaveEditing(next);
    _item = next;
    cancelLoad();
    leaveDownload();
    forgetContent();
    setTitle(_item ? displayName(_item->lastPathComponent()) : std::string());
    if (!_item)
        return showNothing();
    load(previewLimitsForMainScreen());
    showLoadingAfterDelay();
}

void PreviewController::refreshCurrentPreviewItem()
{
    if (_editor)
        followChange();
    else if (_item)
        load(previewLimitsForMainScreen());
}

void PreviewController::cancelLoad()
{
    ++_generation;
    if (_cancelled)
        *_cancelled = true;
    // Work that has not begun is dropped with its queue.
    _queue = nullptr;
}

void PreviewController::load(const PreviewLimits& limits)
{
    cancelLoad();
    _cancelled = std::make_shared<std::atomic<bool>>(false);
    const auto main = services().dispatch().mainQueue();
    _queue = services().dispatch().makeOperationQueue("preview", QualityOfService::UserInitiated);
    _queue->addOperation([weak = std::weak_ptr(self()), item = *_item, limits, generation = _generation, main,
                             cancelled = _cancelled, saved = _savedVersion] {
        // The screen already shows the version that was saved here.
        if (*cancelled || (saved && services().fileChanges().versionOfItem(item.path()) == saved))
            return;
        const auto content = std::make_shared<const PreviewContent>(
            loadPreview(item, limits, [&] { return cancelled->load(); }));
        main->async(weakly(weak, [content, generation](PreviewController& self) {
            if (self._generation == generation)
                self.show(content);
        }));
    });
}

void PreviewController::forgetContent()
{
    _content = nullptr;
    _previewView = nullptr;
    _savedVersion.reset();
    if (!_screen)
        return;
    _screen->setSearching(false);
    _screen->searchBar()->field()->setText({});
    _screen->setContent(nullptr);
    connectPreview();
}

std::shared_ptr<const PreviewContent> PreviewController::withoutPlayer(
    std::shared_ptr<const PreviewContent> content) const
{
    const auto delegate = _delegate.lock();
    if (!isMedia(*content) || !delegate || delegate->previewControllerWantsDefaultMediaPlayer(*this, *_item))
        return content;
    auto summary = *content;
    summary.kind = PreviewContent::Kind::Summary;
    return std::make_shared<const PreviewContent>(std::move(summary));
}

void PreviewController::show(std::shared_ptr<const PreviewContent> content)
{
    _content = withoutPlayer(std::move(content));
    _savedVersion.reset();
    setTitle(_content->title);
    showContent();
}

void PreviewController::showContent()
{
    // The view is not loaded yet; viewDidLoad shows the content later.
    if (!isViewLoaded())
        return;
    if (const auto preview = previewViewFor(*_content, _previewView))
        showPreview(preview);
    else if (!_download)
        showSummary();
    // The download waits until the screen has appeared, because a user who only passes by has not asked for
    // it.
    if (appearanceState() == kit::AppearanceState::Appeared)
        startDownload();
}

void PreviewController::showPreview(const std::shared_ptr<PreviewView>& preview)
{
    _previewView = preview;
    // The note of a recording would repeat its kind and size, so it is left out.
    _screen->setNote(isMedia(*_content) ? std::string() : _content->note);
    _screen->setContent(preview);
    connectPreview();
}

/// A preview in miniature has no toolbar, because the user only looks at it.
void PreviewController::showToolbar()
{
    const bool isMiniature = parent() && !navigationController();
    _screen->toolbar()->setHidden(isMiniature || _editor || _screen->toolbar()->isEmpty());
    _screen->setNeedsLayout();
}

void PreviewController::connectPreview()
{
    const auto shown = _screen->content() == _previewView ? _previewView : nullptr;
    _screen->toolbar()->setPreview(shown);
    _screen->toolbar()->setCanEdit(canEdit());
    showToolbar();
    _screen->searchBar()->setPreview(shown);
    _screen->setNeedsLayout();
    if (!shown)
        return;
    shown->setOnStateChange(weakly(this, &PreviewController::updateBars));
    shown->setOnFind(weakly(this, &PreviewController::beginSearch));
    shown->setOnFailure(weakly(this, &PreviewController::previewFailed));
    connectPages();
    if (const auto picture = std::dynamic_pointer_cast<PreviewPictureView>(shown))
        picture->setOnNeedsPixels(
            weakly(this, [](PreviewController& self) { self.load(previewLimitsForCloseLook()); }));
}

void PreviewController::updateBars()
{
    _screen->toolbar()->update();
    _screen->searchBar()->update();
    if (_editor)
        _editor->update();
}

void PreviewController::previewFailed(const std::string& words)
{
    auto failure = *_content;
    failure.kind = PreviewContent::Kind::Failure;
    failure.note = words;
    show(std::make_shared<const PreviewContent>(std::move(failure)));
}

void PreviewController::showSummary()
{
    _summary =
        summaryView({.iconName = _content->iconName, .title = _content->title, .message = _content->note});
    std::vector<PlaceholderView::Action> actions;
    if (_content->kind == PreviewContent::Kind::InCloud)
        actions.push_back({localized("Download"), weakly(this, &PreviewController::startAgain), true});
    else if (_content->canRetry)
        actions.push_back({localized("Try Again"), weakly(this, &PreviewController::startAgain), true});
    else if (_openIn)
        actions.push_back({localized("Open in…"), weakly(this, &PreviewController::openIn), true});
    _summary->setActions(actions);
    _screen->setSearching(false);
    _screen->setNote({});
    _screen->setContent(_summary);
    connectPreview();
}

void PreviewController::openIn()
{
    if (!_item || !_openIn)
        return;
    std::shared_ptr<kit::View> from = view();
    if (_summary && !_summary->buttons().empty())
        from = _summary->buttons().front();
    _openIn(*_item, from);
}

void PreviewController::showNothing()
{
    if (_screen)
        _screen->setContent(summaryView({.title = localized("Nothing to show")}));
}

void PreviewController::showLoadingAfterDelay()
{
    auto& dispatch = services().dispatch();
    dispatch.after(
        loadingDelay, dispatch.mainQueue(), weakly(this, [generation = _generation](PreviewController& self) {
            if (self._generation == generation && !self._content && self._screen)
                self._screen->setContent(summaryView({.message = localized("Loading…"), .isBusy = true}));
        }));
}

void PreviewController::beginSearch()
{
    if (!_screen || !_previewView || _screen->content() != _previewView || !_previewView->canSearch())
        return;
    _screen->setSearching(true);
    _screen->searchBar()->field()->becomeFirstResponder();
    if (_previewView->query().empty() && !_screen->searchBar()->field()->text().empty())
        _previewView->setQuery(_screen->searchBar()->field()->text());
}

void PreviewController::endSearch()
{
    if (!_screen || !_screen->isSearching())
        return;
    _screen->searchBar()->field()->resignFirstResponder();
    _screen->setSearching(false);
    if (!_previewView)
        return;
    _previewView->setQuery({});
    _previewView->takeFocus();
}

} // namespace screens
