// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Error.h"
#include "platform/Url.h"

#include <functional>
#include <memory>
#include <optional>

namespace platform {

class FilePresenter;

enum class ReadingOptions {
    None, ///< waits until nobody writes the item or a folder that it lies in
    ImmediatelyAvailableMetadataOnly, ///< never waits for a download or for a writer: only what is known is
                                      ///< read
};

/// What a writer is about to do to a location.
enum class WritingOptions { None, ForDeleting, ForMoving, ForReplacing };

/// Coordinates access to files with other presenters and processes. Synchronous on the caller's thread; any
/// thread. A writer has its item and everything below it to itself. An accessor may coordinate again for what
/// its thread already has; wanting to write what its thread only reads is an error (EDEADLK).
class FileCoordinator {
public:
    using Accessor = std::function<void(const Url&)>;
    using PairAccessor = std::function<void(const Url&, const Url&)>;

    virtual ~FileCoordinator() = default;

    /// Runs the accessor once with the location to use, which may differ from `url`. Answers an error, and
    /// does not run the accessor, when the read cannot be coordinated: EBUSY when another thread or process
    /// keeps the item too long. One that was killed keeps nothing.
    virtual std::optional<Error> coordinateReading(
        const Url& url, ReadingOptions options, const Accessor& accessor) = 0;

    /// The same for a write. Presenters are asked before it and told after it; one that does not answer is
    /// waited for a limited time. A presenter's error, or a system's, is answered instead of running the
    /// accessor.
    virtual std::optional<Error> coordinateWriting(
        const Url& url, WritingOptions options, const Accessor& accessor) = 0;
    /// Writes two locations at once. No two writers wait for each other, whatever their order.
    virtual std::optional<Error> coordinateWriting(const Url& first, WritingOptions firstOptions,
        const Url& second, WritingOptions secondOptions, const PairAccessor& accessor) = 0;

    /// Inside a write of both locations: tells the presenters of an item that it is about to be moved, and
    /// that it was. After an announcement without a move they hear that the item may have changed.
    virtual void itemWillMove(const Url& from, const Url& to) = 0;
    virtual void itemDidMove(const Url& from, const Url& to) = 0;

    /// From now on the presenter is called, a moment later also for what other processes do; it is not kept
    /// alive. Adding one twice adds nothing.
    virtual void addFilePresenter(const std::shared_ptr<FilePresenter>& presenter) = 0;
    /// After this no call to the presenter begins, but for those that already wait in its queue.
    virtual void removeFilePresenter(const FilePresenter& presenter) = 0;
};

} // namespace platform
