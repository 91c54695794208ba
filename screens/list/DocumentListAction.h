// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

namespace screens {

/// The actions that a folder list offers for one item, with the codes that it reports.
enum class DocumentListAction : int {
    Delete = 0,
    More = 1,
    Info = 2,
    Rename = 3,
    Share = 4,
    Move = 5,
    PressurePop = 6, ///< opens what a peek showed
};

/// A set of actions: bit n stands for the action with code n.
using DocumentListActionSet = unsigned;

constexpr DocumentListActionSet actionBit(DocumentListAction action)
{
    return 1U << static_cast<int>(action);
}

} // namespace screens
