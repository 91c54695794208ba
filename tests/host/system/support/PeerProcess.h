// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <sys/types.h>

#include <string>

namespace testing_support {

/// A process that gets its orders line by line and answers each with one line. It ends with this object.
class PeerProcess {
public:
    PeerProcess(const std::string& program, const std::string& argument);
    ~PeerProcess();
    PeerProcess(const PeerProcess&) = delete;
    PeerProcess& operator=(const PeerProcess&) = delete;

    void send(const std::string& line);
    /// Waits for the next line. Answers an empty text when the process has ended.
    std::string receive();
    std::string ask(const std::string& line);
    void signal(int number);

private:
    pid_t _process = -1;
    int _toProcess = -1, _fromProcess = -1;
};

} // namespace testing_support
