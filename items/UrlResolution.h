// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "items/PlatformNames.h"

#include <optional>
#include <vector>

namespace tarrow {

// These find the real location of an item and tell what may be done with it. Any thread; no call downloads
// anything.

/// Answers the URL itself when it is not a reference to a document elsewhere. Otherwise it answers the
/// logical location of that document, or nothing when the reference cannot be read.
std::optional<Url> trw_URLByResolvingBookmark(const Url& url);

/// Answers the logical location of a promise, or the URL itself when it is not a promise.
Url trw_URLByResolvingPromise(const Url& url);

/// Works like trw_URLByResolvingBookmark(), but answers the URL itself for a reference that cannot be read.
Url trw_URLByResolvingAlias(const Url& url);

/// Answers whether this is the Desktop or the Documents folder at the top of the default container. Those two
/// are never moved, renamed or deleted.
bool trw_isDesktopOrDocumentsFolder(const Url& url);
/// Answers whether the path is the one of such a folder, without a look at the disk. It is not one of them
/// when it is in no container.
bool trw_hasPathOfSpecialFolder(const Url& url);
/// Answers the same for an item of a container that was looked up before, without a look at the disk.
bool trw_isDesktopOrDocumentsFolderIn(const DocumentContainer& container, const Url& url);

/// Answers whether the destinations of a move may include other containers. The first item alone decides.
bool trw_canCrossZoneMoveURLs(const std::vector<Url>& urls);

} // namespace tarrow
