// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/DetailText.h"

#include "platform/Localization.h"
#include "screens/PlatformNames.h"

namespace screens {

namespace {

std::string joined(const char* format, const std::string& first, const std::string& second)
{
    if (first.empty() || second.empty())
        return first + second;
    return localized(format, {first, second});
}

} // namespace

std::string joinedDetails(const std::string& first, const std::string& second)
{
    return joined("%1$@ · %2$@", first, second);
}

std::string joinedPlace(const std::string& folder, const std::string& inner)
{
    return joined("%1$@ › %2$@", folder, inner);
}

} // namespace screens
