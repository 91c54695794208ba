// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/changes/Discarding.h"

#include "host/drive/changes/CloudStore.h"
#include "host/drive/changes/PromiseFile.h"
#include "host/drive/changes/TreeWalk.h"

#include <fcntl.h>
#include <sys/stat.h>

#include <cerrno>

namespace host::drive {

using host::system::FileDescriptor;

namespace {

/// Root may write anywhere and still cannot remove what is marked so.
int checkMarks(const FileDescriptor& folder, const char* name, int flags)
{
    struct statx found;
    if (::statx(folder.get(), name, flags | AT_NO_AUTOMOUNT, STATX_TYPE, &found) != 0)
        return errno;
    return found.stx_attributes & (STATX_ATTR_IMMUTABLE | STATX_ATTR_APPEND) ? EPERM : 0;
}

class RemovableCheck : public TreeVisitor {
public:
    int visitItem(const FileDescriptor& folder, const std::string& name, const struct stat&) override
    {
        return checkMarks(folder, name.c_str(), AT_SYMLINK_NOFOLLOW);
    }
    int enterFolder(
        const FileDescriptor& folder, const struct stat&, const std::vector<std::string>& names) override
    {
        if (!names.empty() && ::faccessat(folder.get(), ".", W_OK | X_OK, AT_EACCESS) != 0)
            return errno;
        return checkMarks(folder, "", AT_EMPTY_PATH);
    }
};

class Discard : public TreeVisitor {
public:
    explicit Discard(CloudStore* store)
        : _store(store)
    {
    }
    int visitItem(const FileDescriptor& folder, const std::string& name, const struct stat& found) override
    {
        if (_store && S_ISREG(found.st_mode) && PromiseRecord::itemPathFor(name)) {
            std::string content;
            int failed = contentOfPromise(folder, name, content);
            if (failed == 0 && !content.empty())
                failed = _store->remove(content);
            if (failed != 0)
                return note(failed);
            hasBegun = hasBegun || !content.empty();
        }
        return note(::unlinkat(folder.get(), name.c_str(), 0) == 0 || errno == ENOENT ? 0 : errno);
    }
    int leaveFolder(const FileDescriptor& parent, const std::string& name) override
    {
        const int failed = ::unlinkat(parent.get(), name.c_str(), AT_REMOVEDIR) == 0 ? 0 : errno;
        // Why a folder is not empty was noted before.
        return note(failed == ENOTEMPTY && failure != 0 ? failure : failed);
    }
    bool hasBegun = false;
    int failure = 0;

private:
    /// Before anything is gone the first failure ends the walk; later ones are left behind.
    int note(int failed)
    {
        if (failed == 0)
            hasBegun = true;
        else if (failure == 0)
            failure = failed;
        return hasBegun ? 0 : failed;
    }
    CloudStore* _store;
};

} // namespace

int checkRemovable(const FileDescriptor& folder, const std::string& name)
{
    RemovableCheck check;
    return walkTree(folder, name, check);
}

Discarded discardTree(const FileDescriptor& folder, const std::string& name, CloudStore* store, int& failure)
{
    Discard discard(store);
    const int ended = walkTree(folder, name, discard);
    failure = discard.failure != 0 ? discard.failure : ended;
    if (failure == 0)
        return Discarded::Everything;
    return discard.hasBegun ? Discarded::Something : Discarded::Nothing;
}

} // namespace host::drive
