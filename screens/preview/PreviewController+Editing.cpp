// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This file lets the user change the document that is shown, and keeps the edits.

#include "kit/controllers/NavigationController.h"
#include "platform/Localization.h"
#include "platform/Services.h"
#include "platform/Weakly.h"
#include "screens/AlertParts.h"
#include "screens/DisplayName.h"
#include "screens/ErrorWords.h"
#include "screens/preview/PreviewContent.h"
#include "screens/preview/PreviewController.h"
#include "screens/preview/PreviewEditor.h"
#include "screens/preview/PreviewFieldBar.h"
#include "screens/preview/PreviewLoader.h"
#include "screens/preview/PreviewPagesView.h"
#include "screens/preview/PreviewScreenView.h"
#include "screens/preview/PreviewToolbar.h"

#include <algorithm>
#include <cerrno>
#include <utility>

namespace screens {

namespace {

using Editing = std::shared_ptr<PreviewEditing>;

std::string whyNotChanged(const Error& error)
{
    const bool isDamaged =
        error.domain() == errorDomain::pages && error.code() == static_cast<int>(PagesErrorCode::Damaged);
    if (isDamaged)
        return localized("The document is damaged. It can be read, but not changed.");
    if (error.domain() == errorDomain::system && error.code() == EFBIG)
        return localized("The document is too large to be changed here.");
    return errorWords(error);
}

std::string nameOf(const Url& url)
{
    return displayName(url.lastPathComponent());
}

} // namespace

bool PreviewController::canEdit() const
{
    const auto delegate = _delegate.lock();
    const bool isAllowed = _content && _content->kind == PreviewContent::Kind::Pages
        && (_content->rights.canFillForms || _content->rights.canMark);
    return isAllowed && _item && delegate && delegate->previewControllerCanEditItem(*this, *_item);
}

bool PreviewController::shouldSave(const Url& item)
{
    const auto delegate = _delegate.lock();
    return delegate && delegate->previewControllerShouldSaveEditedItem(*this, item);
}

void PreviewController::beginEditing()
{
    if (_editor || _isEditingWanted || !canEdit())
        return;
    _isEditingWanted = true;
    _lastNavigation = navigationController();
    PreviewEditing::begin(*_item,
        weakly(this, [generation = _generation](PreviewController& self, const Result<Editing>& begun) {
            if (std::exchange(self._isEditingWanted, false) && self._generation == generation)
                self.editingBegan(begun);
        }));
}

void PreviewController::editingBegan(const Result<Editing>& begun)
{
    const auto pages = std::dynamic_pointer_cast<PreviewPagesView>(_previewView);
    if (!pages || !_item)
        return;
    if (!begun)
        return alert(
            messageAlert(localized("“%@” cannot be changed", {nameOf(*_item)}), whyNotChanged(*begun.error)));
    const auto& editing = *begun.value;
    // A load that is under way would replace the document being changed by the one without edits.
    cancelLoad();
    const auto& shown = _savedVersion ? _savedVersion : _content->version;
    if (shown == editing->versionRead())
        pages->continueWith(editing->pages());
    else
        pages->setDocument(editing->pages(), editing->pages()->pageSize(0));
    _editor = PreviewEditor::create(editing, pages,
        {.present = weakly(this, &PreviewController::alert),
            .layoutDidChange = weakly(this, &PreviewController::showEditBars),
            .done = weakly(this, &PreviewController::endEditing),
            .editedLate = weakly(this, &PreviewController::keepLate)});
    _edited.push_back(editing);
    auto& center = services().notificationCenter();
    _observations.clear();
    for (const auto notice :
        {Notification::ApplicationDidLoseFocus, Notification::ApplicationWillResignActive})
        _observations.push_back(center.observe(notice, weakly(this, &PreviewController::keepEdits)));
    _observations.push_back(center.observe(
        Notification::ApplicationWillTerminate, weakly(this, &PreviewController::programEnds)));
    showEditBars();
    pages->takeFocus();
}

void PreviewController::showEditBars()
{
    if (!_screen)
        return;
    if (_editor)
        _screen->setEditBars(_editor->bar(), _editor->fieldBar());
    else
        _screen->setEditBars(nullptr, nullptr);
    _screen->setNote(_editor ? _editor->hint() : _content ? _content->note : std::string());
    connectPreview();
}

/// Notes can be read also in a document that cannot be changed.
void PreviewController::connectPages()
{
    const auto pages = std::dynamic_pointer_cast<PreviewPagesView>(_previewView);
    if (!pages || _editor)
        return;
    pages->setOnTap(weakly(this, [](PreviewController& self, const PreviewPagesView::PagePlace& place) {
        if (const auto shown = std::dynamic_pointer_cast<PreviewPagesView>(self._previewView))
            shown->findMark(place, weakly(&self, &PreviewController::showNote));
    }));
}

void PreviewController::showNote(const std::optional<PageMark>& mark)
{
    if (mark && !mark->text.empty())
        alert(makeNoteAlert(*mark));
}

void PreviewController::removeEditor()
{
    _isEditingWanted = false;
    if (!_editor)
        return;
    _editor->finishWriting();
    _editor = nullptr;
    showEditBars();
}

void PreviewController::endEditing()
{
    if (!_editor)
        return;
    _editor->finishWriting();
    const auto editing = _editor->editing();
    removeEditor();
    keep(editing);
    if (const auto pages = _previewView)
        pages->takeFocus();
}

void PreviewController::keepEdits()
{
    if (!_editor)
        return;
    _editor->finishWriting();
    if (shouldSave(_editor->editing()->item()))
        keep(_editor->editing());
}

/// Stops changing the document and keeps its edits. `newItem` is shown next, and may be the same document at
/// another place.
void PreviewController::leaveEditing(const std::optional<Url>& newItem)
{
    if (!_editor) {
        _isEditingWanted = false;
        return;
    }
    _editor->finishWriting();
    const auto editing = _editor->editing();
    removeEditor();
    if (newItem)
        editing->follow(*newItem);
    keep(editing);
}

void PreviewController::keep(const Editing& editing)
{
    if (!editing->hasUnsavedEdits()) {
        if (!_editor || _editor->editing() != editing)
            std::erase(_edited, editing);
        return;
    }
    if (!shouldSave(editing->item()))
        return askForUnsaved(editing);
    editing->save(weakly(this, &PreviewController::kept, editing));
}

/// Keeps an edit of a document that is not being changed any more.
void PreviewController::keepLate(const Editing& editing)
{
    if (std::ranges::count(_edited, editing) == 0)
        _edited.push_back(editing);
    keep(editing);
}

void PreviewController::kept(const Editing& editing, const EditsKept& outcome)
{
    const bool isBeingEdited = _editor && _editor->editing() == editing;
    const bool isShown = isBeingEdited || (!_editor && _item == outcome.place);
    if (!isBeingEdited && !editing->hasUnsavedEdits())
        std::erase(_edited, editing);
    switch (outcome.where) {
    case EditsKept::Where::Document:
        if (isShown)
            _savedVersion = outcome.version;
        return;
    case EditsKept::Where::Copy:
        // The document now holds the other program's content, so these edits cannot be continued in it.
        if (keepsRest(editing, &PreviewController::kept))
            return;
        showOnDisk(editing);
        return alert(messageAlert(localized("“%@” was changed by another program", {nameOf(editing->item())}),
            localized("Your changes are kept in a copy, “%@”.", {nameOf(outcome.place)})));
    case EditsKept::Where::Nowhere:
        return askAfterFailure(editing, outcome);
    }
}

/// Stops changing a document whose edits went into a copy, and saves there what was changed meanwhile.
/// Answers false when nothing was.
bool PreviewController::keepsRest(const Editing& editing, KeptHandler told)
{
    if (_editor && _editor->editing() == editing)
        removeEditor();
    // The later save says where the edits are.
    if (editing->isBeingKept())
        return true;
    if (!editing->hasUnsavedEdits())
        return false;
    editing->save(weakly(this, told, editing));
    return true;
}

void PreviewController::askAfterFailure(const Editing& editing, const EditsKept& outcome)
{
    if (std::ranges::count(_edited, editing) == 0)
        _edited.push_back(editing);
    const auto question = std::make_shared<kit::AlertController>(
        localized("“%@” could not be saved", {nameOf(editing->item())}),
        outcome.error ? whyNotChanged(*outcome.error) : std::string(), kit::AlertStyle::Alert);
    question->addAction(alertAction(localized("Try Again"), kit::AlertActionStyle::Default,
        weakly(this, &PreviewController::keep, editing)));
    addCopyAndDiscard(*question, editing);
    alert(question);
}

void PreviewController::askForUnsaved(const Editing& editing)
{
    const auto question = std::make_shared<kit::AlertController>(
        localized("Your changes to “%@” are not saved", {nameOf(editing->item())}), std::string(),
        kit::AlertStyle::Alert);
    addCopyAndDiscard(*question, editing);
    alert(question);
}

void PreviewController::addCopyAndDiscard(kit::AlertController& question, const Editing& editing)
{
    const auto told = weakly(this, &PreviewController::keptCopy, editing);
    question.addAction(alertAction(localized("Keep a Copy"), kit::AlertActionStyle::Default,
        [editing, told] { editing->saveCopy(told); }));
    const auto discarded = weakly(this, &PreviewController::showOnDisk, editing);
    question.addAction(
        alertAction(localized("Discard Changes"), kit::AlertActionStyle::Destructive, [editing, discarded] {
            editing->discard();
            discarded();
        }));
}

void PreviewController::keptCopy(const Editing& editing, const EditsKept& outcome)
{
    if (outcome.where == EditsKept::Where::Nowhere)
        return askAfterFailure(editing, outcome);
    if (keepsRest(editing, &PreviewController::keptCopy))
        return;
    showOnDisk(editing);
    alert(messageAlert(
        localized("Your changes are kept"), localized("They are in a copy, “%@”.", {nameOf(outcome.place)})));
}

/// The edits were saved or discarded. If their document is still shown, it is shown as it is on the disk.
void PreviewController::showOnDisk(const Editing& editing)
{
    std::erase(_edited, editing);
    if (_editor && _editor->editing() == editing)
        removeEditor();
    _savedVersion.reset();
    if (!_editor && _item == editing->item())
        refreshCurrentPreviewItem();
}

/// The document on the disk has changed while it is being changed here.
void PreviewController::followChange()
{
    const auto editing = _editor->editing();
    editing->checkItem(weakly(this, &PreviewController::itemChecked, editing));
}

void PreviewController::itemChecked(const Editing& editing, bool isChanged)
{
    if (!isChanged || !_editor || _editor->editing() != editing)
        return;
    _editor->finishWriting();
    if (!editing->hasUnsavedEdits())
        return showOnDisk(editing);
    _screen->setNote(
        localized("Another program has changed this document. Your changes will go into a copy."));
}

/// The program ends, so the edits are written at once: no alert could ask the user, and no queue would run
/// any more.
void PreviewController::programEnds()
{
    if (_editor)
        _editor->finishWriting();
    for (const auto& editing : std::exchange(_edited, {})) {
        if (editing->hasUnsavedEdits())
            editing->keepNow(shouldSave(editing->item()) ? EditsPlace::Document : EditsPlace::Copy);
    }
}

/// Presents an alert over the current screen, because the user may have left this one before the failure.
void PreviewController::alert(const std::shared_ptr<kit::ViewController>& alert)
{
    const auto own = navigationController();
    if (const auto navigation = own ? own : _lastNavigation.lock())
        navigation->presentViewController(alert, true);
    else
        presentViewController(alert, true);
}

} // namespace screens
