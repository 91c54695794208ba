// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/search/NameGathering.h"

#include "host/system/files/DirectoryReader.h"
#include "host/system/files/FileVersion.h"

#include <fcntl.h>
#include <sys/stat.h>

#include <algorithm>
#include <ctime>
#include <optional>
#include <utility>

namespace host::system {

using platform::FolderEntryKind;

namespace {

constexpr std::size_t firstProgress = 20'000; ///< items, which are read in well under a tenth of a second
constexpr std::size_t progressGrowth =
    4; ///< with this factor all copies together cost a third of the last one
/// The clock of file times advances in steps of up to ten milliseconds, so a folder that was modified this
/// shortly before it was read may change again without a new time.
constexpr std::int64_t unsettled = 100'000'000; // nanoseconds

std::int64_t now()
{
    timespec time{};
    ::clock_gettime(CLOCK_REALTIME, &time);
    return nanosecondsOf(time);
}

/// Answers the modification time, or 0 when the folder cannot be read.
std::int64_t modificationTime(const FileDescriptor& folder)
{
    struct stat status { };
    if (::fstat(folder.get(), &status) != 0)
        return 0;
    return nanosecondsOf(status.st_mtim);
}

} // namespace

NameGathering::NameGathering(const EntryClassifier& classifier, const NameFolding& folding,
    std::shared_ptr<const NameIndex> earlier, Handlers handlers)
    : _classifier(classifier)
    , _folding(folding)
    , _earlier(std::move(earlier))
    , _handlers(std::move(handlers))
    , _nextProgress(firstProgress)
{
    if (!_earlier)
        return;
    // The results of an earlier search must not shrink at first, so progress is reported only with more
    // items.
    _nextProgress = std::max(firstProgress, _earlier->itemCount());
    for (const auto& folder : _earlier->folders())
        _earlierFolders.emplace(folder.path, &folder);
}

NameIndex NameGathering::gather(const std::vector<std::string>& roots)
{
    for (const auto& root : roots) {
        enter(openFolder(root), root);
        while (!_levels.empty() && !_handlers.isCancelled())
            descend();
        _levels.clear();
    }
    return _builder.finish();
}

void NameGathering::enter(SystemResult<FileDescriptor> folder, std::string path)
{
    if (!folder)
        return;
    const auto modified = modificationTime(*folder);
    const bool isSettled = now() - modified > unsettled;
    const auto known = _earlierFolders.find(path);
    const bool isKept =
        known != _earlierFolders.end() && modified != 0 && known->second->modified == modified;
    Level level{path, std::move(*folder), {}};
    _builder.beginFolder(std::move(path), isSettled ? modified : 0);
    if (isKept)
        copy(*known->second, level.subfolders);
    else
        read(level.descriptor, level.subfolders);
    ++(isKept ? _keptFolders : _readFolders);
    _levels.push_back(std::move(level));
    reportProgress();
}

void NameGathering::descend()
{
    auto& level = _levels.back();
    if (level.subfolders.empty() || _levels.size() >= deepestLevel) {
        _levels.pop_back();
        return;
    }
    const auto name = std::move(level.subfolders.back());
    level.subfolders.pop_back();
    enter(openFolderAt(level.descriptor, name), level.path + '/' + name);
}

void NameGathering::copy(const NameIndex::Folder& folder, std::vector<std::string>& subfolders)
{
    for (auto number = folder.firstItem; number < folder.firstItem + folder.itemCount; ++number) {
        const auto item = _earlier->item(number);
        _builder.append(item);
        if (item.kind == FolderEntryKind::Folder && !item.isPromise)
            subfolders.emplace_back(item.name);
    }
}

void NameGathering::read(const FileDescriptor& descriptor, std::vector<std::string>& subfolders)
{
    std::vector<std::pair<std::string, FolderEntryKind>> promised;
    LongNameReading longName;
    DirectoryReader reader(descriptor);
    while (const auto found = reader.next()) {
        const auto type = reader.typeOf(*found);
        const auto entry =
            type ? _classifier.classify(descriptor, found->name, *type, longName) : std::nullopt;
        if (entry && entry->isPromise)
            promised.emplace_back(entry->name, entry->kind);
        else if (entry)
            append(*entry, subfolders);
    }
    for (const auto& [name, kind] : promised) {
        struct stat status { };
        // When an item is here, it counts and not the promise beside it.
        if (::fstatat(descriptor.get(), name.c_str(), &status, AT_SYMLINK_NOFOLLOW) != 0)
            append({name, kind, true}, subfolders);
    }
}

void NameGathering::append(const platform::FolderEntry& entry, std::vector<std::string>& subfolders)
{
    _folded.clear();
    _folding.append(entry.name, _folded);
    _builder.append({entry.name, _folded, entry.kind, entry.isPromise});
    if (entry.kind == FolderEntryKind::Folder && !entry.isPromise)
        subfolders.emplace_back(entry.name);
}

void NameGathering::reportProgress()
{
    if (_builder.itemCount() < _nextProgress)
        return;
    _nextProgress = _builder.itemCount() * progressGrowth;
    _handlers.progress(_builder.soFar());
}

} // namespace host::system
