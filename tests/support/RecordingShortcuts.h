// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/LauncherShortcuts.h"

#include <vector>

namespace testing_support {

/// Keeps the shortcut in memory, and records every document that was named.
class RecordingShortcuts : public platform::LauncherShortcuts {
public:
    void keepRecentDocument(const platform::Url& document, const platform::ShortcutItem& shortcut) override
    {
        documents.push_back(document);
        kept = shortcut;
    }
    std::optional<platform::ShortcutItem> recentDocument() const override { return kept; }
    void forgetRecentDocument() override { kept.reset(); }

    std::vector<platform::Url> documents;
    std::optional<platform::ShortcutItem> kept;
};

} // namespace testing_support
