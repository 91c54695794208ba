// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/FolderSnapshot.h"
#include "platform/Url.h"
#include "screens/PlatformNames.h"

#include <string>

namespace screens {

/// The item of a row, be it in a folder's list or in the results of a search.
struct RowItem {
    Url url;
    FolderEntryKind kind;
    bool isPromise; ///< only a promise of the item is here
    std::string title; ///< what the row calls it
};

} // namespace screens
