// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "prompts/DocumentListControllerStatusBar.h"

#include "kit/values/Screen.h"
#include "kit/views/Label.h"
#include "platform/Log.h"
#include "platform/Weakly.h"
#include "prompts/DriveStatusLabelView.h"
#include "screens/StorageUpgradeButton.h"
#include "screens/list/DocumentListController.h"

namespace tarrow {

using kit::BarButtonItem;
using kit::Font;
using kit::SystemItem;
using platform::Operation;
using platform::weakly;
using screens::DocumentListController;
using screens::StorageUpgradeButton;

namespace {

constexpr auto associationKey = "_TarrowDriveAppStatusBar";

using Offer = DocumentListControllerStatusBar::Offer;

bool equal(const Offer& a, const Offer& b)
{
    return a && b ? *a == *b : a == b;
}

bool isToBeShown(const Offer& offer)
{
    return offer && StorageUpgradeButton::shouldShowForOffer(offer);
}

std::shared_ptr<kit::Label> makePrimaryLabel()
{
    auto label = std::make_shared<kit::Label>();
    // The toolbar does not grow with the user's text size, so the font of its line does not either.
    label->setFont(Font::preferred(kit::TextStyle::Caption2).fixed());
    label->setTextColor(platform::Color::black());
    label->sizeToFit();
    return label;
}

} // namespace

void DocumentListControllerStatusBar::createStatusBarButtonPressDelegate(
    const Offer& offer, const std::shared_ptr<DocumentListControllerStatusBarDelegate>& delegate)
{
    _delegate = delegate;
    const auto& screen = kit::Screen::main();
    _labelsView = DriveStatusLabelView::initWithFrame(screen ? screen->statusBarFrame : platform::Rect{});
    configureLabels(offer);
    _toolbarItems = {std::make_shared<BarButtonItem>(SystemItem::FlexibleSpace),
        std::make_shared<BarButtonItem>(_labelsView),
        std::make_shared<BarButtonItem>(SystemItem::FlexibleSpace)};
}

void DocumentListControllerStatusBar::configureLabels(const Offer& offer)
{
    _labelsView->setPrimaryLabel(makePrimaryLabel());
    _labelsView->addSubview(_labelsView->primaryLabel());

    const auto button = StorageUpgradeButton::createButton();
    button->setOffer(offer);
    button->setAction(weakly(this, [pressed = std::weak_ptr(button)](DocumentListControllerStatusBar& self) {
        if (const auto sender = pressed.lock())
            self.upgradeStoragePressed(*sender);
    }));
    button->sizeToFit();
    button->setHidden(true);
    _labelsView->setQuotaButton(button);
    _labelsView->addSubview(button);
    _labelsView->showLowQuota(isToBeShown(offer));
}

void DocumentListControllerStatusBar::setStatusText(const std::string& text)
{
    _labelsView->setPrimaryLabelText(text);
}

void DocumentListControllerStatusBar::showUpgradeOffer(const Offer& offer)
{
    const auto& button = _labelsView->quotaButton();
    if (!equal(button->offer(), offer))
        button->setOffer(offer);
    _labelsView->showLowQuota(isToBeShown(offer));
}

void DocumentListControllerStatusBar::showProgress(const std::string& text, std::function<void()> cancel)
{
    if (text.empty()) {
        _progressItems.clear();
        return;
    }
    if (_progressItems.empty()) {
        _progressView = DriveStatusLabelView::initWithFrame(_labelsView->frame());
        _progressView->setPrimaryLabel(makePrimaryLabel());
        _progressView->addSubview(_progressView->primaryLabel());
        _progressItems = {std::make_shared<BarButtonItem>(SystemItem::FlexibleSpace),
            std::make_shared<BarButtonItem>(_progressView),
            std::make_shared<BarButtonItem>(SystemItem::FlexibleSpace),
            std::make_shared<BarButtonItem>(SystemItem::Cancel)};
    }
    _progressView->setPrimaryLabelText(text);
    _progressItems.back()->setAction([cancel = std::move(cancel)](const auto&) { cancel(); });
}

void DocumentListControllerStatusBar::upgradeStoragePressed(const StorageUpgradeButton& button)
{
    static constexpr Operation op{"-[DocumentListControllerStatusBar upgradeStoragePressed:]"};
    op.userAction("Pressed Upgrade Storage");
    const auto link = button.link();
    op.info("UpgradeStorage button pressed, link.action=%{public}@", link.action());
    if (link.performDefaultAction()) {
        op.info("UpgradeStorage button pressed, launched default action (Manage Storage?)");
        return;
    }
    const auto delegate = _delegate.lock();
    if (delegate && link.action() == platform::StorageOfferLink::actionUpgradeInApplication)
        delegate->upgradeStorageButtonPressed();
}

std::shared_ptr<DocumentListControllerStatusBar> statusBar(const DocumentListController& list)
{
    return list.associatedObject<DocumentListControllerStatusBar>(associationKey);
}

void setStatusBar(DocumentListController& list, std::shared_ptr<DocumentListControllerStatusBar> statusBar)
{
    list.setAssociatedObject(associationKey, std::move(statusBar));
}

void createStatusBarButtonPressDelegate(DocumentListController& list, const Offer& offer,
    const std::shared_ptr<DocumentListControllerStatusBarDelegate>& delegate)
{
    const auto created = std::make_shared<DocumentListControllerStatusBar>();
    setStatusBar(list, created);
    created->createStatusBarButtonPressDelegate(offer, delegate);
}

void displayStatusBar(DocumentListController& list)
{
    const auto shown = statusBar(list);
    if (!shown)
        return;
    auto items = shown->progressItems().empty() ? shown->toolbarItems() : shown->progressItems();
    if (shown->progressItems().empty() && shown->sideButton())
        items.push_back(shown->sideButton());
    list.setToolbarItems(std::move(items));
}

} // namespace tarrow
