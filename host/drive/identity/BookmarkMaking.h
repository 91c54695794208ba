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

/// Answers the document identifier of the item at a path below the drive's home, giving it one when it has
/// none; 0 when it can have none.
using IdentifyDocument = std::function<std::uint32_t(const std::string& relativePath)>;

/// The bookmark string of an item of the drive, present or promised. CloudErrorCode::NotBookmarkable for what
/// another device could not open: what lies outside the documents folders of the containers or is gone, a
/// name that is no text where there is no identifier, and where nobody is signed in. Any thread; reads the
/// disk.
platform::Result<std::string> makeBookmark(
    const DriveLayout& layout, const platform::Url& url, const IdentifyDocument& identify);

} // namespace host::drive
