// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/list/DocumentListControllerDelegate.h"

#include "kit/values/StandardColors.h"

namespace screens {

std::vector<kit::TagDot> DocumentListControllerDelegate::documentListControllerDotsForTagNames(
    const List&, const std::vector<std::string>& names)
{
    return {names.size(), {kit::StandardColors::gray, kit::StandardColors::lightGray}};
}

} // namespace screens
