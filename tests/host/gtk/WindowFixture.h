// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/ViewPeer.h"
#include "host/gtk/preview/PreviewModule.h"
#include "host/gtk/screens/GtkWindowHost.h"
#include "host/gtk/screens/NavigationPeer.h"
#include "kit/controllers/NavigationController.h"
#include "kit/controllers/Window.h"
#include "platform/Services.h"

#include <gtest/gtest.h>

#include <functional>
#include <memory>
#include <string>
#include <vector>

namespace testing_support {

/// Answers the libraries of the previews that are linked with the test.
std::shared_ptr<host::gtk::PreviewModule> linkedPreviews();

/// Opens a real window of 400 by 700 points. A test fails when the toolkit wrote a warning.
class WindowFixture : public ::testing::Test {
protected:
    WindowFixture();
    ~WindowFixture() override;
    void TearDown() override;

    /// Shows a screen as the root, and waits until it has its size.
    void show(const std::shared_ptr<kit::ViewController>& root);
    /// Shows a stack of these screens and answers it.
    std::shared_ptr<kit::NavigationController> showStack(
        std::vector<std::shared_ptr<kit::ViewController>> screens);
    /// Runs the main loop until a condition holds. The test fails after five seconds.
    void waitFor(const std::function<bool()>& condition, const char* what);
    /// Runs the main loop until everything that was scheduled is shown and laid out.
    void settle();
    /// Destroys the window and everything that shows it.
    void closeWindow();

    host::gtk::WindowPeer& peer() const { return *host->windowPeer(); }
    GtkWidget* windowWidget() const { return GTK_WIDGET(peer().window()); }
    host::gtk::ViewPeer* peerOf(const kit::View& view) const;
    GtkWidget* nativeOf(const kit::View& view) const { return peerOf(view)->native(); }
    /// Answers the frame of a view's widget in the widget of another view.
    platform::Rect boundsIn(const kit::View& view, const kit::View& ancestor) const;
    /// Answers the first button below the window whose label has this text, or null.
    GtkWidget* findButton(const std::string& text) const;

    /// These services are installed; a fixture that needs more of them installs a larger copy.
    platform::ServiceSet installed;
    std::shared_ptr<host::gtk::GtkWindowHost> host;
    std::shared_ptr<kit::Window> window;
};

/// Makes a screen whose view a test fills.
std::shared_ptr<kit::ViewController> makeScreen(const std::string& title);

} // namespace testing_support
