// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "Program.h"

#include <gmock/gmock.h>

#include <algorithm>
#include <cstdlib>
#include <deque>
#include <fstream>
#include <iterator>
#include <regex>
#include <signal.h>

namespace e2e {

namespace {

constexpr int looksBetweenPresses = 20;
constexpr std::size_t lastLines = 30; ///< lines of the log in the message of a failed test
constexpr unsigned controlKeycode = 37, shiftKeycode = 50; ///< codes of every PC keyboard under X

bool begins(const std::string& text, const std::string& beginning)
{
    return text.starts_with(beginning);
}

/// Starts a command with a changed environment. What it writes to its standard error goes to a file, unless
/// the name of that is empty.
std::shared_ptr<GSubprocess> spawn(
    const std::vector<std::string>& command, const Program::Environment& changes, const std::string& errors)
{
    const std::shared_ptr<GSubprocessLauncher> launcher(
        g_subprocess_launcher_new(G_SUBPROCESS_FLAGS_NONE), g_object_unref);
    for (const auto& [name, value] : changes)
        g_subprocess_launcher_setenv(launcher.get(), name.c_str(), value.c_str(), TRUE);
    if (!errors.empty())
        g_subprocess_launcher_set_stderr_file_path(launcher.get(), errors.c_str());
    std::vector<const char*> words;
    for (const auto& word : command)
        words.push_back(word.c_str());
    words.push_back(nullptr);
    auto* process = g_subprocess_launcher_spawnv(launcher.get(), words.data(), nullptr);
    if (process)
        return {process, g_object_unref};
    ADD_FAILURE() << "cannot start " << command.front();
    return nullptr;
}

} // namespace

int Program::run(const std::vector<std::string>& command, const Environment& changes)
{
    const auto process = spawn(command, changes, {});
    const bool hasEnded = process && g_subprocess_wait(process.get(), nullptr, nullptr)
        && g_subprocess_get_if_exited(process.get());
    return hasEnded ? g_subprocess_get_exit_status(process.get()) : -1;
}

Program::Program(const Environment& changes, const std::vector<std::string>& arguments)
{
    static int programs = 0;
    _errors = std::string(getenv("HOME")) + "/errors." + std::to_string(++programs);
    EXPECT_LE(atspi_init(), 1); // 1 means that an earlier program of this process did it
    // The first look starts the accessibility registry, which might not see a program that started before it.
    atspi_accessible_get_child_count(atspi_get_desktop(0), nullptr);
    std::vector<std::string> command{getenv("TRW_PROGRAM")};
    command.insert(command.end(), arguments.begin(), arguments.end());
    _process = spawn(command, changes, _errors);
    EXPECT_TRUE(_process && Accessible::waitFor([this] {
        const char* number = g_subprocess_get_identifier(_process.get());
        return number && (_tree = Accessible::application("tarrow-drive", std::atoi(number)));
    })) << "the program did not come up";
}

// NOLINTNEXTLINE(bugprone-exception-escape): an exception would end the test here as well
Program::~Program()
{
    if (_process)
        expectOrderlyEnd();
    std::ifstream errors(_errors);
    const std::regex complaint("(Gtk|Gdk|Gsk|Adwaita|GLib|GLib-GObject|GLib-GIO|Pango|GtkSourceView|Poppler)-"
                               "(WARNING|CRITICAL|ERROR)");
    for (std::string line; std::getline(errors, line);)
        EXPECT_FALSE(std::regex_search(line, complaint)) << line;
}

void Program::expectOrderlyEnd()
{
    g_subprocess_send_signal(_process.get(), SIGTERM);
    EXPECT_TRUE(Accessible::waitFor([this] { return !g_subprocess_get_identifier(_process.get()); }));
    std::ifstream errors(_errors);
    EXPECT_TRUE(g_subprocess_get_successful(_process.get()))
        << std::string(std::istreambuf_iterator<char>(errors), {});
}

std::vector<Accessible> Program::buttons(const std::string& beginning) const
{
    return all([&](const Accessible& node) { return node.isButton() && begins(node.name(), beginning); });
}

bool Program::says(const std::string& name) const
{
    return !all([&](const Accessible& node) { return node.name() == name; }).empty();
}

bool Program::hasKeyboardAt(const std::string& beginning) const
{
    // The widget with the keyboard focus contains the row of a list.
    const auto places = all([](const Accessible& node) { return node.isFocused(); });
    return std::ranges::any_of(places, [&](const Accessible& place) {
        return begins(place.name(), beginning)
            || !place.all([&](const Accessible& node) { return begins(node.name(), beginning); }).empty();
    });
}

std::string Program::document() const
{
    std::string answer;
    for (const auto& text : all([](const Accessible& node) { return node.isEntry(); }))
        answer += text.text();
    return answer;
}

std::string Program::state() const
{
    std::string answer;
    for (const auto& node : all([](const Accessible& each) { return !each.name().empty(); }))
        answer += (node.isFocused() ? "\n  * " : "\n  ") + node.name();
    std::ifstream log(_errors);
    std::deque<std::string> last;
    for (std::string line; std::getline(log, line); last.push_back(line)) {
        if (last.size() == lastLines)
            last.pop_front();
    }
    for (const auto& line : last)
        answer += '\n' + line;
    return answer;
}

namespace {

/// Answers the last button of this very name, of several that begin so; else the last one.
const Accessible& namedSo(const std::vector<Accessible>& buttons, const std::string& name)
{
    const auto exact =
        std::find_if(buttons.rbegin(), buttons.rend(), [&](const auto& each) { return each.name() == name; });
    return exact == buttons.rend() ? buttons.back() : *exact;
}

} // namespace

void Program::press(const std::string& beginning) const
{
    // The look is repeated, because a changing bar may remove its buttons between the look and the press.
    EXPECT_TRUE(Accessible::waitFor([&] {
        const auto found = buttons(beginning);
        return !found.empty() && namedSo(found, beginning).press();
    })) << beginning;
}

void Program::pressUntil(const std::string& beginning, const std::function<bool()>& effect) const
{
    int looks = 0;
    EXPECT_TRUE(Accessible::waitFor([&] {
        if (effect())
            return true;
        const auto found = buttons(beginning);
        if (looks++ % looksBetweenPresses == 0 && !found.empty())
            found.back().press();
        return false;
    })) << beginning;
}

void pressKey(unsigned symbol, Modifier modifier)
{
    const auto send = [](unsigned key, AtspiKeySynthType kind) {
        EXPECT_TRUE(atspi_generate_keyboard_event(static_cast<glong>(key), nullptr, kind, nullptr));
    };
    std::vector<unsigned> held;
    if (modifier == Modifier::Control || modifier == Modifier::ControlAndShift)
        held.push_back(controlKeycode);
    if (modifier == Modifier::Shift || modifier == Modifier::ControlAndShift)
        held.push_back(shiftKeycode);
    for (const auto key : held)
        send(key, ATSPI_KEY_PRESS);
    send(symbol, ATSPI_KEY_SYM);
    for (const auto key : held)
        send(key, ATSPI_KEY_RELEASE);
}

void type(const std::string& text)
{
    for (const char letter : text)
        pressKey(static_cast<unsigned char>(letter));
}

} // namespace e2e
