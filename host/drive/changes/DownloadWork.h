// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/changes/CloudStore.h"

namespace host::drive {

/// Downloads the content of a promised document on the calling thread. The content goes into a file under a
/// private name beside the promise, is synced, and then renamed to the document's name; the promise is
/// removed last. After any failure the promise and its content are as they were. A document that is already
/// downloaded is no error. Errors: FileErrorCode::NoSuchItem, also when the promise disappears meanwhile;
/// FileErrorCode::ItemExists when another document took the name meanwhile; FileErrorCode::Unsupported for an
/// item that is not a document; CloudErrorCode::MissingContent; ECANCELED when `progress` ended it; else the
/// system's or the store's.
std::optional<platform::Error> bringHere(const DriveLayout& layout, CloudStore& store,
    const std::string& path, const CloudStore::Progress& progress);

} // namespace host::drive
