// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "preview/PreviewDetailsViewController.h"

#include "items/DRItem.h"
#include "platform/Services.h"
#include "platform/TypeRegistry.h"
#include "preview/PreviewItemManager.h"
#include "screens/PlaceholderView.h"

namespace tarrow {

using screens::PlaceholderView;

namespace {

constexpr const char* folderIcon = "folder";

PlaceholderView::Content summaryOf(const DRItem& item)
{
    auto message = item.localizedTypeDescription();
    if (const auto size = item.friendlyFileSize(); !size.empty())
        message += (message.empty() ? "" : "\n") + size;
    return {.iconName = item.isDirectory()
            ? folderIcon
            : platform::services().typeRegistry().iconName(item.typeIdentifier()),
        .title = item.localizedName(),
        .message = std::move(message)};
}

} // namespace

void PreviewDetailsViewController::viewDidLoad()
{
    PreviewBaseViewController::viewDidLoad();
    _summaryView = PlaceholderView::create();
    _summaryView->setAutoresizing({.flexibleWidth = true, .flexibleHeight = true});
    _summaryView->setFrame(wrapperView()->bounds());
    wrapperView()->addSubview(_summaryView);
}

void PreviewDetailsViewController::refreshItem()
{
    PreviewBaseViewController::refreshItem();
    const auto manager = itemManager();
    const auto item = manager ? manager->item() : nullptr;
    if (_summaryView)
        _summaryView->setContent(item ? summaryOf(*item) : PlaceholderView::Content());
}

} // namespace tarrow
