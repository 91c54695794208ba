// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <memory>
#include <string>

namespace screens {
class DocumentListController;
}

namespace tarrow {

// These values stand for texts about a folder list in log lines. The texts are only made when the line is
// written, because a list may have 100,000 items.

/// Reads as the URLs of a list's items; the list may be null.
struct ContainedItems {
    std::shared_ptr<const screens::DocumentListController> list;
};
std::string logText(const ContainedItems& items);

/// Reads as the URLs of the items that are selected in a list, which may be null.
struct SelectedItems {
    std::shared_ptr<const screens::DocumentListController> list;
};
std::string logText(const SelectedItems& items);

/// Reads as the content type of the folder that a list shows.
struct PresentedType {
    std::shared_ptr<const screens::DocumentListController> list;
};
std::string logText(const PresentedType& type);

/// Logs a list that is about to be shown and, line by line, its items.
void logNewList(const std::shared_ptr<const screens::DocumentListController>& list);

} // namespace tarrow
