// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/changes/CloudStore.h"

#include <functional>
#include <optional>

namespace host::drive {

/// Runs the steps in which the document takes its promise's place, and keeps other writers of the item out
/// meanwhile. Answers why it could not; the steps did not run then.
using KeepingOthersOut = std::function<std::optional<platform::Error>(const std::function<void()>& steps)>;

/// Downloads the content of a promised document, package or folder on the calling thread. The content goes
/// into a file or folder under a private name beside the promise. With what the promise says by then, it is
/// synced and gets the document's name; the promise is removed last, and only if it still names this content.
/// After any failure the promise and its content are as they were, and after a power cut in the seconds that
/// follow they may be again. A document that is already downloaded, also by another program meanwhile, is no
/// error. Errors: FileErrorCode::NoSuchItem, also when the promise is moved or deleted meanwhile;
/// FileErrorCode::ItemExists when another document took the name meanwhile; CloudErrorCode::MissingContent;
/// EOPNOTSUPP when the promise is one of a folder and the content a file, or the other way round; ECANCELED
/// when `progress` ended it; else the system's or the store's.
std::optional<platform::Error> bringHere(const DriveLayout& layout, CloudStore& store,
    const std::string& path, const CloudStore::Progress& progress, const KeepingOthersOut& keepingOthersOut);

} // namespace host::drive
