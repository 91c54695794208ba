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

/// An object that shows an item, or keeps it open, and wants to hear what happens to it. It is registered
/// with the FileCoordinator. The first two calls come on any thread; all others come as operations of the
/// presenter's queue, several at once when that queue runs several.
///
/// Coordinated writes of this process ask the presenter before they change anything. What other processes do,
/// coordinated or not, is told within a second after it was done, and once for all steps of a program's save;
/// the presenter cannot be asked before, because the coordinator learns of it from the file system. A
/// presented folder hears of its direct items alone then. An item that is replaced by another one, as most
/// programs save, has changed and was not deleted.
class FilePresenter {
public:
    /// The presenter calls this once, on any thread: with nothing when the deletion may go on, else with why
    /// it must not. The first call counts. A handler that is dropped without a call counts as called with
    /// nothing.
    using CompletionHandler = std::function<void(const std::optional<Error>&)>;

    virtual ~FilePresenter() = default;

    /// Answers the item or folder that is presented; nothing while there is none. It is asked anew at every
    /// write, so it must be quick. A presenter that turns to another item, without having been told of a
    /// move, must be removed and added again.
    virtual std::optional<Url> presentedItemURL() = 0;
    /// Answers the queue on which the calls below are to run. With null the presenter hears nothing.
    virtual std::shared_ptr<OperationQueue> presentedItemOperationQueue() = 0;

    /// The item, or something in the presented folder, may have changed. This comes once after each write of
    /// this process; several writes of other processes may be told together.
    virtual void presentedItemDidChange() { }
    /// This process is about to move the item, or a folder that it lies in. The writer waits until this
    /// returns, for a limited time.
    virtual void presentedItemWillMoveToURL(const Url& newURL) { static_cast<void>(newURL); }
    /// The item, or a folder that it lies in, was moved and is at a new location now.
    virtual void presentedItemDidMoveToURL(const Url& newURL) { static_cast<void>(newURL); }

    /// The item, or a folder that it lies in, is about to be deleted. The writer waits for the completion,
    /// for a limited time. When another process deleted the item it is gone already, and the completion's
    /// argument makes no difference.
    virtual void accommodatePresentedItemDeletionWithCompletionHandler(CompletionHandler completion)
    {
        completion(std::nullopt);
    }
    /// Does the same for something in the presented folder, at any depth; it also comes for a direct item
    /// that another process moved away.
    virtual void accommodatePresentedSubitemDeletionAtURLCompletionHandler(
        const Url& url, CompletionHandler completion)
    {
        static_cast<void>(url);
        completion(std::nullopt);
    }
};

} // namespace platform
