// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <string>
#include <string_view>

namespace fuzzing {

/// Reads one input. Every target defines it; the fuzzer calls it many thousand times in one process. A crash,
/// a report of a sanitizer, a broken rule and an input that takes seconds are findings.
void tryInput(std::string_view input);

/// Ends the process when a rule does not hold, so that the fuzzer keeps the input. `rule` is a sentence.
void require(bool holds, const char* rule);

/// Takes bytes from the front of an input, and zeros when nothing is left.
class Bytes {
public:
    explicit Bytes(std::string_view input)
        : _rest(input)
    {
    }
    unsigned char byte();
    unsigned pair() { return byte() * 256U + byte(); }
    std::string_view rest() const { return _rest; }

private:
    std::string_view _rest;
};

/// Answers a folder of this process for files with inputs. It is removed at the end.
const std::string& folder();
/// Makes or replaces a file. Answers its path.
std::string writeFile(const std::string& path, std::string_view content);

} // namespace fuzzing
