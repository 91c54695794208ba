// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This program is the other process of a test. It performs the operation on each line of its input and
// answers each with a line. Its first argument is the lock file that both processes share.

#include "host/system/coordination/LocalFileCoordinator.h"
#include "host/system/files/AtomicWrite.h"

#include <filesystem>
#include <fstream>
#include <functional>
#include <iostream>
#include <iterator>
#include <map>
#include <sstream>

namespace {

using host::system::LocalFileCoordinator;
using namespace platform;
namespace fs = std::filesystem;

using Words = std::vector<std::string>;

void answer(const std::string& text)
{
    std::cout << text << std::endl;
}

void answer(const std::optional<platform::Error>& error)
{
    answer(error ? std::to_string(error->code()) : "done");
}

void append(const Url& at)
{
    std::ofstream(at.path(), std::ios::app) << "more";
}

/// Holds an item until the next line of the input.
void hold(const Url&)
{
    answer("holding");
    std::string line;
    std::getline(std::cin, line);
}

using Command = std::function<void(LocalFileCoordinator&, const Words&)>;

/// Makes the command that changes the item in its first word, alone with it.
Command writing(WritingOptions options, void (*change)(const Url&))
{
    return
        [=](auto& to, auto& words) { answer(to.coordinateWriting(Url::fileURL(words[1]), options, change)); };
}

const std::map<std::string, Command> commands = {
    {"reads",
        [](auto& to, auto& words) {
            answer(to.coordinateReading(Url::fileURL(words[1]), ReadingOptions::None, hold));
        }},
    {"writes", writing(WritingOptions::None, hold)},
    {"append", writing(WritingOptions::None, append)},
    {"save",
        writing(WritingOptions::ForReplacing,
            [](const Url& at) { host::system::writeFileAtomically(at.path(), "saved"); })},
    {"remove", writing(WritingOptions::ForDeleting, [](const Url& at) { fs::remove_all(at.path()); })},
    {"move",
        [](auto& to, auto& words) {
            answer(to.coordinateWriting(Url::fileURL(words[1]), WritingOptions::ForMoving,
                Url::fileURL(words[2]), WritingOptions::ForReplacing,
                [](const Url& from, const Url& target) { fs::rename(from.path(), target.path()); }));
        }},
    // These act like programs without coordination.
    {"write", [](auto&, auto& words) { append(Url::fileURL(words[1])), answer("done"); }},
    {"rename", [](auto&, auto& words) { fs::rename(words[1], words[2]), answer("done"); }},
    {"delete", [](auto&, auto& words) { fs::remove_all(words[1]), answer("done"); }},
    {"flood",
        [](auto&, auto& words) {
            for (int turn = 0; turn < std::stoi(words[2]); ++turn) {
                append(Url::fileURL(words[1]));
                fs::remove(words[1]);
            }
            answer("done");
        }},
};

} // namespace

int main(int, char** argv)
{
    LocalFileCoordinator coordinator(LocalFileCoordinator::Settings{.lockFile = argv[1]});
    for (std::string line; std::getline(std::cin, line);) {
        std::istringstream text(line);
        const Words words{std::istream_iterator<std::string>(text), {}};
        commands.at(words.at(0))(coordinator, words);
    }
}
