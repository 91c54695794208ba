// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/changes/Discarding.h"

#include "host/drive/changes/CloudStore.h"
#include "host/drive/changes/Promises.h"
#include "host/drive/changes/TreeWalk.h"

#include <fcntl.h>
#include <sys/stat.h>

#include <cerrno>

namespace host::drive {

using host::system::FileDescriptor;
using host::system::SystemError;

namespace {

/// Root passes every check of permissions, so the attributes that forbid a removal are checked here.
SystemError checkMarks(const FileDescriptor& folder, const char* name, int flags)
{
    struct statx found;
    if (::statx(folder.get(), name, flags | AT_NO_AUTOMOUNT, STATX_TYPE, &found) != 0)
        return SystemError::last(name);
    const bool isMarked = found.stx_attributes & (STATX_ATTR_IMMUTABLE | STATX_ATTR_APPEND);
    return isMarked ? SystemError(EPERM, name) : SystemError();
}

class RemovableCheck : public TreeVisitor {
public:
    SystemError visitItem(const FileDescriptor& folder, const std::string& name, const struct stat&) override
    {
        return checkMarks(folder, name.c_str(), AT_SYMLINK_NOFOLLOW);
    }
    SystemError enterFolder(
        const FileDescriptor& folder, const struct stat&, const std::vector<std::string>& names) override
    {
        if (!names.empty() && ::faccessat(folder.get(), ".", W_OK | X_OK, AT_EACCESS) != 0)
            return SystemError::last();
        return checkMarks(folder, "", AT_EMPTY_PATH);
    }
};

class Discard : public TreeVisitor {
public:
    explicit Discard(CloudStore* store)
        : _store(store)
    {
    }
    SystemError visitItem(
        const FileDescriptor& folder, const std::string& name, const struct stat& found) override
    {
        if (_store && S_ISREG(found.st_mode) && PromiseRecord::isPromiseName(name)) {
            const auto content = contentOfPromise(folder, name);
            if (!content)
                return note(content.error);
            if (!content->empty()) {
                if (const auto failed = _store->release(*content))
                    return note(failed);
                hasBegun = true;
            }
        }
        const bool isGone = ::unlinkat(folder.get(), name.c_str(), 0) == 0 || errno == ENOENT;
        return note(SystemError::unless(isGone, name));
    }
    SystemError leaveFolder(const FileDescriptor& parent, const std::string& name) override
    {
        auto failed = SystemError::unless(::unlinkat(parent.get(), name.c_str(), AT_REMOVEDIR) == 0, name);
        // The reason why a folder is not empty was noted before.
        return note(failed.is(ENOTEMPTY) && failure ? failure : failed);
    }
    bool hasBegun = false;
    SystemError failure; ///< the first one

private:
    /// The first failure ends the walk unless something was already removed. After that the walk goes on and
    /// leaves out the items that fail.
    SystemError note(const SystemError& failed)
    {
        if (!failed)
            hasBegun = true;
        else if (!failure)
            failure = failed;
        return hasBegun ? SystemError() : failed;
    }
    CloudStore* _store;
};

} // namespace

SystemError checkRemovable(const FileDescriptor& folder, const std::string& name)
{
    RemovableCheck check;
    return walkTree(folder, name, check);
}

Discarded discardTree(const FileDescriptor& folder, const std::string& name, CloudStore* store)
{
    using Part = Discarded::Part;
    Discard discard(store);
    const auto ended = walkTree(folder, name, discard);
    auto failure = discard.failure ? discard.failure : ended;
    if (!failure)
        return {Part::Everything, {}};
    return {discard.hasBegun ? Part::Something : Part::Nothing, std::move(failure)};
}

} // namespace host::drive
