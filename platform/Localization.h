// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <variant>
#include <vector>

namespace platform {

/// The message catalogues. Any thread.
class Localization {
public:
    virtual ~Localization() = default;
    /// The text of a key in the user's language; the key itself when the catalogue has none.
    virtual std::string text(const std::string& key) const = 0;
    /// The plural form of a key (these begin with ".DICT.") for a number.
    virtual std::string pluralText(const std::string& key, double number) const = 0;
    /// Whether the interface is written from right to left.
    virtual bool isRightToLeft() const = 0;
};

using TextArgument = std::variant<std::string, std::int64_t, double>;

/// The text of a key, in the user's language.
std::string localized(const std::string& key);
/// The text of a key with its placeholders filled: %@, %d, %g, and numbered ones such as %2$@. Numbers are
/// written with the language's digits; marks in a text that would turn the rest of the sentence around show
/// as the replacement character.
std::string localized(const std::string& key, const std::vector<TextArgument>& arguments);
/// The plural form that the first argument, a number, chooses, with its placeholders filled.
std::string localizedPlural(const std::string& key, const std::vector<TextArgument>& arguments);
/// Fills the placeholders of a text that needs no look-up.
std::string formatText(std::string_view format, const std::vector<TextArgument>& arguments);

} // namespace platform
