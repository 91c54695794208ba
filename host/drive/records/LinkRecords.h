// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/records/DriveLayout.h"
#include "host/system/files/DriveNames.h"
#include "platform/Error.h"
#include "platform/Url.h"

#include <string>
#include <string_view>

namespace host::drive {

using system::referenceExtension;

/// Largest reference or alias that is read, in bytes.
inline constexpr std::size_t maximumLinkRecordSize = 64 * 1024;

/// The text of a reference to a document, by its container and the path below the container's documents
/// folder.
std::string referenceJson(const std::string& container, const std::string& path);
/// The text of an alias: a path below the documents area, or an absolute one.
std::string aliasJson(const std::string& path);

/// Reads a reference or an alias. Errors: there is none, it is damaged, or it leads out of its container (the
/// documents area for an alias with a relative path).
platform::Result<platform::Url> readReference(const std::string& path, const DriveLayout& layout);
platform::Result<platform::Url> readAlias(const std::string& path, const DriveLayout& layout);

/// Whether a path is made of plain names: not empty, none of them empty, "." or "..", no NUL, at most 4,096
/// bytes.
bool isPlainRelativePath(std::string_view path);

} // namespace host::drive
