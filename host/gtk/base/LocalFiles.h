// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Url.h"

#include <gdk/gdk.h>

#include <vector>

namespace host::gtk {

/// Files that a person chose in another program.
struct LocalFiles {
    std::vector<platform::Url> files; ///< those with a path on this machine
    bool areAll = true; ///< false: others have none, and were left out

    void add(GFile* file);
    static LocalFiles of(GListModel* files);
    static LocalFiles of(const GSList* files);
};

/// Answers a new provider of files for the clipboard or a drag, in the forms that programs ask for: the
/// toolkit's list of files with all that it is converted to, and the list of copied files that file managers
/// have.
GdkContentProvider* contentOf(const std::vector<platform::Url>& files);

} // namespace host::gtk
