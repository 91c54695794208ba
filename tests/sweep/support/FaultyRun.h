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
    std::uint64_t number = 0; ///< of the system call
    std::string subject; ///< the path or the open file that it is about, as far as it can be told
    std::string newName; ///< of a rename
    int index = 0; ///< from 1, among the calls below the watched folder
    bool mayNeedSpace() const; ///< it writes, or makes a name
    bool takesPath() const;
};

/// What a call meets.
struct Fault {
    enum class Kind { None, Kill, Error } kind = Kind::None;
    int errorNumber = 0;
};

/// How a program ended.
struct Ending {
    bool wasKilled = false;
    int status = -1; ///< exit status, where it was not killed
    int calls = 0; ///< below the watched folder
};

/// Runs a program and asks before each of its calls that concern files below a folder what shall happen. Done
/// by a filter of system calls that reports them to this process (as an ordinary user, too); the program and
/// its threads wait meanwhile, so a kill comes before the call has any effect.
Ending runWithFaults(const std::vector<std::string>& command, const std::string& watchedFolder,
    const std::function<Fault(const FileCall&)>& faultFor);

} // namespace sweep_tests
