// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This measures the time from the start of the process to the first painted list, beside a bare libadwaita
// window that is started the same way.
//
// Usage: start_bench ROUNDS PROGRAM PEER, with DISPLAY and TARROW_DRIVE_HOME set. Both are started in turn,
// each in a session of its own. A start ends with the line "First list on screen" on standard error. It
// prints the medians and their ratio.

#include <algorithm>
#include <chrono>
#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <spawn.h>
#include <string>
#include <sys/wait.h>
#include <unistd.h>
#include <vector>

namespace {

bool readUntilMarker(int descriptor)
{
    std::string text;
    char buffer[4096];
    ssize_t length = 0;
    while ((length = read(descriptor, buffer, sizeof buffer)) > 0) {
        text.append(buffer, static_cast<std::size_t>(length));
        if (text.find("First list on screen") != std::string::npos)
            return true;
    }
    std::fputs(text.c_str(), stderr);
    return false;
}

/// Answers the milliseconds from the start of the process to its line, or a negative number when it never
/// came.
double startOnce(const char* program)
{
    int ends[2];
    if (pipe(ends) != 0)
        return -1;
    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    posix_spawn_file_actions_adddup2(&actions, ends[1], STDERR_FILENO);
    posix_spawn_file_actions_addclose(&actions, ends[0]);
    char* argv[] = {const_cast<char*>(program), nullptr};
    const auto begin = std::chrono::steady_clock::now();
    pid_t child = 0;
    const int failed = posix_spawn(&child, program, &actions, nullptr, argv, environ);
    posix_spawn_file_actions_destroy(&actions);
    close(ends[1]);
    const bool found = failed == 0 && readUntilMarker(ends[0]);
    const std::chrono::duration<double, std::milli> elapsed = std::chrono::steady_clock::now() - begin;
    close(ends[0]);
    if (failed == 0) {
        kill(child, SIGTERM);
        waitpid(child, nullptr, 0);
    }
    return found ? elapsed.count() : -1;
}

double median(std::vector<double>& values)
{
    std::ranges::sort(values);
    return values[values.size() / 2];
}

} // namespace

int main(int argc, char** argv)
{
    if (argc != 4)
        return std::fprintf(stderr, "usage: start_bench ROUNDS PROGRAM PEER\n"), 2;
    std::vector<double> program, peer;
    for (int round = -1; round < std::atoi(argv[1]); ++round) {
        const double ours = startOnce(argv[2]), theirs = startOnce(argv[3]);
        if (ours < 0 || theirs < 0)
            return std::fprintf(stderr, "a program never showed its window\n"), 1;
        if (round >= 0) { // the first pair warms the caches
            program.push_back(ours);
            peer.push_back(theirs);
        }
    }
    const double ours = median(program), theirs = median(peer);
    std::printf(
        "start to first list: %.0f ms; bare window: %.0f ms; ratio %.2f\n", ours, theirs, ours / theirs);
    return 0;
}
