// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/changes/TreeWalk.h"

#include "host/drive/changes/DriveEntry.h"
#include "host/drive/records/BeneathRoot.h"
#include "host/system/files/DirectoryReader.h"

#include <fcntl.h>

#include <cerrno>
#include <memory>

namespace host::drive {

using host::system::DirectoryReader;
using host::system::FileDescriptor;
using host::system::openFolderAt;
using host::system::SystemError;
using host::system::SystemResult;

namespace {

/// Walks through a folder one level at a time, with two descriptors however deep the folders lie.
class Walk {
public:
    Walk(TreeVisitor& visitor, Mounts mounts)
        : _visitor(visitor)
        , _open(mounts == Mounts::Enter ? openFolderAt : openSubfolder)
    {
    }
    SystemError run(const FileDescriptor& parent, const std::string& name)
    {
        auto folder = _open(parent, name);
        if (!folder)
            return folder.error;
        _current = std::move(*folder);
        TRW_TRY(enter());
        while (!_levels.empty())
            TRW_TRY(_levels.back().subfolders.empty() ? leave() : descend());
        return _visitor.leaveFolder(parent, name);
    }

private:
    struct Level {
        dev_t device;
        ino_t inode;
        std::vector<std::string> subfolders;
    };

    /// Visits the items in the current folder and notes its subfolders.
    SystemError enter()
    {
        struct stat self;
        if (::fstat(_current.get(), &self) != 0)
            return SystemError::last();
        auto names = readNames(_current);
        if (!names)
            return names.error;
        TRW_TRY(_visitor.enterFolder(_current, self, *names));
        std::vector<std::string> subfolders;
        for (auto& name : *names)
            TRW_TRY(visit(name, subfolders));
        _levels.push_back({self.st_dev, self.st_ino, std::move(subfolders)});
        return {};
    }
    SystemError visit(std::string& name, std::vector<std::string>& subfolders)
    {
        const auto found = statusAt(_current, name);
        if (!found)
            return found.error.is(ENOENT) ? SystemError() : found.error;
        if (!S_ISDIR(found->st_mode))
            return _visitor.visitItem(_current, name, *found);
        subfolders.push_back(std::move(name));
        return {};
    }
    SystemError descend()
    {
        auto below = _open(_current, _levels.back().subfolders.back());
        if (!below)
            return below.error;
        _current = std::move(*below);
        return enter();
    }
    SystemError leave()
    {
        _levels.pop_back();
        if (_levels.empty())
            return {};
        auto above = openFolderAt(_current, "..");
        if (!above)
            return above.error;
        struct stat found;
        // When another program moved the folder away, its contents went along, and the walk must not enter
        // its new parent.
        if (::fstat(above->get(), &found) != 0)
            return SystemError::last("..");
        auto& level = _levels.back();
        if (found.st_dev != level.device || found.st_ino != level.inode)
            return {ESTALE, level.subfolders.back()};
        _current = std::move(*above);
        const auto name = std::move(level.subfolders.back());
        level.subfolders.pop_back();
        return _visitor.leaveFolder(_current, name);
    }

    TreeVisitor& _visitor;
    SystemResult<FileDescriptor> (*_open)(const FileDescriptor&, const std::string&);
    FileDescriptor _current;
    std::vector<Level> _levels;
};

class Removal : public TreeVisitor {
public:
    SystemError visitItem(const FileDescriptor& folder, const std::string& name, const struct stat&) override
    {
        return SystemError::unless(::unlinkat(folder.get(), name.c_str(), 0) == 0 || errno == ENOENT, name);
    }
    SystemError enterFolder(
        const FileDescriptor& folder, const struct stat& self, const std::vector<std::string>&) override
    {
        // A copy of a folder that nobody may write in cannot be written in either.
        if ((self.st_mode & S_IRWXU) != S_IRWXU)
            ::fchmod(folder.get(), self.st_mode | S_IRWXU);
        return {};
    }
    SystemError leaveFolder(const FileDescriptor& parent, const std::string& name) override
    {
        return SystemError::unless(::unlinkat(parent.get(), name.c_str(), AT_REMOVEDIR) == 0, name);
    }
};

class VersionReading : public TreeVisitor {
public:
    SystemError visitItem(const FileDescriptor&, const std::string&, const struct stat& found) override
    {
        note(found);
        return {};
    }
    SystemError enterFolder(
        const FileDescriptor&, const struct stat& self, const std::vector<std::string>&) override
    {
        note(self);
        return {};
    }
    TreeVersions versions;

private:
    void note(const struct stat& found)
    {
        auto version = versionOf(found);
        if (versions.empty())
            version.changed = 0;
        versions.emplace(std::pair(version.device, version.inode), version);
    }
};

} // namespace

SystemResult<std::vector<std::string>> readNames(const FileDescriptor& folder)
{
    std::vector<std::string> names;
    const auto reader = std::make_unique<DirectoryReader>(folder);
    while (const auto entry = reader->next())
        names.emplace_back(entry->name);
    if (reader->error())
        return reader->error();
    return names;
}

SystemError walkTree(
    const FileDescriptor& parent, const std::string& name, TreeVisitor& visitor, Mounts mounts)
{
    const auto found = statusAt(parent, name);
    if (!found)
        return found.error;
    return S_ISDIR(found->st_mode) ? Walk(visitor, mounts).run(parent, name)
                                   : visitor.visitItem(parent, name, *found);
}

SystemError removeTree(const FileDescriptor& folder, const std::string& name)
{
    Removal removal;
    return walkTree(folder, name, removal);
}

SystemResult<TreeVersions> readVersions(const FileDescriptor& folder, const std::string& name)
{
    VersionReading reading;
    TRW_TRY(walkTree(folder, name, reading));
    return std::move(reading.versions);
}

} // namespace host::drive
