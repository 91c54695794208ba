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

/// What is to be known of a sample item beside its content.
struct Traits {
    int daysAgo = 30; ///< when it was last changed
    std::vector<std::string> tags;
    std::optional<platform::SharedItemRole> sharedAs; ///< nothing: not shared
    bool extensionHidden = false;
};

/// Puts items into a drive and never touches what is there already: an item whose name is taken, here or by a
/// promise, is left out. Paths are relative to the documents area; folders that lead to an item are made. The
/// first failure is kept, and after it nothing more is written.
class SampleWriter {
public:
    /// Content that is made only when the item is missing.
    using Content = std::function<std::string()>;

    explicit SampleWriter(const DriveLayout& layout)
        : _layout(layout)
    {
    }

    const std::optional<platform::Error>& error() const { return _error; }
    int written() const { return _written; }

    void folder(const std::string& path, const Traits& traits = {});
    /// A folder that its own user may not read.
    void lockedFolder(const std::string& path);
    void document(const std::string& path, const Content& content, const Traits& traits = {});
    /// An item whose content is in the cloud only.
    void promised(const std::string& path, const Content& content, const Traits& traits = {});
    void link(const std::string& path, const std::string& target);
    /// A file of the drive itself, by its absolute path.
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
