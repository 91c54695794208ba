// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <functional>
#include <string>

namespace host::previews {

/// Whether this machine can play sound and films.
namespace MediaSupport {

/// Looks for the player's parts, off the main thread (the first time, a registry of plug-ins is read); the
/// answer comes on the main queue: empty when all is there, else what is missing, in words. Main thread.
void check(std::function<void(const std::string& missing)> answer);

/// Why a stream could not be played, for the person.
std::string wordsFor(const char* domain, int code);

} // namespace MediaSupport

} // namespace host::previews
