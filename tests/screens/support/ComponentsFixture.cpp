// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "tests/screens/support/ComponentsFixture.h"

#include "kit/views/ListView.h"

#include <chrono>
#include <utility>

namespace testing_support {

using platform::Url;
using screens::DocumentListController;

std::optional<platform::Error> CountingCoordinator::coordinateReading(
    const Url& url, platform::ReadingOptions options, const Accessor& accessor)
{
    _names.push_back(url.lastPathComponent());
    return real->coordinateReading(url, options, accessor);
}

std::vector<std::string> CountingCoordinator::takeReads()
{
    return std::exchange(_names, {});
}

void RecordingListDelegate::documentListControllerDidSelectContainerWithViewController(
    const List&, const List& container)
{
    _lines.push_back("folder " + container->title() + " " + container->presentedURL()->lastPathComponent());
}

void RecordingListDelegate::documentListControllerDidSelectItemAtURL(const List&, const Url& url)
{
    _lines.push_back("item " + url.lastPathComponent());
}

void RecordingListDelegate::documentListControllerItemsChanged(const List& list)
{
    _lines.push_back("changed " + std::to_string(list->containedItemCount()) + " selected "
        + std::to_string(list->selectedItemCount()));
}

void RecordingListDelegate::documentListControllerURLWasRemoved(const List& list)
{
    _lines.push_back("removed " + list->title());
}

void RecordingListDelegate::documentListControllerPerformActionURLOriginatingViewCompletion(
    const List&, int action, const Url& url, const std::shared_ptr<kit::View>&, const Completion&)
{
    _lines.push_back("action " + std::to_string(action) + " " + url.lastPathComponent());
}

void RecordingListDelegate::documentListControllerRequestsEditing(const List& list)
{
    _lines.push_back("wants to select");
    if (allowsEditing)
        list->setEditingAnimated(true, false);
}

std::vector<std::string> RecordingListDelegate::take()
{
    return std::exchange(_lines, {});
}

ComponentsFixture::ComponentsFixture()
{
    install(lister);
}

void ComponentsFixture::useRealLister()
{
    install(drive.installed.folderLister);
}

void ComponentsFixture::install(std::shared_ptr<platform::FolderLister> folderLister)
{
    auto set = drive.installed;
    set.appRegistry = apps;
    set.documentSharing = sharing;
    set.fileCoordinator = coordinator;
    set.folderLister = std::move(folderLister);
    set.linkOpener = links;
    platform::installServices(std::move(set));
}

bool ComponentsFixture::waitUntil(const std::function<bool()>& condition)
{
    const auto deadline = std::chrono::steady_clock::now() + std::chrono::seconds(60);
    while (!condition()) {
        if (std::chrono::steady_clock::now() > deadline)
            return false;
        drive.settle();
        drive.dispatch->advance(0.01);
    }
    return true;
}

ComponentsFixture::List ComponentsFixture::shownList(const Url& folder)
{
    const auto list = DocumentListController::initWithURL(folder);
    list->setDelegate(delegate);
    list->view()->setFrame({0, 0, 360, 600});
    list->view()->layoutIfNeeded();
    list->beginAppearance(true, false);
    list->endAppearance();
    return list;
}

void ComponentsFixture::deliver(
    const List& list, const HandLister::Entries& entries, platform::ListingStage stage)
{
    lister->deliver(*list->presentedURL(), entries, stage);
    drive.dispatch->runUntilIdle();
}

std::vector<std::string> ComponentsFixture::titles(const List& list) const
{
    std::vector<std::string> found;
    for (std::size_t row = 0; row < list->listView()->rowCount(); ++row)
        found.push_back(list->listView()->row(row).title);
    return found;
}

} // namespace testing_support
