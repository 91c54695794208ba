// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/DocumentContainers.h"

#include <map>
#include <optional>
#include <string>
#include <vector>

namespace host::drive {

/// A container's description as it is on disk.
struct ContainerRecord {
    /// Largest description that is read, in bytes.
    static constexpr std::size_t maximumFileSize = 256 * 1024;

    std::map<std::string, std::string> names; ///< by language ("de", "pt_BR")
    std::vector<platform::DocumentType> documentTypes;
    std::optional<std::string> supportedFolderLevels;
    std::vector<std::string> owningApps;
    std::optional<std::string> iconName;

    /// Nothing for a text that is no JSON object. A field of the wrong kind is as if it were not there.
    static std::optional<ContainerRecord> parse(const std::string& text);
    std::string toJson() const;

    /// The name in the first of the languages that there is one for, else the English one, else any, else
    /// empty.
    std::string nameIn(const std::vector<std::string>& languages) const;
};

} // namespace host::drive
