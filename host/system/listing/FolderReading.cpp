// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/listing/FolderReading.h"

#include "host/system/files/SystemErrors.h"

#include <algorithm>
#include <cerrno>
#include <utility>

namespace host::system {

using platform::FolderSnapshot;
using platform::ListingStage;

namespace {

// A block is large enough to be worth a thread's work, and small enough that both cores of a small machine
// get some.
constexpr std::size_t blockEntries = 4096;
// These are more rows than any screen shows. They are delivered first when the rest takes longer.
constexpr std::size_t firstRows = 256;
constexpr std::size_t manyRows = 8 * firstRows;

/// Reads blocks that are each sorted as one sorted sequence.
class MergedBlocks {
public:
    explicit MergedBlocks(const std::vector<std::shared_ptr<ListingBlock>>& blocks)
    {
        for (const auto& block : blocks) {
            if (block->count() > 0)
                _cursors.push_back({block.get(), 0});
        }
        std::ranges::make_heap(_cursors, isAfter);
    }

    bool isAtEnd() const { return _cursors.empty(); }

    /// Answers the block of the next entry and the entry's number in the block.
    std::pair<const ListingBlock*, std::size_t> next()
    {
        std::ranges::pop_heap(_cursors, isAfter);
        auto& cursor = _cursors.back();
        const std::pair found(cursor.block, cursor.block->numberAt(cursor.place));
        if (++cursor.place < cursor.block->count())
            std::ranges::push_heap(_cursors, isAfter);
        else
            _cursors.pop_back();
        return found;
    }

private:
    struct Cursor {
        const ListingBlock* block;
        std::size_t place;
    };
    static bool isAfter(const Cursor& a, const Cursor& b)
    {
        return b.block->isBefore(b.place, *a.block, a.place);
    }
    std::vector<Cursor> _cursors;
};

/// Calls `visit` for each entry of the folder itself, without the extra items.
template <typename Visit>
void forEachEntry(const std::vector<std::shared_ptr<ListingBlock>>& blocks, const Visit& visit)
{
    for (const auto& block : blocks) {
        for (std::size_t number = 0; number < block->count(); ++number) {
            if (block->extra(number) < 0)
                visit(block->entry(number));
        }
    }
}

} // namespace

FolderReading::FolderReading(std::shared_ptr<const ListingTools> tools, Subject subject, Handlers handlers)
    : _tools(std::move(tools))
    , _subject(std::move(subject))
    , _handlers(std::move(handlers))
{
}

void FolderReading::start()
{
    _unfinished = 1;
    _tools->queue->addOperation([self = shared_from_this()] { self->open(); });
}

void FolderReading::open()
{
    if (_isCancelled)
        return;
    auto folder = openFolder(_subject.folder.path());
    if (!folder)
        return fail(folder.error);
    _descriptor = std::move(*folder);
    _handlers.opened(_descriptor);
    _reader.emplace(_descriptor);
    readBlock();
}

void FolderReading::fail(const SystemError& failure)
{
    FolderSnapshot::Builder builder(_subject.folder);
    _handlers.snapshot(builder.finish(ListingStage::Failed, systemError(failure, _subject.folder.path())));
}

void FolderReading::readBlock()
{
    if (_isCancelled)
        return;
    const auto block = fillBlock();
    const bool isLast = block->count() < blockEntries;
    if (isLast)
        appendExtraItems(*block);
    if (isLast && _reader->error())
        _error = systemError(_reader->error(), _subject.folder.path());
    _blocks.push_back(block);
    if (!isLast) {
        ++_unfinished;
        _tools->queue->addOperation([self = shared_from_this()] { self->readBlock(); });
    }
    finishBlock(*block);
}

std::shared_ptr<ListingBlock> FolderReading::fillBlock()
{
    auto block = std::make_shared<ListingBlock>();
    LongNameReading longName;
    while (block->count() < blockEntries) {
        const auto found = _reader->next();
        if (!found)
            break;
        const auto type = _reader->typeOf(*found);
        if (!type)
            continue; // it was removed since the folder was read
        if (const auto entry = _tools->classifier.classify(_descriptor, found->name, *type, longName))
            block->append(*entry);
        else if (longName.mayBeThere())
            _error = systemError(std::exchange(longName.failure, {}), _subject.folder.path());
    }
    return block;
}

void FolderReading::appendExtraItems(ListingBlock& block)
{
    std::int32_t index = 0;
    for (const auto& item : _subject.extraItems)
        block.append({item.name, item.kind, false}, index++);
}

void FolderReading::finishBlock(ListingBlock& block)
{
    block.sort(_tools->order, _subject.grouping);
    if (--_unfinished == 0 && !_isCancelled)
        merge();
}

std::unordered_set<std::string_view> FolderReading::promisesOfPresentItems() const
{
    std::unordered_set<std::string_view> promised, present;
    forEachEntry(_blocks, [&](const platform::FolderEntry& entry) {
        if (entry.isPromise)
            promised.insert(entry.name);
    });
    if (!promised.empty())
        forEachEntry(_blocks, [&](const platform::FolderEntry& entry) {
            if (!entry.isPromise && promised.contains(entry.name))
                present.insert(entry.name);
        });
    return present;
}

void FolderReading::appendRow(FolderSnapshot::Builder& builder, const ListingBlock& block, std::size_t number)
{
    if (const auto extra = block.extra(number); extra >= 0)
        return builder.append(_subject.extraItems[static_cast<std::size_t>(extra)]);
    const auto entry = block.entry(number);
    builder.append(entry.name, entry.kind, entry.isPromise);
}

void FolderReading::merge()
{
    std::size_t count = 0, nameBytes = 0, rows = 0;
    for (const auto& block : _blocks) {
        count += block->count();
        nameBytes += block->nameBytes();
    }
    const auto leftOut = promisesOfPresentItems();
    const bool wantsFirstRows = count >= manyRows && !_error;
    FolderSnapshot::Builder all(_subject.folder), first(_subject.folder);
    all.reserve(count, nameBytes);
    for (MergedBlocks merged(_blocks); !merged.isAtEnd();) {
        const auto [block, number] = merged.next();
        if (const auto entry = block->entry(number); entry.isPromise && leftOut.contains(entry.name))
            continue;
        appendRow(all, *block, number);
        if (!wantsFirstRows || ++rows > firstRows)
            continue;
        appendRow(first, *block, number);
        if (rows == firstRows)
            _handlers.snapshot(first.finish(ListingStage::FirstRows));
    }
    _handlers.snapshot(all.finish(_error ? ListingStage::Failed : ListingStage::Complete, _error));
}

} // namespace host::system
