// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace platform {

/// Knows the types of documents. A uniform type identifier such as "public.png" names a type; on Linux a MIME
/// type without one is "dyn.mime." and its name. Types are judged by names alone, so nothing here reads a
/// document. Any thread may call; answers are kept, because every row of a list needs them.
class TypeRegistry {
public:
    virtual ~TypeRegistry() = default;

    /// Answers the preferred type for the extension of a file name, given without its dot and in any letter
    /// case. It answers nothing for an empty or unknown extension.
    virtual std::optional<std::string> typeForExtension(std::string_view extension) const = 0;
    /// Whether a type is another one or a kind of it, at any distance: "public.png" is a kind of
    /// "public.image".
    virtual bool conformsTo(std::string_view type, std::string_view other) const = 0;
    /// Answers what the type is called, in the user's language, such as "PNG image"; nothing for an unknown
    /// type.
    virtual std::optional<std::string> description(std::string_view type) const = 0;
    /// Answers the name of the type's icon in the icon theme, a general one for types without their own;
    /// never empty.
    virtual std::string iconName(std::string_view type) const = 0;
};

/// The types that the program treats in a way of their own.
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
