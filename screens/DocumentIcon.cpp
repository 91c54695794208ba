// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "screens/DocumentIcon.h"

#include "platform/Services.h"
#include "platform/TypeRegistry.h"
#include "screens/DisplayName.h"

namespace screens {

namespace {

double points(DocumentIconFormat format)
{
    switch (format) {
    case DocumentIconFormat::Large:
        return 64;
    }
    return 0;
}

} // namespace

Image documentIcon(std::string_view typeIdentifier, std::string_view name, DocumentIconFormat format)
{
    return Image::named(documentIconName(typeIdentifier, name), points(format));
}

std::string documentIconName(std::string_view typeIdentifier, std::string_view name)
{
    const auto& types = services().typeRegistry();
    if (!typeIdentifier.empty() && typeIdentifier != platform::typeIdentifier::data)
        return types.iconName(typeIdentifier);
    const auto type = types.typeForExtension(nameExtension(name));
    return type ? types.iconName(*type) : "text-x-generic";
}

} // namespace screens
