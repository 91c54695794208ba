// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

// This file copies items from anywhere on this machine into the drive.

#include "host/drive/changes/LocalItemChanges.h"
#include "host/drive/changes/NewFile.h"
#include "host/drive/changes/TreeCopy.h"
#include "host/drive/records/PromiseRecord.h"
#include "host/drive/records/SmallFile.h"
#include "host/system/files/DriveNames.h"
#include "host/system/files/ItemPaths.h"
#include "host/system/files/PromisedNames.h"
#include "host/system/files/SystemErrors.h"
#include "host/system/texts/Translate.h"
#include "platform/Localization.h"

#include <fcntl.h>

#include <cerrno>

namespace host::drive {

using host::system::FileDescriptor;
using host::system::SystemError;
using host::system::systemError;
using host::system::textKey;
using platform::Error;
using platform::FileErrorCode;

namespace {

constexpr int openFlags = O_CLOEXEC | O_NOFOLLOW | O_NONBLOCK | O_NOCTTY;

/// The item that is copied: a name in an open folder, which may lie anywhere.
struct Original {
    FileDescriptor folder;
    std::string name;
};

constexpr const char* stillInTheCloud =
    textKey("“%@” is still in the cloud, so it can’t be copied. Download it first.");

Error refused(const char* key, const std::string& name)
{
    return Error(FileErrorCode::Unsupported,
        {{std::string(platform::errorKey::localizedDescription),
            platform::formatText(host::system::translated(key), {host::system::displayName(name)})}});
}

/// Finds out why an item must not come into the drive, with everything in it.
class AddableCheck : public TreeVisitor {
public:
    AddableCheck(const DriveEntry& target, const std::function<bool()>& goesOn)
        : _goesOn(goesOn)
    {
        if (::fstat(target.folder.get(), &_target) != 0)
            _target = {};
    }
    const std::optional<Error>& refusal() const { return _refusal; }

    SystemError visitItem(
        const FileDescriptor& folder, const std::string& name, const struct stat& found) override
    {
        if (!S_ISREG(found.st_mode) && !S_ISLNK(found.st_mode))
            return refuse(refused(
                textKey("“%@” can’t be added, because it is neither a document nor a folder."), name));
        return checkName(folder, name);
    }
    SystemError enterFolder(
        const FileDescriptor&, const struct stat& self, const std::vector<std::string>&) override
    {
        return isSameFile(self, _target) ? refuse(refused(textKey("“%@” can’t be added to itself."), _name))
                                         : SystemError();
    }
    SystemError leaveFolder(const FileDescriptor& parent, const std::string& name) override
    {
        return checkName(parent, name);
    }
    void setName(const std::string& name) { _name = name; }

private:
    SystemError checkName(const FileDescriptor& folder, const std::string& name)
    {
        if (!_goesOn())
            return refuse(Error(FileErrorCode::Cancelled));
        if (!isReservedName(name))
            return {};
        // A second promise of a content would end with the first.
        const auto promised = system::promisedName(folder, name);
        return refuse(promised ? refused(stillInTheCloud, *promised) : reservedName(name));
    }
    SystemError refuse(Error refusal)
    {
        _refusal = std::move(refusal);
        return SystemError(ECANCELED);
    }

    const std::function<bool()>& _goesOn;
    struct stat _target { };
    std::string _name;
    std::optional<Error> _refusal;
};

SystemError addLink(const Original& original, const DriveEntry& target)
{
    TRW_TRY(copyLink(original.folder, original.name, target.folder, target.name));
    auto failure = syncFolder(target.folder);
    if (failure)
        ::unlinkat(target.folder.get(), target.name.c_str(), 0);
    return failure;
}

SystemError addTree(const DriveLayout& layout, const Original& original, const DriveEntry& target,
    const std::function<bool()>& goesOn)
{
    const FileDescriptor from(::openat(original.folder.get(), original.name.c_str(), O_RDONLY | openFlags));
    struct stat found;
    if (!from || ::fstat(from.get(), &found) != 0)
        return SystemError::last(original.name);
    if (!S_ISREG(found.st_mode) && !S_ISDIR(found.st_mode))
        return {ECANCELED, original.name};
    auto fresh =
        S_ISDIR(found.st_mode) ? NewFile::createFolder(layout, target) : NewFile::create(layout, target);
    if (!fresh)
        return fresh.error;
    TRW_TRY(copyAsNew(from, fresh->descriptor(),
        [&](std::uint64_t) { return goesOn() ? SystemError() : SystemError(ECANCELED); }));
    if (!goesOn())
        return {ECANCELED, original.name};
    return fresh->publish(target, target.name);
}

} // namespace

std::optional<Error> LocalItemChanges::addCopy(
    const std::string& from, const std::string& to, const std::function<bool()>& goesOn)
{
    const auto target = DriveEntry::open(_layout, to);
    if (!target)
        return target.error;
    if (isReservedName(target.value->name))
        return reservedName(to);
    if (const auto failure = target->checkIsFree())
        return systemError(failure, from, to);
    const Original original{
        FileDescriptor(::open(system::parentPath(from).c_str(), O_PATH | O_DIRECTORY | O_CLOEXEC)),
        std::string(system::lastName(from))};
    const auto found =
        original.folder ? statusAt(original.folder, original.name) : SystemError::last(original.name);
    if (found.error.is(ENOENT) && statusAt(original.folder, PromiseRecord::pathFor(original.name)))
        return refused(stillInTheCloud, original.name);
    if (!found)
        return itemError(found.error, from);
    AddableCheck check(*target.value, goesOn);
    check.setName(original.name);
    auto failure = S_ISDIR(found->st_mode) ? walkTree(original.folder, original.name, check, Mounts::Enter)
                                           : check.visitItem(original.folder, original.name, *found);
    if (check.refusal())
        return check.refusal();
    if (!failure)
        failure = S_ISLNK(found->st_mode) ? addLink(original, *target.value)
                                          : addTree(_layout, original, *target.value, goesOn);
    if (failure)
        return failure.is(ECANCELED) ? Error(FileErrorCode::Cancelled) : systemError(failure, from, to);
    return std::nullopt;
}

} // namespace host::drive
