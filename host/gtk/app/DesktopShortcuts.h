// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/app/StateFile.h"
#include "platform/LauncherShortcuts.h"

#include <memory>
#include <optional>
#include <string>

namespace platform {
class Queue;
}

namespace host::gtk {

/// The launcher's shortcut to the recent document, on desktops that follow the freedesktop.org entries.
///
/// A launcher shows the actions of the installed desktop entry, whose names and commands are fixed. So the
/// action is always there, and asks the program for the document that is kept here. A desktop entry written
/// for the user could name the document, but it would hide the installed one and everything that later
/// versions of that change. The document itself shows in the desktop's shared list of recent files
/// (recently-used.xbel), from which launchers, file managers and file choosers offer it, and which the user
/// can switch off for all programs.
///
/// Both files are written on a queue, because a slow disk must not hold up the window in which the document
/// opens.
class DesktopShortcuts : public platform::LauncherShortcuts {
public:
    struct Settings {
        std::string stateFile; ///< the path of the file that keeps the shortcut
        std::string recentFiles; ///< the path of the desktop's list
        std::shared_ptr<platform::Queue> queue; ///< a serial one
    };
    explicit DesktopShortcuts(Settings settings);
    /// Answers the path of the list of recent files that all programs of the user share.
    static std::string sharedRecentFiles();

    void keepRecentDocument(const platform::Url& document, const platform::ShortcutItem& shortcut) override;
    std::optional<platform::ShortcutItem> recentDocument() const override;
    void forgetRecentDocument() override;

private:
    void keep(std::optional<platform::ShortcutItem> shortcut);

    Settings _settings;
    std::shared_ptr<StateFile> _file; ///< used on the queue alone
    std::optional<platform::ShortcutItem> _recent;
};

} // namespace host::gtk
