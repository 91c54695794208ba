#pragma once

#include "platform/CharacterData.h"

namespace host::system {

/// Character classes from the Unicode data of the installed library.
class UnicodeCharacterData : public platform::CharacterData {
public:
    bool isIllegal(char32_t point) const override;
    bool isControlOrFormat(char32_t point) const override;
};

} // namespace host::system
