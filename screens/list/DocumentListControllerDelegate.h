// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/TagDots.h"
#include "platform/Url.h"
#include "screens/PlatformNames.h"

#include <functional>
#include <memory>
#include <string>
#include <vector>

namespace kit {
class View;
class ViewController;
} // namespace kit

namespace screens {

class DocumentListController;

/// Is told what happens in a folder list. Main thread only.
class DocumentListControllerDelegate {
public:
    using List = std::shared_ptr<DocumentListController>;
    using Completion = std::function<void()>; ///< may be empty

    virtual ~DocumentListControllerDelegate() = default;

    /// The user tapped a folder or a library. `container` is a new list of it that is not on the screen yet.
    virtual void documentListControllerDidSelectContainerWithViewController(
        const List& list, const List& container) = 0;
    /// The user tapped a document, a package or a link.
    virtual void documentListControllerDidSelectItemAtURL(const List& list, const Url& url) = 0;

    /// The list's items or its selection have changed. Also called once when the first listing is complete.
    virtual void documentListControllerItemsChanged(const List&) { }
    /// The folder that the list shows was deleted or moved away. Called once, and only while the list is
    /// shown.
    virtual void documentListControllerURLWasRemoved(const List&) { }

    /// The user began to select several items by the keyboard (select all, a range). The delegate may enter
    /// edit mode; the list selects them once it is editing.
    virtual void documentListControllerRequestsEditing(const List&) { }

    /// The user holds an item for a peek. The delegate looks at the item, and calls `ready` on the main
    /// thread when it can answer the next question without delay. It need not call it.
    virtual void documentListControllerPrepareToPreviewItemAtURL(
        const List&, const Url&, const Completion& ready)
    {
        ready();
    }
    /// Answers the screen for a peek at an item, or null for none.
    virtual std::shared_ptr<kit::ViewController> documentListControllerViewControllerForPreviewingItemAtURL(
        const List&, const Url&)
    {
        return nullptr;
    }

    /// A peek has closed, however it ended. What the user chose in it has been done before.
    virtual void documentListControllerPeekDidEnd(const List&) { }

    /// The user chose an action of an item. `action` is a code of DocumentListAction. A popover may point at
    /// the view (null: nowhere). The delegate calls the completion when the action has ended.
    virtual void documentListControllerPerformActionURLOriginatingViewCompletion(const List& list, int action,
        const Url& url, const std::shared_ptr<kit::View>& /*originatingView*/, const Completion& completion)
    {
        documentListControllerPerformActionURL(list, action, url);
        if (completion)
            completion();
    }
    /// An older form, for a delegate that needs neither the view nor the completion.
    virtual void documentListControllerPerformActionURL(const List&, int /*action*/, const Url&) { }

    /// Answers the dots for an item's tags, one for each name. It is asked again when the key-value store,
    /// which has the tags' colours, has changed.
    virtual std::vector<kit::TagDot> documentListControllerDotsForTagNames(
        const List& list, const std::vector<std::string>& names);
};

} // namespace screens
