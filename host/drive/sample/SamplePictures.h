// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <string>

namespace host::drive::sample {

/// These draw pictures for the sample drive; each answers the bytes of a file. `variant` chooses colours and
/// shapes.
std::string landscapeJpeg(int variant);
std::string portraitPng(int variant); ///< a cat on a cushion
std::string windowShotPng(); ///< a picture of a screen
std::string chartSvg();
std::string sketchSvg(int variant);

} // namespace host::drive::sample
