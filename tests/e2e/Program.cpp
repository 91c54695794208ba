// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "Program.h"

#include <gmock/gmock.h>

#include <algorithm>
#include <cstdlib>
#include <deque>
#include <fcntl.h>
#include <fstream>
#include <iterator>
#include <regex>
#include <signal.h>
#include <spawn.h>
#include <sys/wait.h>

namespace e2e {

namespace {

constexpr int looksBetweenPresses = 20;
constexpr std::size_t lastLines = 30; ///< lines of the log in the message of a failed test
constexpr unsigned controlKeycode = 37, shiftKeycode = 50; ///< codes of every PC keyboard under X

bool begins(const std::string& text, const std::string& beginning)
{
    return text.compare(0, beginning.size(), beginning) == 0;
}

std::vector<std::string> changed(const Program::Environment& changes)
{
    auto all = changes;
    for (char** entry = environ; *entry; ++entry) {
        const std::string text = *entry;
        const auto equals = text.find('=');
        all.emplace(text.substr(0, equals), text.substr(equals + 1));
    }
    std::vector<std::string> answer;
    for (const auto& [name, value] : all)
        answer.push_back(name + '=' + value);
    return answer;
}

std::vector<char*> pointers(std::vector<std::string>& texts)
{
    std::vector<char*> answer;
    for (auto& text : texts)
        answer.push_back(text.data());
    answer.push_back(nullptr);
    return answer;
}

} // namespace

pid_t Program::spawn(
    const std::vector<std::string>& command, const Environment& changes, const std::string& errors)
{
    auto words = command;
    auto environment = changed(changes);
    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    if (!errors.empty())
        posix_spawn_file_actions_addopen(&actions, 2, errors.c_str(), O_WRONLY | O_CREAT | O_TRUNC, 0600);
    pid_t process = -1;
    EXPECT_EQ(posix_spawn(&process, command.front().c_str(), &actions, nullptr, pointers(words).data(),
                  pointers(environment).data()),
        0)
        << command.front();
    posix_spawn_file_actions_destroy(&actions);
    return process;
}

int Program::run(const std::vector<std::string>& command, const Environment& changes)
{
    const auto process = spawn(command, changes, {});
    int status = -1;
    return process > 0 && waitpid(process, &status, 0) == process && WIFEXITED(status) ? WEXITSTATUS(status)
                                                                                       : -1;
}

Program::Program(const Environment& changes)
{
    static int programs = 0;
    _errors = std::string(getenv("HOME")) + "/errors." + std::to_string(++programs);
    EXPECT_LE(atspi_init(), 1); // 1 means that an earlier program of this process did it
    // The first look starts the accessibility registry, which might not see a program that started before it.
    atspi_accessible_get_child_count(atspi_get_desktop(0), nullptr);
    _process = spawn({getenv("TRW_PROGRAM")}, changes, _errors);
    EXPECT_TRUE(Accessible::waitFor([this] {
        return bool(_tree = Accessible::application("tarrow-drive", _process));
    })) << "the program did not come up";
}

Program::~Program()
{
    if (_process > 0)
        expectOrderlyEnd();
    std::ifstream errors(_errors);
    const std::regex complaint("(Gtk|Gdk|Gsk|Adwaita|GLib|GLib-GObject|GLib-GIO|Pango|GtkSourceView|Poppler)-"
                               "(WARNING|CRITICAL|ERROR)");
    for (std::string line; std::getline(errors, line);)
        EXPECT_FALSE(std::regex_search(line, complaint)) << line;
}

void Program::expectOrderlyEnd()
{
    kill(_process, SIGTERM);
    int status = 0;
    EXPECT_TRUE(Accessible::waitFor([&] { return waitpid(_process, &status, WNOHANG) == _process; }));
    std::ifstream errors(_errors);
    EXPECT_TRUE(WIFEXITED(status) && WEXITSTATUS(status) == 0)
        << status << '\n'
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

std::vector<Accessible> Program::entries() const
{
    return all([](const Accessible& node) { return node.isEntry(); });
}

std::vector<Accessible> Program::dialogs() const
{
    return all([](const Accessible& node) { return node.isDialog(); });
}

void Program::press(const std::string& beginning) const
{
    // The look is repeated, because a changing bar may remove its buttons between the look and the press.
    EXPECT_TRUE(Accessible::waitFor([&] {
        const auto found = buttons(beginning);
        return !found.empty() && found.back().press();
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
