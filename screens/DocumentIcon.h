// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Image.h"
#include "screens/PlatformNames.h"

#include <string>
#include <string_view>

namespace screens {

/// The sizes that the platform has for a document's icon, by its own numbers.
enum class DocumentIconFormat : int {
    Large = 12, ///< 64 points, for a screen that shows one document
};

/// Answers the icon of a document of this type and name. A type that says nothing about the document, such as
/// an empty one, leaves it to the name's extension. It is never without a name, and its size in points is the
/// format's. Any thread.
Image documentIcon(std::string_view typeIdentifier, std::string_view name, DocumentIconFormat format);

/// Answers the name of that icon, for those who give it a size where they show it.
std::string documentIconName(std::string_view typeIdentifier, std::string_view name);

} // namespace screens
