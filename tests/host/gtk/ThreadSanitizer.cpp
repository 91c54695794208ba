// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// The libraries of the toolkit are not built for the sanitizer of threads, which therefore sees neither their
// atomic operations nor their mutexes and takes what they do on their own threads for races. These entries
// name the libraries that make such calls; a race in this program is still reported.

// NOLINTNEXTLINE(bugprone-reserved-identifier): the sanitizer's name
extern "C" const char* __tsan_default_suppressions();

// NOLINTNEXTLINE(bugprone-reserved-identifier)
extern "C" const char* __tsan_default_suppressions()
{
    return "called_from_lib:libglib-2.0.so.0\n"
           "called_from_lib:libgio-2.0.so.0\n"
           "called_from_lib:libgobject-2.0.so.0\n"
           "called_from_lib:libgtk-4.so.1\n"
           "called_from_lib:libadwaita-1.so.0\n"
           "called_from_lib:libpango-1.0.so.0\n"
           "called_from_lib:libpangocairo-1.0.so.0\n"
           "called_from_lib:libpangoft2-1.0.so.0\n"
           "called_from_lib:libfontconfig.so.1\n"
           "called_from_lib:libcairo.so.2\n"
           "mutex:libmedia-gstreamer.so\n"
           "mutex:libgtksourceview-5.so.0\n"
           "deadlock:libX11.so.6\n"
           "race:libgstreamer-1.0.so\n"
           "race:libgstcoreelements.so\n";
}
