// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <cstdint>
#include <functional>
#include <string>
#include <vector>

namespace sweep_tests {

/// A call of the file system that a program is about to make.
struct FileCall {
    std::uint64_t number = 0; ///< the number of the system call
    std::string subject; ///< the path or the open file of the call, as far as it is known
    std::string newName; ///< of a rename
    int index = 0; ///< counted from 1 among the calls below the watched folder
    std::uint64_t length = 0; ///< the bytes that a read or a write is for
    bool mayNeedSpace() const; ///< it writes or makes a name
    bool changesNames() const; ///< it renames or removes
    bool takesPath() const;
    bool opensFile() const;
    bool isTransfer() const; ///< it reads or writes a file's content
};

/// The fault that a call meets, none by default.
struct Fault {
    int errorNumber = 0;
    bool isKill = false;
    bool isShort = false; ///< a read or a write transfers one byte only, and says so
    bool isNone() const { return errorNumber == 0 && !isKill && !isShort; }
};
using FaultFor = std::function<Fault(const FileCall&)>;

/// How a program ended.
struct Ending {
    bool wasKilled = false;
    int status = -1; ///< exit status, when it was not killed
    int calls = 0; ///< calls below the watched folder
    std::string said; ///< what it printed, with its log
};

/// Runs a program and asks before each of its calls on files below a folder for a fault. A filter of system
/// calls reports them to this process (as an ordinary user, too). The program and its threads wait meanwhile,
/// so a kill comes before the call has any effect.
Ending runWithFaults(
    const std::vector<std::string>& command, const std::string& watchedFolder, const FaultFor& faultFor);

} // namespace sweep_tests
