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

namespace {

/// Goes through a folder one level at a time, with two descriptors however deep the folders lie.
class Walk {
public:
    explicit Walk(TreeVisitor& visitor)
        : _visitor(visitor)
    {
    }
    int run(const FileDescriptor& parent, const std::string& name)
    {
        _current = openSubfolder(parent, name);
        int failure = _current ? enter() : errno;
        while (failure == 0 && !_levels.empty())
            failure = _levels.back().subfolders.empty() ? leave() : descend();
        return failure != 0 ? failure : _visitor.leaveFolder(parent, name);
    }

private:
    struct Level {
        dev_t device;
        ino_t inode;
        std::vector<std::string> subfolders;
    };

    /// Visits what is no folder in the current one, and notes the others.
    int enter()
    {
        struct stat self;
        std::vector<std::string> names;
        if (::fstat(_current.get(), &self) != 0)
            return errno;
        int failure = readNames(_current, names);
        if (failure == 0)
            failure = _visitor.enterFolder(_current, self, names);
        std::vector<std::string> subfolders;
        for (auto each = names.begin(); failure == 0 && each != names.end(); ++each)
            failure = visit(*each, subfolders);
        _levels.push_back({self.st_dev, self.st_ino, std::move(subfolders)});
        return failure;
    }
    int visit(std::string& name, std::vector<std::string>& subfolders)
    {
        struct stat found;
        if (::fstatat(_current.get(), name.c_str(), &found, AT_SYMLINK_NOFOLLOW) != 0)
            return errno == ENOENT ? 0 : errno;
        if (!S_ISDIR(found.st_mode))
            return _visitor.visitItem(_current, name, found);
        subfolders.push_back(std::move(name));
        return 0;
    }
    int descend()
    {
        auto below = openSubfolder(_current, _levels.back().subfolders.back());
        if (!below)
            return errno;
        _current = std::move(below);
        return enter();
    }
    int leave()
    {
        _levels.pop_back();
        if (_levels.empty())
            return 0;
        auto above = openFolderAt(_current, "..");
        struct stat found;
        // Whoever moved the folder away took its contents along; its new parent is no business of ours.
        if (!above || ::fstat(above.get(), &found) != 0)
            return errno;
        auto& level = _levels.back();
        if (found.st_dev != level.device || found.st_ino != level.inode)
            return ESTALE;
        _current = std::move(above);
        const auto name = std::move(level.subfolders.back());
        level.subfolders.pop_back();
        return _visitor.leaveFolder(_current, name);
    }

    TreeVisitor& _visitor;
    FileDescriptor _current;
    std::vector<Level> _levels;
};

class Removal : public TreeVisitor {
public:
    int visitItem(const FileDescriptor& folder, const std::string& name, const struct stat&) override
    {
        return ::unlinkat(folder.get(), name.c_str(), 0) == 0 || errno == ENOENT ? 0 : errno;
    }
    int leaveFolder(const FileDescriptor& parent, const std::string& name) override
    {
        return ::unlinkat(parent.get(), name.c_str(), AT_REMOVEDIR) == 0 ? 0 : errno;
    }
};

class VersionReading : public TreeVisitor {
public:
    explicit VersionReading(TreeVersions& versions)
        : _versions(versions)
    {
    }
    int visitItem(const FileDescriptor&, const std::string&, const struct stat& found) override
    {
        return note(found);
    }
    int enterFolder(const FileDescriptor&, const struct stat& self, const std::vector<std::string>&) override
    {
        return note(self);
    }

private:
    int note(const struct stat& found)
    {
        auto version = versionOf(found);
        if (_versions.empty())
            version.changed = 0;
        _versions.emplace(std::pair(version.device, version.inode), version);
        return 0;
    }
    TreeVersions& _versions;
};

} // namespace

int readNames(const FileDescriptor& folder, std::vector<std::string>& names)
{
    const auto reader = std::make_unique<DirectoryReader>(folder);
    while (const auto entry = reader->next())
        names.emplace_back(entry->name);
    return reader->errorNumber();
}

int walkTree(const FileDescriptor& parent, const std::string& name, TreeVisitor& visitor)
{
    struct stat found;
    if (::fstatat(parent.get(), name.c_str(), &found, AT_SYMLINK_NOFOLLOW) != 0)
        return errno;
    return S_ISDIR(found.st_mode) ? Walk(visitor).run(parent, name) : visitor.visitItem(parent, name, found);
}

int removeTree(const FileDescriptor& folder, const std::string& name)
{
    Removal removal;
    return walkTree(folder, name, removal);
}

int readVersions(const FileDescriptor& folder, const std::string& name, TreeVersions& versions)
{
    VersionReading reading(versions);
    return walkTree(folder, name, reading);
}

} // namespace host::drive
