// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/files/FileDescriptor.h"
#include "host/system/files/SystemError.h"
#include "host/system/listing/EntryClassifier.h"
#include "host/system/search/NameIndex.h"
#include "host/system/texts/NameFolding.h"

#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace host::system {

/// Reads the names below some folders into an index. Folders that an earlier index knows, and that were not
/// modified since, are taken from it. Links are not followed; folders deeper than `deepestLevel` are left
/// out. Used once, by one thread.
class NameGathering {
public:
    static constexpr std::size_t deepestLevel = 200; ///< one descriptor is open for each level

    struct Handlers {
        std::function<bool()> isCancelled;
        /// Called with what is known so far, less and less often as there is more.
        std::function<void(const NameIndex&)> progress;
    };

    NameGathering(const EntryClassifier& classifier, const NameFolding& folding,
        std::shared_ptr<const NameIndex> earlier, Handlers handlers);

    NameIndex gather(const std::vector<std::string>& roots);
    /// Whether the result differs from the earlier index.
    bool hasChanged() const { return _readFolders > 0 || _keptFolders != _earlierFolders.size(); }

private:
    struct Level {
        std::string path;
        FileDescriptor descriptor;
        std::vector<std::string> subfolders; ///< still to be walked
    };

    void enter(SystemResult<FileDescriptor> folder, std::string path);
    void descend();
    void copy(const NameIndex::Folder& folder, std::vector<std::string>& subfolders);
    void read(const FileDescriptor& descriptor, std::vector<std::string>& subfolders);
    void append(const platform::FolderEntry& entry, std::vector<std::string>& subfolders);
    void reportProgress();

    const EntryClassifier& _classifier;
    const NameFolding& _folding;
    std::shared_ptr<const NameIndex> _earlier;
    std::unordered_map<std::string_view, const NameIndex::Folder*> _earlierFolders;
    Handlers _handlers;
    NameIndex::Builder _builder;
    std::vector<Level> _levels;
    std::size_t _readFolders = 0, _keptFolders = 0, _nextProgress;
    std::string _folded; ///< kept for its memory
};

} // namespace host::system
