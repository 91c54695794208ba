// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// What the sanitizers find in libraries and not in this program. Part of every test program of a sanitized
// build.

extern "C" const char* __lsan_default_suppressions();

// GIO reads the shared MIME database once and keeps it; on the way it loses the empty tables that it began
// with. Fontconfig keeps its configuration until the process ends. Poppler's glib library loses a reference
// to every annotation that it makes, and the corners of a marked text.
extern "C" const char* __lsan_default_suppressions()
{
    return "leak:libgio-2.0.so\nleak:libfontconfig.so\nleak:libpoppler-glib.so\n";
}
