// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace platform {

/// Uniform type identifiers. Any thread; nothing here reads a document.
class TypeRegistry {
public:
    virtual ~TypeRegistry() = default;

    /// The preferred type for a file-name extension (without its dot, in any case); nothing for an empty or
    /// unknown one.
    virtual std::optional<std::string> typeForExtension(std::string_view extension) const = 0;
    /// Whether a type is another one or a kind of it.
    virtual bool conformsTo(std::string_view type, std::string_view other) const = 0;
    /// What the type is called, in the user's language; nothing for an unknown type.
    virtual std::optional<std::string> description(std::string_view type) const = 0;
    /// The icon theme's name for the type's icon.
    virtual std::string iconName(std::string_view type) const = 0;
};

/// Types with a meaning of their own in the program.
namespace typeIdentifier {
inline constexpr std::string_view data = "public.data";
inline constexpr std::string_view content = "public.content";
inline constexpr std::string_view directory = "public.directory";
inline constexpr std::string_view package = "public.package";
inline constexpr std::string_view symlink = "public.symlink";
inline constexpr std::string_view image = "public.image";
inline constexpr std::string_view movie = "public.movie";
inline constexpr std::string_view audio = "public.audio";
inline constexpr std::string_view text = "public.text";
inline constexpr std::string_view pdf = "public.pdf";
} // namespace typeIdentifier

} // namespace platform
