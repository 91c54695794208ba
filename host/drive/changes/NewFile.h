// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/changes/DriveEntry.h"
#include "host/drive/changes/ItemTraits.h"
#include "host/drive/changes/TreeWalk.h"
#include "host/drive/changes/WorkRecord.h"

#include <optional>
#include <string>

namespace host::drive {

/// A file that is being written in its final folder, under a private name until it is whole, or a folder with
/// everything in it. What is not published is removed by the destructor, or at the next start if the process
/// was killed.
///
/// A file replaces a document by exchanging the two names in one step and comparing what comes out with the
/// expected version. When another program has saved meanwhile, the names are exchanged back, as often as yet
/// another version comes out, so that the newest one has the name in the end.
class NewFile {
public:
    /// Creates the empty file beside an entry.
    static system::SystemResult<NewFile> create(const DriveLayout& layout, const DriveEntry& entry)
    {
        return create(layout, entry, {});
    }
    /// Creates the promise of a document that is evicted, whose content gets this name.
    static system::SystemResult<NewFile> create(
        const DriveLayout& layout, const DriveEntry& entry, const std::string& content);

    /// Creates an empty folder beside an entry, in the same way. Whoever fills it syncs what is in it.
    static system::SystemResult<NewFile> createFolder(const DriveLayout& layout, const DriveEntry& entry);

    NewFile(NewFile&& other) noexcept;
    NewFile& operator=(NewFile&&) = delete;
    ~NewFile();

    const system::FileDescriptor& descriptor() const { return _file; }
    /// Answers the versions of everything in it, and the bytes of all files, while it has its private name.
    system::SystemResult<TreeVersions> versions() const { return readVersions(_folder, _name); }
    system::SystemResult<std::uint64_t> bytes() const;
    /// Writes a text.
    system::SystemError write(std::string_view text) const;
    /// Says what is on the disk when publish() answers. The content alone is enough where what stood for it
    /// stays until the name is there, too; nothing for a file without content that its caller syncs.
    enum class Sync : std::uint8_t { Nothing, Content, ContentAndName };
    /// Gives the file or folder its name. It never replaces anything (EEXIST). The record for the next start
    /// stays until the end.
    system::SystemError publish(
        const DriveEntry& entry, const std::string& name, Sync sync = Sync::ContentAndName);
    /// Syncs the file and gives it the name of the `expected` version, which is removed for good. What became
    /// of that version's traits since it had `traits` is done to this file, too. Answers the new version, or
    /// ECANCELED when another version had taken the name, which it has then again. A version that nobody
    /// asked for is kept under a private name, and is in the trash after the next start.
    system::SystemResult<platform::ItemVersion> replace(const DriveLayout& layout, const DriveEntry& entry,
        const platform::ItemVersion& expected, const ItemTraits& traits);
    /// Leaves the record for the next start, which settles what is at the entry then.
    void keepRecord() { _record->keep(); }

private:
    NewFile() = default;
    static system::SystemResult<NewFile> begin(const DriveLayout& layout, const DriveEntry& entry,
        const std::string& name, const std::string& content);
    system::SystemError takeHeldName(
        const DriveLayout& layout, const DriveEntry& entry, const platform::ItemVersion& expected);
    system::SystemError exchange(const DriveEntry& entry) const;
    system::SystemResult<platform::ItemVersion> finishExchange(
        const DriveEntry& entry, const platform::ItemVersion& expected, const ItemTraits& traits) const;
    system::SystemError adoptChanges(const ItemTraits& traits) const;
    void exchangeBack(const DriveEntry& entry) const;
    bool isUnderPrivateName() const;

    std::optional<WorkRecord> _record;
    system::FileDescriptor _folder, _file;
    std::string _name; ///< empty once the file is published
};

} // namespace host::drive
