# SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
# SPDX-License-Identifier: GPL-3.0-or-later

# cmake -D FILE=<source> -P WriteBuildDate.cmake writes a source that says when the program was built, in the form of the
# compiler's __DATE__ and __TIME__. Where SOURCE_DATE_EPOCH is set its time stands for the clock's, in UTC, so that two
# builds of one source are the same, whichever compiler makes them.

set(zone "")
if(DEFINED ENV{SOURCE_DATE_EPOCH})
    set(zone UTC)
endif()
string(TIMESTAMP date "%b %d %Y @ %H:%M:%S" ${zone})
string(REGEX REPLACE " 0([1-9]) " "  \\1 " date ${date})
file(WRITE ${FILE} "#include \"app/BuildDate.h\"\n\nconst char* const buildDate = \"${date}\";\n")
