# SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
# SPDX-License-Identifier: GPL-3.0-or-later

find_package(PkgConfig REQUIRED)
find_package(Threads REQUIRED)

function(trw_package target)
    pkg_check_modules(${target} REQUIRED IMPORTED_TARGET GLOBAL ${ARGN})
    add_library(trw_dep_${target} INTERFACE)
    target_link_libraries(trw_dep_${target} INTERFACE PkgConfig::${target})
endfunction()

trw_package(glib glib-2.0 gobject-2.0 gio-2.0 gio-unix-2.0)
trw_package(gtk gtk4 libadwaita-1)
trw_package(atspi atspi-2 gobject-2.0)
trw_package(icu icu-i18n icu-uc)
trw_package(sqlite sqlite3)
trw_package(cairo cairo)
trw_package(pango pangocairo)
trw_package(pixbuf gdk-pixbuf-2.0)
trw_package(poppler poppler-glib)
trw_package(sourceview gtksourceview-5)
trw_package(gstreamer gstreamer-1.0)
trw_package(uchardet uchardet)
find_package(nlohmann_json 3.11 REQUIRED)
