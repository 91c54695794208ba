// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

namespace tarrow {

/// How a document is previewed. The modes are signed integers, because they are stored in the saved state of
/// the interface.
inline constexpr int PreviewModeQuick = 0; ///< the shared quick preview
inline constexpr int PreviewModeDetails = 1; ///< the details screen

} // namespace tarrow
