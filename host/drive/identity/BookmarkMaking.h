// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/identity/Bookmark.h"
#include "host/drive/records/DriveLayout.h"
#include "platform/Error.h"
#include "platform/Url.h"

#include <cstdint>
#include <functional>
#include <string>

namespace host::drive {

/// Answers the document identifier of the item at a path below the drive's home, and gives the item one when
/// it has none. Answers 0 when it cannot have one.
using IdentifyDocument = std::function<std::uint32_t(const std::string& relativePath)>;

/// Answers the bookmark string of an item of the drive, present or promised. The error is
/// CloudErrorCode::NotBookmarkable when another device could not open the item: for an item outside the
/// containers' documents folders or one that does not exist, for a name that is not UTF-8 when there is no
/// identifier, and when nobody is signed in. Any thread; reads the disk.
platform::Result<std::string> makeBookmark(
    const DriveLayout& layout, const platform::Url& url, const IdentifyDocument& identify);

} // namespace host::drive
