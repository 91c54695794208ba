// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/changes/CloudStore.h"

namespace host::drive {

/// Brings the content of a promised document here, on the calling thread: into a file under a private name
/// beside the promise, synced, then renamed to the document's name; the promise goes last. Whatever fails on
/// the way, the promise and its content stay as they were. A document that is here already is no error.
/// Errors: FileErrorCode::NoSuchItem, also for a promise that goes meanwhile; FileErrorCode::ItemExists when
/// another document took the name meanwhile; FileErrorCode::Unsupported for what is no document;
/// CloudErrorCode::MissingContent; ECANCELED when `progress` ended it; else the system's or the store's.
std::optional<platform::Error> bringHere(const DriveLayout& layout, CloudStore& store,
    const std::string& path, const CloudStore::Progress& progress);

} // namespace host::drive
