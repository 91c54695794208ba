// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "preview/PreviewDetailsViewController.h"

#include "items/DRItem.h"
#include "items/ItemChange.h"
#include "kit/controllers/NavigationItem.h"
#include "kit/views/TextField.h"
#include "platform/Localization.h"
#include "platform/Log.h"
#include "platform/Weakly.h"
#include "prompts/UIUtils.h"

namespace tarrow {

using kit::BarButtonItem;
using kit::SystemItem;
using kit::TextField;
using platform::localized;
using platform::Operation;
using platform::weakly;

namespace {

constexpr double fullWidthAtRest = -16, fullWidthInEditing = 0; // points

} // namespace

bool PreviewDetailsViewController::textFieldShouldBeginEditing(TextField&)
{
    static constexpr Operation op{"-[PreviewDetailsViewController textFieldShouldBeginEditing:]"};
    const auto shown = item();
    const bool renameable = shown && shown->renameable();
    op.debug("ShouldBeginEditing: %{public}@", renameable);
    return renameable;
}

void PreviewDetailsViewController::textFieldDidBeginEditing(TextField& field)
{
    static constexpr Operation op{"-[PreviewDetailsViewController textFieldDidBeginEditing:]"};
    const auto shown = item();
    op.debug("DidBeginEditing '%@' = '%@'", _originalFilename,
        shown ? std::optional(shown->localizedName()) : std::nullopt);
    if (shown && !shown->hasHiddenExtension())
        UIUtils::setCursorInTextFieldToBeforeExtension(field);
    updateNavBarForRename(true);
    _filenameTextFieldFullWidthConstraint->setConstant(fullWidthInEditing);
}

void PreviewDetailsViewController::updateNavBarForRename(bool renaming)
{
    if (renaming == _barIsForRename)
        return;
    _barIsForRename = renaming;
    auto& bar = navigationItem();
    bar.setTitle(renaming ? localized("Rename File") : std::string());
    bar.setLeftItemsSupplementBackButton(renaming);
    bar.setHidesBackButton(renaming);
    if (!renaming) {
        offerMenu();
        bar.setLeftItems({});
        bar.setRightItems(std::exchange(_originalRightBarButtonItems, {}));
        return;
    }
    _originalRightBarButtonItems = bar.rightItems();
    bar.setMenu({}, nullptr);
    bar.setLeftItems({std::make_shared<BarButtonItem>(SystemItem::Cancel,
        weakly(this, [](PreviewDetailsViewController& self) { self.forceRenameCancel(); }))});
    bar.setRightItems({std::make_shared<BarButtonItem>(
        SystemItem::Done, weakly(this, [](PreviewDetailsViewController& self) { self.forceRenameDone(); }))});
}

/// The window may change its size class during a renaming, and the base then makes its buttons anew.
void PreviewDetailsViewController::showRightBarButtonItems(kit::BarButtonItems items)
{
    if (_barIsForRename)
        _originalRightBarButtonItems = std::move(items);
    else
        PreviewBaseViewController::showRightBarButtonItems(std::move(items));
}

bool PreviewDetailsViewController::textFieldShouldChangeCharactersInRangeReplacementString(
    TextField& field, const kit::TextRange&, const std::string& replacement)
{
    if (replacement == "\n") {
        field.resignFirstResponder();
        return false;
    }
    // Who goes on typing does not want the editing to end with the name that is being given.
    _endsWhenRenamed = false;
    return true;
}

bool PreviewDetailsViewController::textFieldShouldReturn(TextField& field)
{
    static constexpr Operation op{"-[PreviewDetailsViewController textFieldShouldReturn:]"};
    op.debug("textFieldShouldReturn");
    field.resignFirstResponder();
    return true;
}

void PreviewDetailsViewController::forceRenameDone()
{
    if (_filenameTextField->isEditing())
        _filenameTextField->resignFirstResponder();
}

void PreviewDetailsViewController::forceRenameCancel()
{
    if (_renaming)
        _renaming->cancel();
    _endsWhenRenamed = false;
    _filenameTextField->setText(_originalFilename);
    forceRenameDone();
}

void PreviewDetailsViewController::viewWasTapped()
{
    forceRenameDone();
}

bool PreviewDetailsViewController::textFieldShouldEndEditing(TextField& field)
{
    static constexpr Operation op{"-[PreviewDetailsViewController textFieldShouldEndEditing:]"};
    op.debug("ShouldEndEditing: old:'%@', new:'%@'", _originalFilename, field.text());
    if (presentedViewController())
        return true;
    if (field.text().empty())
        field.setText(_originalFilename);
    if (field.text() == _originalFilename)
        return true;
    const auto shown = item();
    if (!shown)
        return true;
    _endsWhenRenamed = true;
    if (!_renaming)
        rename(shown->url(), field.text());
    return false;
}

void PreviewDetailsViewController::rename(const platform::Url& url, const std::string& name)
{
    _givenName = UIUtils::computeNewURLNewBasename(url, name).lastPathComponent();
    _renaming = UIUtils::renameItemAtURLToNameCompletion(
        url, name, weakly(this, &PreviewDetailsViewController::renameEnded, name), undoHistory());
}

/// The field may show another text meanwhile: who cancelled sees the item's real name, and who typed on keeps
/// what was typed.
void PreviewDetailsViewController::renameEnded(
    const std::string& name, const std::optional<platform::Error>& error)
{
    _renaming.reset();
    auto& field = *_filenameTextField;
    if (error) {
        const bool isAwaited = std::exchange(_endsWhenRenamed, false);
        if (isAwaited || !error->is(platform::FileErrorCode::Cancelled))
            UIUtils::showFriendlyRenameErrorBasenameParentViewController(*error, name, self());
        return;
    }
    _originalFilename = name;
    if (!field.isEditing())
        field.setText(name);
    else if (std::exchange(_endsWhenRenamed, false))
        field.resignFirstResponder();
}

void PreviewDetailsViewController::textFieldDidEndEditing(TextField& field)
{
    static constexpr Operation op{"-[PreviewDetailsViewController textFieldDidEndEditing:]"};
    op.debug("DidEndEditing: old:'%@', new:'%@'", _originalFilename, field.text());
    updateNavBarForRename(false);
    _filenameTextFieldFullWidthConstraint->setConstant(fullWidthAtRest);
}

} // namespace tarrow
