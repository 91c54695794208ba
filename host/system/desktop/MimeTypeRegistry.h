// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/TypeRegistry.h"

#include <memory>
#include <string>
#include <string_view>

namespace host::system {

class TypeGraph;

/// Types by the table of TypeTable.h and, beyond it, by the shared MIME database, where "dyn.mime.text/x-ada"
/// is the identifier of the MIME type "text/x-ada". Everything is decided by names. Any thread; repeated
/// questions are answered from memory.
class MimeTypeRegistry : public platform::TypeRegistry {
public:
    MimeTypeRegistry();
    ~MimeTypeRegistry() override;

    std::optional<std::string> typeForExtension(std::string_view extension) const override;
    bool conformsTo(std::string_view type, std::string_view other) const override;
    std::optional<std::string> description(std::string_view type) const override;
    std::string iconName(std::string_view type) const override;

    /// Answers whether a folder with this extension is shown as one document.
    bool isPackageExtension(std::string_view extension) const;
    /// Answers the preferred MIME type of a type, or nothing for a type without one.
    std::optional<std::string> mimeType(std::string_view type) const;
    /// Answers the type of a MIME type.
    std::string typeForMimeType(std::string_view mimeType) const;

private:
    class AnswerCache;
    std::unique_ptr<TypeGraph> _graph;
    std::unique_ptr<AnswerCache> _extensions, _descriptions;
};

} // namespace host::system
