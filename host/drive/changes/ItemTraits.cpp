// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/changes/ItemTraits.h"

#include "host/drive/records/ItemMarks.h"
#include "host/system/files/DriveNames.h"

#include <sys/stat.h>
#include <sys/xattr.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <string_view>

namespace host::drive {

using host::system::FileDescriptor;
using host::system::SystemError;
using host::system::SystemResult;

namespace {

constexpr const char* accessList = "system.posix_acl_access";
constexpr std::size_t largestList = 64 * 1024; // the kernel's own limit
constexpr mode_t allRights = 07777;

bool isKept(std::string_view name)
{
    return name == accessList
        || (name.starts_with("user.") && name != itemMark::promise && name != itemMark::type
            && name != system::promisedNameAttribute);
}

SystemResult<std::string> readAttribute(const FileDescriptor& item, const char* name)
{
    std::array<char, 1024> small;
    auto length = ::fgetxattr(item.get(), name, small.data(), small.size());
    if (length >= 0)
        return std::string(small.data(), static_cast<std::size_t>(length));
    if (errno != ERANGE)
        return SystemError::last(name);
    std::string value(largestList, '\0');
    length = ::fgetxattr(item.get(), name, value.data(), value.size());
    if (length < 0)
        return SystemError::last(name);
    value.resize(static_cast<std::size_t>(length));
    return value;
}

SystemError writeAttribute(const FileDescriptor& item, const std::string& name, const std::string& value)
{
    return SystemError::unless(
        ::fsetxattr(item.get(), name.c_str(), value.data(), value.size(), 0) == 0, name);
}

SystemError removeAttribute(const FileDescriptor& item, const std::string& name)
{
    const bool isGone =
        ::fremovexattr(item.get(), name.c_str()) == 0 || errno == ENODATA || errno == EOPNOTSUPP;
    return SystemError::unless(isGone, name);
}

/// Answers whether the item has the owner and the group now.
bool takeOwners(const FileDescriptor& item, uid_t owner, gid_t group)
{
    struct stat found;
    if (::fstat(item.get(), &found) != 0)
        return false;
    if (found.st_uid == owner && found.st_gid == group)
        return true;
    // Only root may give a file away, and a user only to a group of his own.
    if (::fchown(item.get(), owner, group) == 0 || found.st_gid == group)
        return true;
    return ::fchown(item.get(), static_cast<uid_t>(-1), group) == 0;
}

} // namespace

SystemResult<ItemTraits> ItemTraits::read(const FileDescriptor& item)
{
    ItemTraits traits;
    struct stat found;
    if (::fstat(item.get(), &found) != 0)
        return SystemError::last();
    traits.mode = found.st_mode & allRights;
    traits.owner = found.st_uid;
    traits.group = found.st_gid;
    std::array<char, 1024> small;
    std::string names;
    auto length = ::flistxattr(item.get(), small.data(), small.size());
    if (length >= 0) {
        names.assign(small.data(), static_cast<std::size_t>(length));
    } else if (errno == ERANGE) {
        names.resize(largestList);
        length = ::flistxattr(item.get(), names.data(), names.size());
        names.resize(length < 0 ? 0 : static_cast<std::size_t>(length));
    }
    if (length < 0 && errno != EOPNOTSUPP)
        return SystemError::last();
    for (const char* name = names.data(); name < names.data() + names.size();
         name += std::char_traits<char>::length(name) + 1) {
        if (!isKept(name))
            continue;
        auto value = readAttribute(item, name);
        if (!value && value.error.is(ENODATA))
            continue; // another program removed it meanwhile
        if (!value)
            return value.error;
        traits.attributes.emplace(name, std::move(*value));
    }
    return traits;
}

SystemError ItemTraits::write(const FileDescriptor& item) const
{
    bool isGroupsOwn = takeOwners(item, owner, group);
    // The folder may give each new file an access list.
    if (!attributes.contains(accessList))
        TRW_TRY(removeAttribute(item, accessList));
    for (const auto& [name, value] : attributes) {
        const auto failure = writeAttribute(item, name, value);
        if (failure && name == accessList)
            isGroupsOwn = false;
        else if (failure && !failure.is(EOPNOTSUPP))
            return failure;
    }
    const auto rights = isGroupsOwn ? mode : mode & ~static_cast<mode_t>(S_IRWXG);
    return SystemError::unless(::fchmod(item.get(), rights) == 0);
}

ItemTraits ItemTraits::ofPromise() const
{
    auto traits = *this;
    for (const char* name : {itemMark::documentIdentifier, itemMark::created, itemMark::status})
        traits.attributes.erase(name);
    return traits;
}

SystemError ItemTraits::writeChanges(const ItemTraits& before, const FileDescriptor& item) const
{
    for (const auto& [name, value] : attributes) {
        const auto had = before.attributes.find(name);
        if (had == before.attributes.end() || had->second != value)
            TRW_TRY(writeAttribute(item, name, value));
    }
    for (const auto& [name, value] : before.attributes) {
        if (!attributes.contains(name))
            TRW_TRY(removeAttribute(item, name));
    }
    if (owner != before.owner || group != before.group)
        static_cast<void>(takeOwners(item, owner, group));
    return mode == before.mode ? SystemError() : SystemError::unless(::fchmod(item.get(), mode) == 0);
}

} // namespace host::drive
