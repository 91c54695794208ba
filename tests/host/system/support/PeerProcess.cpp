// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "tests/host/system/support/PeerProcess.h"

#include <fcntl.h>
#include <sys/wait.h>
#include <unistd.h>

#include <csignal>
#include <cstdlib>

namespace testing_support {

PeerProcess::PeerProcess(const std::string& program, const std::string& argument)
{
    int input[2], output[2];
    if (::pipe2(input, O_CLOEXEC) != 0 || ::pipe2(output, O_CLOEXEC) != 0)
        std::abort();
    _process = ::fork();
    if (_process == 0) {
        ::dup2(input[0], STDIN_FILENO);
        ::dup2(output[1], STDOUT_FILENO);
        ::execl(program.c_str(), program.c_str(), argument.c_str(), nullptr);
        ::_exit(127);
    }
    ::close(input[0]);
    ::close(output[1]);
    _toProcess = input[1];
    _fromProcess = output[0];
}

PeerProcess::~PeerProcess()
{
    ::close(_toProcess);
    ::kill(_process, SIGKILL);
    ::waitpid(_process, nullptr, 0);
    ::close(_fromProcess);
}

void PeerProcess::send(const std::string& line)
{
    const auto text = line + '\n';
    static_cast<void>(::write(_toProcess, text.data(), text.size()) + 1);
}

std::string PeerProcess::receive()
{
    std::string line;
    for (char byte = 0; ::read(_fromProcess, &byte, 1) == 1 && byte != '\n';)
        line += byte;
    return line;
}

std::string PeerProcess::ask(const std::string& line)
{
    send(line);
    return receive();
}

void PeerProcess::signal(int number)
{
    ::kill(_process, number);
}

} // namespace testing_support
