// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Error.h"
#include "platform/Url.h"

#include <functional>
#include <memory>
#include <optional>

namespace platform {

class OperationQueue;

/// Something that shows an item, or keeps it open, and wants to hear what happens to it. The first two calls
/// come on any thread, all others as operations of the presenter's queue, several at once if that queue runs
/// several.
///
/// Coordinated writes of this process ask before they change anything. What other processes do, coordinated
/// or not, is told within a second after it was done, once for all that one program does to save: nobody can
/// be asked there. Of what lies in a presented folder only its direct items are told of then. An item that is
/// replaced by another one, as most programs save, has changed and was not deleted.
class FilePresenter {
public:
    /// Called once, on any thread, with why the deletion must not go on, or nothing. A handler that is
    /// dropped without a call counts as called with nothing.
    using CompletionHandler = std::function<void(const std::optional<Error>&)>;

    virtual ~FilePresenter() = default;

    /// The item or folder that is presented; nothing for none at this time. Asked anew at every write. Who
    /// presents another item without having been told of a move is removed and added again.
    virtual std::optional<Url> presentedItemURL() = 0;
    /// Where the calls below are to run; null: nothing is told.
    virtual std::shared_ptr<OperationQueue> presentedItemOperationQueue() = 0;

    /// The item, or something in the presented folder, may have changed. Once after each write of this
    /// process; several writes of others may be told together.
    virtual void presentedItemDidChange() { }
    /// The item is about to be moved by this process. The writer waits, within limits, until this returns.
    virtual void presentedItemWillMoveToURL(const Url& newURL) { static_cast<void>(newURL); }
    /// The item, or a folder that it lies in, was moved and is at a new location now.
    virtual void presentedItemDidMoveToURL(const Url& newURL) { static_cast<void>(newURL); }

    /// The item, or a folder that it lies in, is about to be deleted. The writer waits, within limits, for
    /// the completion. Where another process deleted it, it is gone already, and what the completion is
    /// called with makes no difference.
    virtual void accommodatePresentedItemDeletionWithCompletionHandler(CompletionHandler completion)
    {
        completion(std::nullopt);
    }
    /// The same for something in the presented folder, at any depth; also for a direct item that another
    /// process moved away.
    virtual void accommodatePresentedSubitemDeletionAtURLCompletionHandler(
        const Url& url, CompletionHandler completion)
    {
        static_cast<void>(url);
        completion(std::nullopt);
    }
};

} // namespace platform
