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

/// Larger references and aliases are not read. The limit is in bytes.
inline constexpr std::size_t maximumLinkRecordSize = 64 * 1024;

/// Answers the text of a reference to a document, by its container and the path below the container's
/// documents folder.
std::string referenceJson(const std::string& container, const std::string& path);
/// Answers the text of an alias, for a path below the documents area or an absolute one.
std::string aliasJson(const std::string& path);

/// Read a reference or an alias. It is an error when there is none, when it is damaged, or when it leads out
/// of its container (for an alias with a relative path, out of the documents area).
platform::Result<platform::Url> readReference(const std::string& path, const DriveLayout& layout);
platform::Result<platform::Url> readAlias(const std::string& path, const DriveLayout& layout);

/// Answers whether a path is made of plain names: it is not empty, no name is empty, "." or "..", and it has
/// no NUL and at most 4,096 bytes.
bool isPlainRelativePath(std::string_view path);

} // namespace host::drive
