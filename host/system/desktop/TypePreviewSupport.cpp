// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/desktop/TypePreviewSupport.h"

#include "platform/TypeRegistry.h"

#include <algorithm>

namespace host::system {

bool TypePreviewSupport::canPreview(const platform::Url& url) const
{
    namespace types = platform::typeIdentifier;
    static constexpr std::string_view shown[] = {
        types::image, types::text, types::pdf, types::audio, types::movie};
    if (!url.isFileURL() || url.hasDirectoryPath())
        return false;
    const auto type = _types->typeForExtension(url.pathExtension());
    return type && std::ranges::any_of(shown, [&](auto other) { return _types->conformsTo(*type, other); });
}

} // namespace host::system
