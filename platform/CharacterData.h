#pragma once

namespace platform {

/// Classes of characters in the version of Unicode that the platform follows. Any thread.
class CharacterData {
public:
    virtual ~CharacterData() = default;

    /// Whether a code point is a non-character or is not assigned.
    virtual bool isIllegal(char32_t point) const = 0;
    /// Whether a code point is a control or a format character (general categories Cc and Cf).
    virtual bool isControlOrFormat(char32_t point) const = 0;
};

} // namespace platform
