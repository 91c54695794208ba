// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/desktop/MimeTypeRegistry.h"
#include "host/system/files/FileDescriptor.h"
#include "host/system/files/SystemError.h"
#include "platform/FileSystem.h"
#include "platform/FolderSnapshot.h"

#include <memory>
#include <optional>
#include <string>
#include <string_view>

namespace host::system {

/// The name that the promise of a long name stands for, or why that could not be read.
struct LongNameReading {
    std::string name;
    SystemError failure;

    /// Answers whether the promise may well be there, with a name that it did not say now.
    bool mayBeThere() const;
};

/// Decides from a name and the file system's type alone what a folder's list shows for it. Any thread.
class EntryClassifier {
public:
    explicit EntryClassifier(std::shared_ptr<const MimeTypeRegistry> types)
        : _types(std::move(types))
    {
    }

    /// Answers the entry that the list shows, whose name is the logical one and a part of `name`, or nothing
    /// for a hidden item. A promise is shown as a document, or as a package when its name says so.
    std::optional<platform::FolderEntry> classify(std::string_view name, platform::FileType type) const;
    /// Does so for an entry of an open folder, also for the promise of a long name, which is read into
    /// `longName`. The entry's name is a part of that then.
    std::optional<platform::FolderEntry> classify(const FileDescriptor& folder, std::string_view name,
        platform::FileType type, LongNameReading& longName) const;
    /// Does so for the promise of the item with this name.
    std::optional<platform::FolderEntry> promised(std::string_view name) const;

private:
    platform::FolderEntryKind kindOfFolder(std::string_view name) const;

    std::shared_ptr<const MimeTypeRegistry> _types;
};

} // namespace host::system
