// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <string_view>

namespace host::system {

/// These names have a meaning in the drive's folders. The promise of NAME is the file ".NAME" with this
/// suffix.
inline constexpr std::string_view promiseSuffix = ".trwpromise";
/// The prefix of the private names of items that are being written, moved or removed.
inline constexpr std::string_view passingPrefix = ".trw";
/// The extension of a reference, a small file that stands for a document of a container.
inline constexpr std::string_view referenceExtension = "trwref";
/// The extension of an alias, a small file that stands for another item.
inline constexpr std::string_view aliasExtension = "trwalias";
/// The type of an alias, whose description is never translated.
inline constexpr std::string_view aliasType = "app.tarrow.Drive.alias";

} // namespace host::system
