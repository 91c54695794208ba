// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/app/StateFile.h"
#include "platform/LauncherShortcuts.h"

#include <string>

namespace host::gtk {

/// The launcher's shortcut to the recent document, on desktops that follow the freedesktop.org entries.
///
/// A launcher shows the actions of the installed desktop entry, whose names and commands are fixed. So the
/// action is always there, and asks the program for the document that is kept here. A desktop entry written
/// for the user could name the document, but it would hide the installed one and everything that later
/// versions of that change. The document itself shows in the desktop's shared list of recent files
/// (recently-used.xbel), from which launchers, file managers and file choosers offer it, and which the user
/// can switch off for all programs.
class DesktopShortcuts : public platform::LauncherShortcuts {
public:
    /// Keeps the shortcut in a file.
    explicit DesktopShortcuts(std::string path);

    void keepRecentDocument(const platform::Url& document, const platform::ShortcutItem& shortcut) override;
    std::optional<platform::ShortcutItem> recentDocument() const override;
    void forgetRecentDocument() override;

private:
    StateFile _file;
};

} // namespace host::gtk
