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

/// Reads the names below some folders into an index. Folders that an earlier index has, and that were not
/// modified since, are copied from it. Links are not followed, and folders deeper than `deepestLevel` are
/// left out. It is used once, by one thread.
class NameGathering {
public:
    static constexpr std::size_t deepestLevel = 200; ///< one descriptor is open for each level

    struct Handlers {
        std::function<bool()> isCancelled;
        /// Called with the index so far, less and less often as it grows.
        std::function<void(const NameIndex&)> progress;
    };

    NameGathering(const EntryClassifier& classifier, const NameFolding& folding,
        std::shared_ptr<const NameIndex> earlier, Handlers handlers);

    NameIndex gather(const std::vector<std::string>& roots);
    /// Answers whether the result differs from the earlier index.
    bool hasChanged() const { return _readFolders > 0 || _keptFolders != _earlierFolders.size(); }

private:
    struct Level {
        std::string path;
        FileDescriptor descriptor;
        std::vector<std::string> subfolders; ///< subfolders that are still to be read
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
    std::string _folded; ///< kept to reuse its memory
};

} // namespace host::system
