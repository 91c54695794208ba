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

/// What a reader asks for, which decides whether it waits.
enum class ReadingOptions {
    /// The content is read, so the reader waits until nobody writes the item or a folder that it lies in.
    None,
    /// Only attributes are read, as far as they are known here. Such a read waits neither for a download nor
    /// for a
    /// writer, so it may run on the main thread.
    ImmediatelyAvailableMetadataOnly,
};

/// What a writer is about to do to a location, which decides what presenters are asked and told.
enum class WritingOptions {
    None, ///< the item is changed or made
    ForDeleting, ///< presenters are asked first whether they agree
    ForMoving, ///< the item goes elsewhere; the accessor announces that with itemWillMove()
    ForReplacing, ///< another item takes the place
};

/// Coordinates access to files with the presenters of this process and with other processes of the drive. Any
/// thread may call; every call is synchronous and runs its accessor on the caller's thread. A writer has its
/// item and everything below it to itself, and readers of an item share it. An accessor may coordinate again
/// for what its thread already has; to write what its thread only reads is an error (EDEADLK), because the
/// thread would wait for itself. Programs that do not coordinate are not kept out.
class FileCoordinator {
public:
    /// Does the work, with the location to use. It is called once, or never when there is an error, and not
    /// kept.
    using Accessor = std::function<void(const Url&)>;
    using PairAccessor = std::function<void(const Url&, const Url&)>;

    virtual ~FileCoordinator() = default;

    /// Waits until the item can be read and runs the accessor with the location to use, which may differ from
    /// `url`. It answers an error, and does not run the accessor, when the read cannot be coordinated: EBUSY
    /// when another thread or process keeps the item too long (on Linux ten seconds). A process that was
    /// killed keeps nothing. What goes wrong inside the accessor is the caller's to notice.
    virtual std::optional<Error> coordinateReading(
        const Url& url, ReadingOptions options, const Accessor& accessor) = 0;

    /// Does the same for a write. Before it, the presenters concerned are asked; they are waited for a
    /// limited time (on Linux three seconds for all of them together), after which the write goes on. After
    /// it, they are told. When a presenter refuses, or the item cannot be had, that error is answered and the
    /// accessor is not run.
    virtual std::optional<Error> coordinateWriting(
        const Url& url, WritingOptions options, const Accessor& accessor) = 0;
    /// Does the same for two locations at once, as for a move. Two such writers never wait for each other,
    /// whatever the order of their locations.
    virtual std::optional<Error> coordinateWriting(const Url& first, WritingOptions firstOptions,
        const Url& second, WritingOptions secondOptions, const PairAccessor& accessor) = 0;

    /// Tells the presenters of an item, and of what lies in it, that the item is about to be moved, and then
    /// that it was moved. An accessor calls these two around its move, inside a write of both locations. When
    /// a move was announced and then failed, only the first is called, and the presenters hear that the item
    /// may have changed.
    virtual void itemWillMove(const Url& from, const Url& to) = 0;
    virtual void itemDidMove(const Url& from, const Url& to) = 0;

    /// Registers a presenter, which is called from now on, and a moment later also for what other processes
    /// do. The coordinator does not keep it alive. To register one twice changes nothing.
    virtual void addFilePresenter(const std::shared_ptr<FilePresenter>& presenter) = 0;
    /// Ends the calls to a presenter. Those that wait in its queue already still come. Nothing happens when
    /// it is not registered.
    virtual void removeFilePresenter(const FilePresenter& presenter) = 0;
};

} // namespace platform
