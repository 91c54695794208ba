// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "GtkEnvironment.h"

#include "tests/support/TemporaryDirectory.h"

#include <gtest/gtest.h>

#include <adwaita.h>

#include <csignal>
#include <cstdlib>
#include <mutex>
#include <sys/prctl.h>
#include <sys/wait.h>
#include <unistd.h>
#include <utility>

namespace testing_support {

namespace {

std::mutex& warningsMutex()
{
    static std::mutex mutex;
    return mutex;
}

std::vector<std::string>& warnings()
{
    static std::vector<std::string> lines;
    return lines;
}

GLogWriterOutput recordLog(GLogLevelFlags level, const GLogField* fields, gsize count, gpointer)
{
    char* text = g_log_writer_format_fields(level, fields, count, FALSE);
    if (level & (G_LOG_LEVEL_ERROR | G_LOG_LEVEL_CRITICAL | G_LOG_LEVEL_WARNING)) {
        const std::lock_guard lock(warningsMutex());
        warnings().emplace_back(text);
    }
    g_free(text);
    return G_LOG_WRITER_HANDLED;
}

/// Starts an X server without a screen for this process alone, and opens the toolkit on it.
class DisplayEnvironment : public ::testing::Environment {
public:
    void SetUp() override
    {
        startServer();
        setenv("HOME", _home.path().c_str(), 1);
        setenv("XDG_CONFIG_HOME", _home.at("config").c_str(), 1);
        setenv("XDG_CACHE_HOME", _home.at("cache").c_str(), 1);
        setenv("GDK_BACKEND", "x11", 1);
        setenv("GSK_RENDERER", "cairo", 1);
        // The drivers of OpenGL leak a little, and are unloaded before the sanitizer can tell whose it was.
        setenv("GDK_DEBUG", "gl-disable", 1);
        setenv("GSETTINGS_BACKEND", "memory", 1);
        setenv("GTK_A11Y", "none", 1);
        unsetenv("WAYLAND_DISPLAY");
        unsetenv("DBUS_SESSION_BUS_ADDRESS");
        setenv("ADW_DISABLE_PORTAL", "1", 1);
        g_log_set_writer_func(recordLog, nullptr, nullptr);
        ASSERT_TRUE(gtk_init_check());
        adw_init();
        takeToolkitWarnings(); // about a machine without a session
    }

    void TearDown() override
    {
        if (_server <= 0)
            return;
        if (auto* display = gdk_display_get_default())
            gdk_display_close(display);
        kill(_server, SIGTERM);
        waitpid(_server, nullptr, 0);
    }

private:
    void startServer()
    {
        int ends[2];
        ASSERT_EQ(pipe(ends), 0);
        _server = fork();
        ASSERT_GE(_server, 0);
        if (_server == 0) {
            prctl(PR_SET_PDEATHSIG, SIGTERM);
            close(ends[0]);
            const std::string descriptor = std::to_string(ends[1]);
            execlp("Xvfb", "Xvfb", "-displayfd", descriptor.c_str(), "-screen", "0", "1280x1024x24",
                "-nolisten", "tcp", nullptr);
            _exit(127);
        }
        close(ends[1]);
        std::string number;
        char letter = 0;
        while (read(ends[0], &letter, 1) == 1 && letter != '\n')
            number += letter;
        close(ends[0]);
        ASSERT_FALSE(number.empty()) << "Xvfb did not start";
        setenv("DISPLAY", (":" + number).c_str(), 1);
    }

    TemporaryDirectory _home;
    pid_t _server = -1;
};

[[maybe_unused]] const auto* const environment = ::testing::AddGlobalTestEnvironment(new DisplayEnvironment);

} // namespace

std::vector<std::string> takeToolkitWarnings()
{
    const std::lock_guard lock(warningsMutex());
    return std::exchange(warnings(), {});
}

} // namespace testing_support
