// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Url.h"
#include "platform/UserActivity.h"

#include <optional>

namespace platform {

/// What the desktop's launcher offers of this program beside what it always offers. Main thread only.
class LauncherShortcuts {
public:
    virtual ~LauncherShortcuts() = default;

    /// Keeps the shortcut to the document that was opened last, in place of the one before, and names the
    /// document to the desktop as one that was used.
    virtual void keepRecentDocument(const Url& document, const ShortcutItem& shortcut) = 0;
    /// Answers the shortcut that was kept last, in this run or an earlier one; nothing when there is none.
    virtual std::optional<ShortcutItem> recentDocument() const = 0;
    /// Forgets the shortcut. What the desktop knows of used documents stays.
    virtual void forgetRecentDocument() = 0;
};

} // namespace platform
