// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <variant>
#include <vector>

namespace platform {

/// The message catalogues of the program. Any thread may ask; no call fails. po/README.md says how texts are
/// written.
class Localization {
public:
    virtual ~Localization() = default;
    /// Answers the text of a key in the user's language. A key is the English text; it is answered itself
    /// when no catalogue has it, and so is the empty key.
    virtual std::string text(const std::string& key) const = 0;
    /// Answers the plural form of a key for a number, with its placeholders. Such keys begin with ".DICT."
    /// and are no texts themselves. A number with a fraction takes the form of a hundred, because the rules
    /// of catalogues know whole numbers only.
    virtual std::string pluralText(const std::string& key, double number) const = 0;
    /// Whether the interface is written from right to left, which is a matter of the catalogue in use and not
    /// of the user's region.
    virtual bool isRightToLeft() const = 0;
};

/// What a placeholder of a text is filled with.
using TextArgument = std::variant<std::string, std::int64_t, double>;

/// Answers the text of a key in the user's language, from the installed Localization.
std::string localized(const std::string& key);
/// Answers the text of a key with its placeholders filled: %@, %d, %g, and numbered ones such as %2$@ (from
/// 1). Whole numbers are written with the language's digits and grouping. Characters of an argument that
/// would turn the direction of the rest of the sentence around (U+202A to U+202E) show as the replacement
/// character, because names come from other people. A placeholder without an argument is filled with nothing.
std::string localized(const std::string& key, const std::vector<TextArgument>& arguments);
/// Answers the plural form that the first argument, a number, chooses, with its placeholders filled in the
/// same way.
std::string localizedPlural(const std::string& key, const std::vector<TextArgument>& arguments);
/// Fills the placeholders of a text that is looked up already, in the same way.
std::string formatText(std::string_view format, const std::vector<TextArgument>& arguments);

} // namespace platform
