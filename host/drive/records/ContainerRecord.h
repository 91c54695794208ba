// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/DocumentContainers.h"

#include <map>
#include <optional>
#include <string>
#include <vector>

namespace host::drive {

/// A container's description as it is stored on disk.
struct ContainerRecord {
    /// Larger descriptions are not read. The limit is in bytes.
    static constexpr std::size_t maximumFileSize = 256 * 1024;

    std::map<std::string, std::string> names; ///< by language ("de", "pt_BR")
    std::vector<platform::DocumentType> documentTypes;
    std::optional<std::string> supportedFolderLevels;
    std::vector<std::string> owningApps;
    std::optional<std::string> iconName;

    /// Answers nothing for a text that is not a JSON object. A member of the wrong type counts as missing.
    static std::optional<ContainerRecord> parse(const std::string& content);
    std::string toJson() const;

    /// Answers the name in the first of the languages that has one, else the English name, else any, else an
    /// empty text.
    std::string nameIn(const std::vector<std::string>& languages) const;
};

} // namespace host::drive
