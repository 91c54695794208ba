// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/records/DriveLayout.h"
#include "host/drive/records/PromiseRecord.h"
#include "platform/Error.h"

#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace host::drive::sample {

/// The attributes of a sample item beside its content.
struct Traits {
    int daysAgo = 30; ///< the age of its last change
    std::vector<std::string> tags;
    std::optional<platform::SharedItemRole> sharedAs; ///< absent: the item is not shared
    bool extensionHidden = false;
};

/// Adds items to a drive and never touches existing ones: an item whose name is taken, by an item or a
/// promise, is left out. Paths are relative to the documents area; missing folders are made. After the first
/// failure, which is kept, nothing more is written.
class SampleWriter {
public:
    /// Makes the content; called only when the item is missing.
    using Content = std::function<std::string()>;

    explicit SampleWriter(DriveLayout layout)
        : _layout(std::move(layout))
    {
    }

    const std::optional<platform::Error>& error() const { return _error; }
    int written() const { return _written; }

    void folder(const std::string& path, const Traits& traits = {});
    /// Adds a folder that its own user may not read.
    void lockedFolder(const std::string& path);
    void document(const std::string& path, const Content& content, const Traits& traits = {});
    /// Adds an item whose content is only in the cloud.
    void promised(const std::string& path, const Content& content, const Traits& traits = {});
    void link(const std::string& path, const std::string& target);
    /// Adds a file of the drive itself, by its absolute path.
    void record(const std::string& absolutePath, const std::string& content);

private:
    bool isTaken(const std::string& absolutePath) const;
    bool write(const std::string& absolutePath, std::string_view content);
    void decorate(const std::string& absolutePath, const Traits& traits);
    bool makeFolders(const std::string& absolutePath);
    bool fail(int errorNumber, const std::string& path);
    std::string absolute(const std::string& path) const { return _layout.documents() + '/' + path; }

    DriveLayout _layout;
    std::optional<platform::Error> _error;
    int _written = 0;
};

} // namespace host::drive::sample
