// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/sample/SampleWriter.h"

#include "host/drive/records/ItemFacts.h"
#include "host/drive/records/SmallFile.h"
#include "host/system/files/AtomicWrite.h"
#include "host/system/files/ItemPaths.h"
#include "host/system/files/PosixFileSystem.h"

#include <fcntl.h>
#include <glib.h>
#include <sys/stat.h>
#include <sys/xattr.h>

#include <cerrno>
#include <ctime>
#include <filesystem>
#include <memory>

namespace host::drive::sample {

namespace {

std::int64_t secondsDaysAgo(int days)
{
    // The time of day differs from item to item, so that lists by date look like a person's.
    return std::time(nullptr) - days * 86'400LL - (days * 7919) % 40'000;
}

void setMark(const std::string& path, const char* attribute, const std::string& value)
{
    // On a file system without extended attributes the drive is usable without them.
    ::lsetxattr(path.c_str(), attribute, value.data(), value.size(), 0);
}

std::string contentName(const std::string& path)
{
    const std::unique_ptr<char, decltype(&g_free)> digest(
        g_compute_checksum_for_string(G_CHECKSUM_SHA256, path.c_str(), -1), &g_free);
    return std::string(digest.get()).substr(0, 32);
}

} // namespace

bool SampleWriter::fail(int errorNumber, const std::string& path)
{
    if (!_error)
        _error = itemError(errorNumber, path);
    return false;
}

bool SampleWriter::isTaken(const std::string& absolutePath) const
{
    return existsOnDisk(absolutePath).value_or(true)
        || existsOnDisk(PromiseRecord::pathFor(absolutePath)).value_or(true);
}

bool SampleWriter::makeFolders(const std::string& absolutePath)
{
    std::error_code error;
    std::filesystem::create_directories(absolutePath, error);
    return error ? fail(error.value(), absolutePath) : !_error;
}

bool SampleWriter::write(const std::string& absolutePath, std::string_view content)
{
    if (!makeFolders(host::system::parentPath(absolutePath)))
        return false;
    const auto error = host::system::writeNewFileAtomically(absolutePath, content);
    if (!error)
        ++_written;
    else if (!_error && !error->is(platform::FileErrorCode::ItemExists))
        _error = error;
    return !error;
}

void SampleWriter::decorate(const std::string& absolutePath, const Traits& traits)
{
    setMark(absolutePath, itemMark::status, "current");
    if (!traits.tags.empty())
        setMark(absolutePath, itemMark::tags, joinedTags(traits.tags));
    if (traits.extensionHidden)
        setMark(absolutePath, host::system::hiddenExtensionAttribute, "1");
    if (traits.sharedAs) {
        setMark(absolutePath, itemMark::shared, "1");
        setMark(absolutePath, itemMark::role, nameOf(*traits.sharedAs));
    }
    const timespec changed{secondsDaysAgo(traits.daysAgo), 0};
    const timespec times[] = {changed, changed};
    ::utimensat(AT_FDCWD, absolutePath.c_str(), times, AT_SYMLINK_NOFOLLOW);
}

void SampleWriter::folder(const std::string& path, const Traits& traits)
{
    if (isTaken(absolute(path)) || !makeFolders(absolute(path)))
        return;
    ++_written;
    decorate(absolute(path), traits);
}

void SampleWriter::lockedFolder(const std::string& path)
{
    if (isTaken(absolute(path)) || !makeFolders(absolute(path)))
        return;
    ++_written;
    if (::chmod(absolute(path).c_str(), 0) != 0)
        fail(errno, absolute(path));
}

void SampleWriter::document(const std::string& path, const Content& content, const Traits& traits)
{
    if (_error || isTaken(absolute(path)))
        return;
    if (write(absolute(path), content()))
        decorate(absolute(path), traits);
}

void SampleWriter::promised(const std::string& path, const Content& content, const Traits& traits)
{
    if (_error || isTaken(absolute(path)))
        return;
    const auto bytes = content();
    PromiseRecord promise;
    promise.size = bytes.size();
    const platform::Date changed{secondsDaysAgo(traits.daysAgo) * 1'000'000'000};
    promise.created = promise.modified = changed;
    promise.shared = traits.sharedAs.has_value();
    promise.role = traits.sharedAs;
    promise.tags = traits.tags;
    promise.extensionHidden = traits.extensionHidden;
    promise.content = contentName(path);
    // The content is written first, because a promise must never stand for a content that does not exist.
    record(_layout.cloud() + '/' + promise.content, bytes);
    write(PromiseRecord::pathFor(absolute(path)), promise.toJson());
}

void SampleWriter::link(const std::string& path, const std::string& target)
{
    if (_error || isTaken(absolute(path)))
        return;
    if (!makeFolders(host::system::parentPath(absolute(path))))
        return;
    if (::symlink(target.c_str(), absolute(path).c_str()) == 0)
        ++_written;
    else if (errno != EEXIST)
        fail(errno, absolute(path));
}

void SampleWriter::record(const std::string& absolutePath, const std::string& content)
{
    if (!_error && !existsOnDisk(absolutePath).value_or(true))
        write(absolutePath, content);
}

} // namespace host::drive::sample
