// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/app/CommandLine.h"
#include "host/gtk/app/MakeApplication.h"
#include "host/gtk/app/StateFile.h"
#include "host/gtk/screens/GtkWindowHost.h"
#include "platform/Application.h"

#include <adwaita.h>

#include <memory>
#include <string>

namespace host::gtk {

class BroadwayServer;
class HandOverToasts;

/// The application's loop on the main thread: one process with one window. Later starts pass their requests
/// to it. Without a display the window is served to a web browser on this machine.
class GtkApplicationLoop : public platform::Application {
public:
    explicit GtkApplicationLoop(ApplicationSettings settings);
    ~GtkApplicationLoop() override;

    /// Answers the exit status: 0 after the window was closed, 64 for arguments that are not understood, 69
    /// when no window can be shown.
    int run(int argc, char** argv, const DelegateFactory& makeDelegate) override;

    /// Answers the window that is shown, or null.
    WindowPeer* windowPeer() const;

private:
    int runPrimary(char** argv, const CommandLine& line);
    bool openDisplay();
    void connectApplication();
    void addActions();
    void launch(std::optional<platform::ShortcutItem> shortcut);
    void restoreState();
    void saveState();
    void handle(const LaunchRequest& request);
    void openUrl(const std::string& url);
    void perform(const platform::ShortcutItem& shortcut);
    void continueActivity(const platform::UserActivity& activity);
    void failedToContinue(const platform::UserActivity& activity, const platform::Error& error);
    void activeChanged(bool active);
    void resignActive();
    void focusLost();
    void windowShown(WindowPeer& window);

    ApplicationSettings _settings;
    StateFile _stateFile;
    std::unique_ptr<BroadwayServer> _broadway;
    ObjectRef<AdwApplication> _application;
    std::shared_ptr<GtkWindowHost> _windowHost;
    std::shared_ptr<HandOverToasts> _handOver;
    DelegateFactory _makeDelegate;
    std::shared_ptr<platform::ApplicationDelegate> _delegate; ///< null before the launch
    std::vector<LaunchRequest> _waiting; ///< requests of the command line that wait for the launch
    bool _active = false;
    SignalConnections _connections;
};

} // namespace host::gtk
