// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <functional>
#include <string>

namespace host::previews {

/// Finds out whether this machine can play sounds and films.
namespace MediaSupport {

/// Looks for the player's parts off the main thread, because the first look reads a registry of plug-ins. The
/// answer comes on the main queue: an empty text when all parts are there, else a sentence that names what is
/// missing. Main thread.
void check(std::function<void(const std::string& missing)> answer);

/// Answers a sentence that tells the user why a stream could not be played.
std::string wordsFor(const char* domain, int code);

} // namespace MediaSupport

} // namespace host::previews
