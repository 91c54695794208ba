// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/files/DirectoryReader.h"
#include "host/system/listing/EntryClassifier.h"
#include "host/system/listing/ListingBlock.h"
#include "host/system/listing/NameOrder.h"
#include "platform/Dispatch.h"
#include "platform/FolderLister.h"

#include <atomic>
#include <functional>
#include <memory>
#include <mutex>
#include <optional>
#include <string_view>
#include <unordered_set>
#include <vector>

namespace host::system {

/// The tools that all readings share.
struct ListingTools {
    EntryClassifier classifier;
    NameOrder order;
    std::shared_ptr<platform::OperationQueue> queue;
};

/// One reading of a folder. Blocks of entries are read one after the other, each on any free thread of the
/// queue. The thread that read a block sorts it while the next block is being read. The last thread to end
/// merges the blocks. The reading keeps itself alive until then.
class FolderReading : public std::enable_shared_from_this<FolderReading> {
public:
    using ExtraItems = std::vector<platform::FolderSnapshot::ExtraItem>;
    /// The folder that is listed, its extra items, and the grouping.
    struct Subject {
        platform::Url folder;
        ExtraItems extraItems;
        platform::FolderGrouping grouping;
    };
    struct Handlers {
        /// Called once with the open folder, before the first entry is read.
        std::function<void(const FileDescriptor&)> opened;
        /// Called with the first rows when there are many, and then with all rows.
        std::function<void(std::shared_ptr<const platform::FolderSnapshot>)> snapshot;
    };

    /// The handlers are called on threads of the queue.
    FolderReading(std::shared_ptr<const ListingTools> tools, Subject subject, Handlers handlers);

    void start();
    /// Cancels the reading. After the work that runs now, no handler is called.
    void cancel() { _isCancelled = true; }

private:
    void open();
    void readBlock();
    std::shared_ptr<ListingBlock> fillBlock();
    void finishBlock(ListingBlock& block);
    void appendExtraItems(ListingBlock& block);
    void merge();
    void appendRow(platform::FolderSnapshot::Builder& builder, const ListingBlock& block, std::size_t number);
    std::unordered_set<std::string_view> promisesOfPresentItems() const;
    void fail(const SystemError& failure);

    const std::shared_ptr<const ListingTools> _tools;
    const Subject _subject;
    const Handlers _handlers;
    std::atomic<bool> _isCancelled = false;

    FileDescriptor _descriptor;
    std::optional<DirectoryReader> _reader;
    std::optional<platform::Error> _error;
    std::vector<std::shared_ptr<ListingBlock>> _blocks; // filled by one thread at a time
    std::atomic<std::size_t> _unfinished = 0; // blocks that are being read or sorted, and the reading itself
};

} // namespace host::system
