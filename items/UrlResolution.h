// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "items/PlatformNames.h"

#include <optional>
#include <vector>

namespace tarrow {

// Where an item really lives, and what may be done with it there. Any thread; no call downloads anything.

/// The URL itself when it is no reference to a document elsewhere; else the logical location of the document
/// that it refers to, or nothing when the reference cannot be read.
std::optional<Url> trw_URLByResolvingBookmark(const Url& url);

/// The logical location of a promise; the URL itself when it is none.
Url trw_URLByResolvingPromise(const Url& url);

/// Like trw_URLByResolvingBookmark(), but answers the URL itself for a reference that cannot be read.
Url trw_URLByResolvingAlias(const Url& url);

/// Whether this is the Desktop or the Documents folder at the top of the default container. Those two are
/// never moved, renamed or deleted.
bool trw_isDesktopOrDocumentsFolder(const Url& url);

/// Whether the destinations of a move may include other containers. The first item alone decides.
bool trw_canCrossZoneMoveURLs(const std::vector<Url>& urls);

} // namespace tarrow
