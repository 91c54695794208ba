// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

/// When the program was built, for example "Jul 28 2016 @ 20:38:48". The build writes the definition
/// (cmake/WriteBuildDate.cmake), which follows SOURCE_DATE_EPOCH where that is set.
extern const char* const buildDate;
