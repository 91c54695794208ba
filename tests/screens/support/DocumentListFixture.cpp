// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "tests/screens/support/DocumentListFixture.h"

namespace testing_support {

using platform::Url;
using screens::DocumentListController;

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
    const List&, int action, const Url& url, const std::shared_ptr<kit::View>&, const Completion& completion)
{
    completions.push_back(completion);
    _lines.push_back("action " + std::to_string(action) + " " + url.lastPathComponent());
}

void RecordingListDelegate::documentListControllerRequestsEditing(const List& list)
{
    _lines.push_back("wants to select");
    if (allowsEditing)
        list->setEditingAnimated(true, false);
}

DocumentList::List DocumentList::shownList(const Url& folder) const
{
    const auto list = DocumentListController::initWithURL(folder);
    list->setDelegate(delegate);
    list->view()->setFrame({0, 0, 360, 600});
    list->view()->layoutIfNeeded();
    list->beginAppearance(true, false);
    list->endAppearance();
    return list;
}

void DocumentList::deliver(const List& list, const HandLister::Entries& entries) const
{
    lister->deliver(*list->presentedURL(), entries);
    drive.dispatch->runUntilIdle();
}

Url DocumentList::makePaintLibrary() const
{
    host::drive::ContainerRecord record;
    record.names = {{"en", "Paint"}};
    record.iconName = "paint-icon";
    return drive.makeContainer("com.example.paint", record);
}

} // namespace testing_support
