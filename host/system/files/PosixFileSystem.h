// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/FileSystem.h"

namespace host::system {

/// The kernel's file system. Enumeration works with descriptors, of which few are open however deep the
/// folders lie; it opens only folders.
class PosixFileSystem : public platform::FileSystem {
public:
    platform::Result<platform::FileAttributes> attributesOfItem(const std::string& path) const override;
    platform::Result<std::string> destinationOfSymbolicLink(const std::string& path) const override;
    std::optional<platform::FileType> typeOfItem(const std::string& path) const override;
    std::optional<platform::Url> userDocumentsFolder() const override;
    void enumerateDeeply(const platform::Url& folder,
        const std::function<Continue(const platform::Url&, platform::FileType)>& entry,
        const std::function<Continue(const platform::Url&, const platform::Error&)>& error) const override;
    void enumerateShallowly(const platform::Url& folder,
        const std::function<Continue(const platform::Url&, platform::FileType)>& entry,
        const std::function<Continue(const platform::Url&, const platform::Error&)>& error) const override;
};

/// The extended attribute that hides a file's extension. Its value is "1".
inline constexpr const char* hiddenExtensionAttribute = "user.tarrow.hidden-extension";

} // namespace host::system
