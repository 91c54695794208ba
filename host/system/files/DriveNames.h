// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <cstddef>
#include <string_view>

namespace host::system {

/// These names have a meaning in the drive's folders. The promise of NAME is the file ".NAME" with this
/// suffix.
inline constexpr std::string_view promiseSuffix = ".trwpromise";
/// The promise of a longer name than this many bytes has no room for the suffix. It is the file with this
/// prefix and the SHA-256 of the name in hexadecimal digits.
inline constexpr std::size_t longestNameInPromise = 255 - 1 - promiseSuffix.size();
inline constexpr std::string_view longPromisePrefix = ".trwlong-";
/// The attribute of such a promise that says its name. While it is being renamed it says both names, with a
/// slash between them; the one that belongs to the file's name counts.
inline constexpr const char* promisedNameAttribute = "user.trw.name";
/// The prefix of the private names of items that are being written, moved or removed.
inline constexpr std::string_view passingPrefix = ".trw";
/// The extension of a reference, a small file that stands for a document of a container.
inline constexpr std::string_view referenceExtension = "trwref";
/// The extension of an alias, a small file that stands for another item.
inline constexpr std::string_view aliasExtension = "trwalias";
/// The type of an alias, whose description is never translated.
inline constexpr std::string_view aliasType = "app.tarrow.Drive.alias";

} // namespace host::system
