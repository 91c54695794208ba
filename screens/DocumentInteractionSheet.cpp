// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/DocumentInteractionSheet.h"

#include "kit/controllers/AlertController.h"
#include "kit/controllers/Window.h"
#include "platform/DocumentSharing.h"
#include "platform/FileSystem.h"
#include "platform/Localization.h"
#include "platform/Services.h"
#include "screens/ErrorWords.h"
#include "screens/FolderPlaces.h"

#include <algorithm>
#include <utility>

namespace screens {

namespace {

using kit::AlertAction;
using kit::AlertActionStyle;
using kit::AlertController;

/// Answers the apps that can open a document in its place, without this program. Apps that own the document's
/// type come first.
std::vector<AppHandle> appsFor(const Url& document)
{
    const auto& registry = services().appRegistry();
    std::vector<AppHandle> apps;
    for (const auto& [rank, ranked] : registry.availableApps({document})) {
        for (const auto& app : ranked) {
            const bool isKnown = std::ranges::find(apps, app) != apps.end();
            if (app.supportsOpenInPlace && !isKnown && app.bundleIdentifier != registry.ownBundleIdentifier())
                apps.push_back(app);
        }
    }
    return apps;
}

} // namespace

std::shared_ptr<DocumentInteractionSheet> DocumentInteractionSheet::interactionControllerWithURL(
    const Url& url)
{
    return interactionControllerWithURLFacts(url, lookUp(url));
}

std::shared_ptr<DocumentInteractionSheet> DocumentInteractionSheet::interactionControllerWithURLFacts(
    const Url& url, ItemFacts facts)
{
    return std::make_shared<DocumentInteractionSheet>(url, std::move(facts));
}

DocumentInteractionSheet::ItemFacts DocumentInteractionSheet::lookUp(const Url& url)
{
    return {folderTitle(url), services().fileSystem().typeOfItem(url.path())};
}

DocumentInteractionSheet::DocumentInteractionSheet(Url url, ItemFacts facts)
    : _url(std::move(url))
    , _facts(std::move(facts))
{
}

bool DocumentInteractionSheet::openDocumentInPlaceInApp(const AppHandle& app) const
{
    return contentIsHere() && services().appRegistry().openInPlace(_url, app);
}

void DocumentInteractionSheet::presentOptionsMenuFromRectInView(
    const std::shared_ptr<kit::ViewController>& presenter, const Rect& rect,
    const std::shared_ptr<kit::View>& view, bool animated)
{
    present(presenter, kit::ViewAnchor{view, rect}, animated);
}

void DocumentInteractionSheet::presentOptionsMenuFromBarButtonItem(
    const std::shared_ptr<kit::ViewController>& presenter, const std::shared_ptr<kit::BarButtonItem>& item,
    bool animated)
{
    present(presenter, std::weak_ptr(item), animated);
}

void DocumentInteractionSheet::present(
    const std::shared_ptr<kit::ViewController>& presenter, kit::PopoverAnchor anchor, bool animated)
{
    _presenter = presenter;
    _anchor = std::move(anchor);
    showMenu(makeMenu(contentIsHere() ? appsFor(_url) : Apps()), animated);
}

void DocumentInteractionSheet::showMenu(const std::shared_ptr<AlertController>& menu, bool animated)
{
    const auto presenter = _presenter.lock();
    if (!presenter)
        return;
    menu->setPopoverAnchor(_anchor);
    presenter->presentViewController(menu, animated);
}

std::shared_ptr<AlertController> DocumentInteractionSheet::makeMenu(Apps apps)
{
    const bool isHere = contentIsHere();
    const auto menu = std::make_shared<AlertController>(_facts.name,
        isHere ? std::string() : localized("The content is in the cloud. Open the document to download it."),
        kit::AlertStyle::ActionSheet);
    for (std::size_t i = 0; i < std::min(apps.size(), directApps); ++i)
        addApp(*menu, apps[i]);
    if (apps.size() > directApps)
        menu->addAction(std::make_shared<AlertAction>(localized("Other Apps…"), AlertActionStyle::Default,
            [self = shared_from_this(), others = Apps(apps.begin() + directApps, apps.end())](
                const auto&) { self->showMenu(self->makeAppMenu(others), true); }));
    auto& sharing = services().documentSharing();
    const bool isDocument = _facts.type == FileType::Regular;
    if (isDocument && sharing.canSendByMail())
        add(*menu, localized("Send by Mail"), &DocumentInteractionSheet::sendByMail);
    add(*menu, localized("Copy Path"), &DocumentInteractionSheet::copyPath);
    add(*menu, localized("Copy Link"), &DocumentInteractionSheet::copyLink);
    if (isHere)
        add(*menu, localized("Show in File Manager"), &DocumentInteractionSheet::showInFileManager);
    if (isDocument && sharing.canPrint(_url))
        add(*menu, localized("Print"), &DocumentInteractionSheet::print);
    addCancel(*menu);
    return menu;
}

std::shared_ptr<AlertController> DocumentInteractionSheet::makeAppMenu(const Apps& apps)
{
    const auto menu =
        std::make_shared<AlertController>(_facts.name, std::string(), kit::AlertStyle::ActionSheet);
    for (const auto& app : apps)
        addApp(*menu, app);
    addCancel(*menu);
    return menu;
}

void DocumentInteractionSheet::addApp(AlertController& menu, const AppHandle& app)
{
    menu.addAction(std::make_shared<AlertAction>(localized("Open in %@", {app.localizedName}),
        AlertActionStyle::Default, [self = shared_from_this(), app](const auto&) { self->openIn(app); }));
}

void DocumentInteractionSheet::add(AlertController& menu, const std::string& title, Action action)
{
    menu.addAction(std::make_shared<AlertAction>(
        title, AlertActionStyle::Default, [self = shared_from_this(), action](const auto&) {
            (self.get()->*action)();
            self->ended();
        }));
}

void DocumentInteractionSheet::addCancel(AlertController& menu)
{
    menu.addAction(std::make_shared<AlertAction>(localized("Cancel"), AlertActionStyle::Cancel,
        [self = shared_from_this()](const auto&) { self->ended(); }));
}

void DocumentInteractionSheet::ended()
{
    if (const auto told = _delegate.lock())
        told->documentInteractionControllerDidDismissOptionsMenu(shared_from_this());
}

void DocumentInteractionSheet::openIn(const AppHandle& app)
{
    // The content may have come or gone while the menu was shown.
    _look->begin([url = _url] { return services().fileSystem().typeOfItem(url.path()); },
        [self = shared_from_this(), app](std::optional<FileType> type) {
            self->_facts.type = type;
            if (!self->openDocumentInPlaceInApp(app))
                self->showFailure(localized("%@ could not be started", {app.localizedName}), {});
            self->ended();
        });
}

void DocumentInteractionSheet::sendByMail()
{
    services().documentSharing().sendByMail(_url, reportFailure());
}

void DocumentInteractionSheet::copyPath()
{
    services().documentSharing().copyText(_url.path());
    tell(localized("The path was copied"));
}

void DocumentInteractionSheet::copyLink()
{
    services().documentSharing().copyText(linkToItem(_url));
    tell(localized("The link was copied"));
}

void DocumentInteractionSheet::tell(const std::string& notice)
{
    const auto presenter = _presenter.lock();
    if (const auto shown = presenter ? presenter->window() : nullptr)
        shown->showNotice(notice);
}

void DocumentInteractionSheet::showInFileManager()
{
    services().documentSharing().showInFileManager(_url, reportFailure());
}

void DocumentInteractionSheet::print()
{
    services().documentSharing().print(_url, reportFailure());
}

std::function<void(const std::optional<Error>&)> DocumentInteractionSheet::reportFailure()
{
    return [self = shared_from_this()](const std::optional<Error>& error) {
        if (error)
            self->showFailure(self->_facts.name, errorWords(*error));
    };
}

void DocumentInteractionSheet::showFailure(const std::string& title, const std::string& message)
{
    const auto presenter = _presenter.lock();
    if (!presenter)
        return;
    const auto alert = std::make_shared<AlertController>(title, message, kit::AlertStyle::Alert);
    alert->addAction(std::make_shared<AlertAction>(localized("OK"), AlertActionStyle::Cancel));
    presenter->presentViewController(alert, true);
}

} // namespace screens
