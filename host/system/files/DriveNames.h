// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <string_view>

namespace host::system {

/// Names that mean something in the drive's folders. The promise of NAME is the file ".NAME" with this
/// suffix.
inline constexpr std::string_view promiseSuffix = ".trwpromise";
/// How the names begin that the drive gives to what is only on its way: being written, moved or removed.
inline constexpr std::string_view passingPrefix = ".trw";
/// Extension of a reference: a small file that stands for a document of a container.
inline constexpr std::string_view referenceExtension = "trwref";
/// Extension of an alias: a small file that stands for another item.
inline constexpr std::string_view aliasExtension = "trwalias";
/// Type of an alias, whose description is never translated.
inline constexpr std::string_view aliasType = "app.tarrow.Drive.alias";

} // namespace host::system
