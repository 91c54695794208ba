// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/controllers/BarButtonItem.h"
#include "kit/controllers/ViewController.h"
#include "platform/Error.h"
#include "platform/FileChanges.h"
#include "platform/NotificationCenter.h"
#include "platform/Url.h"
#include "screens/PlatformNames.h"
#include "screens/preview/PreviewControllerProtocols.h"

#include <atomic>
#include <functional>
#include <memory>
#include <optional>
#include <vector>

namespace platform {
class ItemDownload;
class OperationQueue;
struct DownloadProgress;
struct PageMark;
} // namespace platform

namespace kit {
class AlertController;
class NavigationController;
} // namespace kit

namespace screens {

class PreviewScreenView;
class PreviewEditing;
class PreviewEditor;
class PlaceholderView;
class PreviewView;
struct EditsKept;
struct PreviewContent;
struct PreviewLimits;

/// The screen that shows one document: a picture, a text, pages, a sound or a film. For every other type it
/// shows the icon with name, kind and size. Content is read off the main thread, within limits (see
/// PreviewLoader). Main thread only.
class PreviewController : public kit::ViewController {
public:
    PreviewController();
    ~PreviewController() override;

    void setDataSource(std::weak_ptr<PreviewControllerDataSource> dataSource);
    void setDelegate(std::weak_ptr<PreviewControllerDelegate> delegate) { _delegate = std::move(delegate); }

    /// Asks the data source again and shows its first document.
    void reloadData();
    /// Reads the current document again. The old content stays on the screen until the new one is there; the
    /// page, the zoom and the place are kept.
    void refreshCurrentPreviewItem();
    /// Answers the document as of the last reload, or nothing when the data source has none.
    const std::optional<Url>& currentPreviewItem() const { return _item; }

    /// The buttons at the right end of the navigation bar, the first one at the edge.
    const kit::BarButtonItems& additionalRightBarButtonItems() const { return _additionalItems; }
    void setAdditionalRightBarButtonItems(kit::BarButtonItems items);

    /// Opens a document in another app, with a popover at a view of the screen. Without a handler no such
    /// button is offered.
    using OpenInHandler = std::function<void(const Url& item, const std::shared_ptr<kit::View>& from)>;
    void setOpenInHandler(OpenInHandler handler);

    void loadView() override;
    void viewDidLoad() override;
    void viewWillAppear(bool animated) override;
    void viewDidAppear(bool animated) override;
    void viewDidDisappear(bool animated) override;
    void didMoveToParentViewController(const std::shared_ptr<ViewController>& parent) override;
    bool backRequested() override;

    /// Answers the content that is shown, or null until there is one.
    const std::shared_ptr<const PreviewContent>& content() const { return _content; }
    /// Answers the view of the document's content, or null when the content has no view.
    const std::shared_ptr<PreviewView>& previewView() const { return _previewView; }
    const std::shared_ptr<PreviewScreenView>& screenView() const { return _screen; }

    void beginSearch();
    void endSearch();

    /// Answers whether the user may change the document, which both the delegate and the document have to
    /// allow.
    bool canEdit() const;
    void beginEditing();
    /// Keeps the edits and stops changing the document.
    void endEditing();
    /// Keeps the edits that were made so far and goes on changing the document.
    void keepEdits();
    /// Answers null unless the document is being changed.
    const std::shared_ptr<PreviewEditor>& editor() const { return _editor; }

    bool isDownloading() const { return _download != nullptr; }
    void startDownload();
    void cancelDownload();

private:
    using Token = std::shared_ptr<std::atomic<bool>>; ///< true: the load is cancelled

    void load(const PreviewLimits& limits);
    void cancelLoad();
    void show(std::shared_ptr<const PreviewContent> content);
    void showContent();
    void showPreview(const std::shared_ptr<PreviewView>& preview);
    void showSummary();
    void showDownload(const DownloadProgress& progress);
    void downloadEnded(const std::optional<Error>& error);
    void leaveDownload();
    void editingBegan(const Result<std::shared_ptr<PreviewEditing>>& begun);
    void showEditBars();
    void connectPages();
    void showNote(const std::optional<PageMark>& mark);
    void removeEditor();
    void leaveEditing(const std::optional<Url>& newItem = std::nullopt);
    void keep(const std::shared_ptr<PreviewEditing>& editing);
    void keepLate(const std::shared_ptr<PreviewEditing>& editing);
    void kept(const std::shared_ptr<PreviewEditing>& editing, const EditsKept& outcome);
    using KeptHandler = void (PreviewController::*)(const std::shared_ptr<PreviewEditing>&, const EditsKept&);
    bool keepsRest(const std::shared_ptr<PreviewEditing>& editing, KeptHandler told);
    void askForUnsaved(const std::shared_ptr<PreviewEditing>& editing);
    void addCopyAndDiscard(kit::AlertController& question, const std::shared_ptr<PreviewEditing>& editing);
    void keptCopy(const std::shared_ptr<PreviewEditing>& editing, const EditsKept& outcome);
    void showOnDisk(const std::shared_ptr<PreviewEditing>& editing);
    void askAfterFailure(const std::shared_ptr<PreviewEditing>& editing, const EditsKept& outcome);
    void followChange();
    void itemChecked(const std::shared_ptr<PreviewEditing>& editing, bool isChanged);
    void programEnds();
    void alert(const std::shared_ptr<kit::ViewController>& alert);
    bool shouldSave(const Url& item);
    void startAgain();
    void openIn();
    void updateBars();
    void showNothing();
    void showLoadingAfterDelay();
    void forgetContent();
    void close();
    void connectPreview();
    void showToolbar();
    void previewFailed(const std::string& words);
    std::shared_ptr<const PreviewContent> withoutPlayer(std::shared_ptr<const PreviewContent> content) const;
    std::shared_ptr<PreviewController> self();

    std::weak_ptr<PreviewControllerDataSource> _dataSource;
    std::weak_ptr<PreviewControllerDelegate> _delegate;
    OpenInHandler _openIn;
    std::optional<Url> _item;
    std::shared_ptr<const PreviewContent> _content;
    std::shared_ptr<PreviewScreenView> _screen;
    std::shared_ptr<PreviewView>
        _previewView; ///< kept while a failure is shown, because it knows the place in the document
    std::shared_ptr<PlaceholderView> _summary; ///< shown in place of content
    std::unique_ptr<ItemDownload> _download;
    std::shared_ptr<PreviewEditor> _editor;
    std::vector<std::shared_ptr<PreviewEditing>>
        _edited; ///< the documents whose edits may not be on the disk yet
    bool _isEditingWanted = false; ///< the document is being read so that it can be changed
    std::optional<ItemVersion>
        _savedVersion; ///< the version that was saved here, which the screen already shows
    std::weak_ptr<kit::NavigationController> _lastNavigation; ///< where a later failure is reported
    std::vector<Observation> _observations;
    bool _isDownloadWanted = true; ///< false once the user has stopped the download
    kit::BarButtonItems _additionalItems;
    std::shared_ptr<OperationQueue> _queue;
    Token _cancelled;
    unsigned _generation = 0; ///< number of the latest load; the result of an older one is ignored
};

} // namespace screens
