// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// These reports of the sanitizers come from libraries and not from this program. Every test program of a
// sanitized build contains this file.

extern "C" const char* __lsan_default_suppressions();

// GIO reads the shared MIME database once and keeps it; on the way it leaks the empty tables that it began
// with. Fontconfig keeps its configuration until the process ends. Poppler's glib library leaks a reference
// to every annotation that it makes, and the corners of marked text.
extern "C" const char* __lsan_default_suppressions()
{
    return "leak:libgio-2.0.so\nleak:libfontconfig.so\nleak:libpoppler-glib.so\n";
}
