// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/texts/NameFolding.h"
#include "platform/CharacterData.h"

namespace host::system {

/// Character classes from the Unicode data of the installed library.
class UnicodeCharacterData : public platform::CharacterData {
public:
    bool isIllegal(char32_t point) const override;
    bool isControlOrFormat(char32_t point) const override;
    void appendFolded(std::string_view text, std::string& folded) const override
    {
        _folding.append(text, folded);
    }

private:
    NameFolding _folding;
};

} // namespace host::system
