// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "items/UndoHistory.h"
#include "platform/Error.h"
#include "platform/Url.h"

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace kit {
class AlertAction;
class BarButtonItem;
class TextField;
class View;
class ViewController;
struct TextRange;
} // namespace kit

namespace tarrow {

/// The messages and questions about errors, names and deletions that several screens show. An alert is shown
/// over its parent; without a parent it is not shown. Titles and messages may be empty. Main thread.
class UIUtils {
public:
    using Screen = std::shared_ptr<kit::ViewController>;
    using MaybeError = std::optional<platform::Error>;
    /// Called once with the button that was pressed (null: nothing was shown) and whether the user cancelled.
    using DeleteCompletion =
        std::function<void(const std::shared_ptr<kit::AlertAction>& button, bool cancelled)>;

    UIUtils() = delete;

    // Names.
    /// Gives an item another name and keeps its extension, see computeNewURLNewBasename(). For a reference it
    /// renames the document that the reference stands for. Answers nothing on success, also when the item has
    /// that name already, and InvalidName for a name that is not valid.
    /// It blocks until other readers and writers have let the item, so any thread but the main thread calls
    /// it; see FileUtils for `stillWanted`.
    static MaybeError renameItemAtURLToName(
        const platform::Url& url, const std::string& name, const FileUtils::StillWanted& stillWanted = {});
    /// Begins the same on the queue on which all items are changed, and returns at once. `renamed` is called
    /// once, on the main thread, with what the operation above answers; FileErrorCode::Cancelled, after the
    /// answered change was cancelled or who asked has signed out, says that the item kept its name. The
    /// history, which may be null, gets an entry.
    static std::shared_ptr<ItemChange> renameItemAtURLToNameCompletion(const platform::Url& url,
        const std::string& name, std::function<void(const MaybeError& error)> renamed,
        const std::shared_ptr<UndoHistory>& history, const AccountSession& asked = AccountSession());
    /// Answers the location of an item under a new name. The item's extension is appended unless the new name
    /// already ends with it, regardless of case.
    static platform::Url computeNewURLNewBasename(const platform::Url& url, const std::string& name);
    /// Puts the caret before the last dot. In a text without a dot the caret stays where it is.
    static void setCursorInTextFieldToBeforeExtension(kit::TextField& field);
    static void selectTextInTextFieldRange(kit::TextField& field, kit::TextRange range);

    // These show errors. Only an error's code counts, not its domain.
    /// Answers the message that a name prompt shows for an error; empty without one.
    static std::string bestMessage(const MaybeError& error);
    /// Shows a failed move. The message names the error's destination.
    static void showFriendlyMoveErrorParentViewController(const platform::Error& error, const Screen& parent);
    /// Shows a failed rename to a name that the user typed.
    static void showFriendlyRenameErrorBasenameParentViewController(
        const platform::Error& error, const std::string& name, const Screen& parent);
    static void showFriendlyMoveOrRenameErrorBasenameMovingToDirParentViewController(
        const platform::Error& error, const std::string& name, bool movingToDir, const Screen& parent);
    static void showItemExistsAlertMovingToDirParentViewController(
        const std::string& name, bool movingToDir, const Screen& parent);
    static void showInvalidItemNameAlertParentViewController(const std::string& name, const Screen& parent);
    /// A message with the single button "OK".
    static void showAlertMessageParentViewController(
        const std::string& title, const std::string& message, const Screen& parent);
    /// Shows why an operation failed, as the title: the error's description, else its failure reason. A
    /// missing error is shown like one without either.
    static void showErrorParentViewController(const MaybeError& error, const Screen& parent);
    /// Shows why something failed for some items, of which there is at least one: a single error like above,
    /// several under the title with the reasons of the first ones.
    static void showErrorsTitleParentViewController(
        const std::vector<platform::Error>& errors, const std::string& title, const Screen& parent);
    /// Says that the folders that must stay as they are cannot be changed.
    static void showUnsupportedError(const Screen& parent);

    // Deletion.
    /// Asks before items are deleted: in a sheet, or on tablets in a popover that points at the view's middle
    /// or, without a view, at the button. Without items, or when no message can be made for the one item, the
    /// completion is called at once as cancelled. `hasContainer` (app libraries are among the items) has no
    /// effect.
    static void showDeleteWarningAlertHasContainerViewControllerUsingViewUsingButtonCompletion(
        const std::vector<platform::Url>& items, bool hasContainer, const Screen& parent,
        const std::shared_ptr<kit::View>& view, const std::shared_ptr<kit::BarButtonItem>& button,
        DeleteCompletion completion);
    /// Asks the same with a message that is known already; absent: the completion is called as above.
    static void showDeleteWarningAlertMessageViewControllerUsingViewUsingButtonCompletion(
        const std::optional<std::string>& message, const Screen& parent,
        const std::shared_ptr<kit::View>& view, const std::shared_ptr<kit::BarButtonItem>& button,
        DeleteCompletion completion);
    /// Answers the message that says what will be lost, or nothing when the one item cannot be read or has no
    /// name. It reads that item. Any thread.
    static std::optional<std::string> messageForDeletePrompt(const std::vector<platform::Url>& items);

    /// Answers whether the device is a tablet.
    static bool tabulaMode();
    /// Adds a screen to another one as a child. Its view becomes the front subview of the parent's.
    static void addChildViewControllerChildViewController(const Screen& parent, const Screen& child);
};

} // namespace tarrow
