// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/PreviewSupport.h"

#include <memory>

namespace platform {
class TypeRegistry;
}

namespace host::system {

/// Previews pictures, texts and source code, PDF documents, sounds and films, which it recognises by the
/// name's extension.
class TypePreviewSupport : public platform::PreviewSupport {
public:
    explicit TypePreviewSupport(std::shared_ptr<const platform::TypeRegistry> types)
        : _types(std::move(types))
    {
    }
    bool canPreview(const platform::Url& url) const override;

private:
    std::shared_ptr<const platform::TypeRegistry> _types;
};

} // namespace host::system
