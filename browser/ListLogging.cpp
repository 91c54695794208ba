// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "browser/ListLogging.h"

#include "items/FileUtils.h"
#include "platform/Log.h"
#include "screens/list/DocumentListController.h"

namespace tarrow {

namespace {

/// Answers an item's path without the part that leads to the list's folder.
std::string shortPath(const Url& item, const std::optional<Url>& folder)
{
    const auto& path = item.path();
    const auto leading = folder ? folder->deletingLastPathComponent().path() : std::string();
    return leading.size() > 1 && path.starts_with(leading) ? "..." + path.substr(leading.size()) : path;
}

} // namespace

std::string logText(const ContainedItems& items)
{
    return items.list ? platform::logText(items.list->containedItems()) : "(null)";
}

std::string logText(const SelectedItems& items)
{
    return items.list ? platform::logText(items.list->selectedItems()) : "(null)";
}

std::string logText(const PresentedType& type)
{
    const auto value =
        FileUtils::getResourceValueForURL(AttributeKey::TypeIdentifier, type.list->presentedURL());
    const auto* text = value ? std::get_if<std::string>(&*value) : nullptr;
    return text ? *text : "(null)";
}

void logNewList(const std::shared_ptr<const screens::DocumentListController>& list)
{
    static constexpr Operation op{"-[NavController initNewListController:]"};
    op.debug("New DLC (%d items): \"%@\", UTI=%@, URL=%@", list->containedItemCount(), list->title(),
        PresentedType{list}, list->presentedURL());
    if (!Operation::isWritten(platform::LogLevel::Debug))
        return;
    for (const auto& item : list->containedItems())
        op.debug("    %@", shortPath(item, list->presentedURL()));
}

} // namespace tarrow
