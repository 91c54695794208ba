// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/ObjectRef.h"

#include <gtksourceview/gtksource.h>

#include <functional>
#include <string>

namespace host::previews {

/// The languages of source code that the desktop can colour.
namespace SourceLanguages {

/// Finds the language of a file name and reads its description off the main thread, because the first read
/// takes longer than a frame for some languages. The answer comes once, on the main queue; it is null for
/// none. Main thread.
using Answer = std::function<void(const gtk::ObjectRef<GtkSourceLanguage>& language)>;
void guess(const std::string& fileName, Answer answer);

} // namespace SourceLanguages

} // namespace host::previews
