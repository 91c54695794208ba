// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This program is the other process of a test. It performs the operation on each line of its input and
// answers each with a line. Its first argument is the lock file that both processes share.

#include "host/system/coordination/LocalFileCoordinator.h"
#include "host/system/files/AtomicWrite.h"

#include <filesystem>
#include <fstream>
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

void append(const std::string& path)
{
    std::ofstream(path, std::ios::app) << "more";
}

/// Holds an item until the next line of the input.
void hold(const Url&)
{
    answer("holding");
    std::string line;
    std::getline(std::cin, line);
}

/// Moves in steps, which is correct only while no other program touches the item.
bool moveInSteps(const std::string& from, const std::string& to)
{
    if (!fs::exists(from))
        return false;
    fs::copy_file(from, to);
    return fs::remove(from);
}

using Command = void (*)(LocalFileCoordinator&, const Words&);

const std::map<std::string, Command> commands = {
    {"reads",
        [](auto& to, auto& words) {
            answer(to.coordinateReading(Url::fileURL(words[1]), ReadingOptions::None, hold));
        }},
    {"writes",
        [](auto& to, auto& words) {
            answer(to.coordinateWriting(Url::fileURL(words[1]), WritingOptions::None, hold));
        }},
    {"append",
        [](auto& to, auto& words) {
            answer(to.coordinateWriting(
                Url::fileURL(words[1]), WritingOptions::None, [](const Url& at) { append(at.path()); }));
        }},
    {"save",
        [](auto& to, auto& words) {
            answer(to.coordinateWriting(Url::fileURL(words[1]), WritingOptions::ForReplacing,
                [](const Url& at) { host::system::writeFileAtomically(at.path(), "saved"); }));
        }},
    {"move",
        [](auto& to, auto& words) {
            answer(to.coordinateWriting(Url::fileURL(words[1]), WritingOptions::ForMoving,
                Url::fileURL(words[2]), WritingOptions::ForReplacing,
                [](const Url& from, const Url& target) { fs::rename(from.path(), target.path()); }));
        }},
    {"race",
        [](auto& to, auto& words) {
            bool isMoved = false;
            to.coordinateWriting(Url::fileURL(words[1]), WritingOptions::ForMoving, Url::fileURL(words[2]),
                WritingOptions::ForReplacing, [&](const Url& from, const Url& target) {
                    isMoved = moveInSteps(from.path(), target.path());
                });
            answer(isMoved ? "won" : "lost");
        }},
    {"remove",
        [](auto& to, auto& words) {
            answer(to.coordinateWriting(Url::fileURL(words[1]), WritingOptions::ForDeleting,
                [](const Url& at) { fs::remove_all(at.path()); }));
        }},
    // These act like programs without coordination.
    {"write", [](auto&, auto& words) { append(words[1]), answer("done"); }},
    {"rename", [](auto&, auto& words) { fs::rename(words[1], words[2]), answer("done"); }},
    {"delete", [](auto&, auto& words) { fs::remove_all(words[1]), answer("done"); }},
    {"backup",
        [](auto&, auto& words) {
            fs::rename(words[1], words[1] + "~");
            append(words[1]);
            answer("done");
        }},
    {"evict",
        [](auto&, auto& words) {
            fs::rename(words[1], words[2]);
            append(words[3]);
            answer("done");
        }},
    {"flood",
        [](auto&, auto& words) {
            for (int turn = 0; turn < std::stoi(words[2]); ++turn) {
                append(words[1]);
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
