// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

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

/// What the screens share to tell and ask the user something about an error, a name or a deletion. An alert
/// is shown over its parent; without a parent it is not shown. Titles and messages may be empty. Main thread.
class UIUtils {
public:
    using Screen = std::shared_ptr<kit::ViewController>;
    using MaybeError = std::optional<platform::Error>;
    /// Called once with the button that was pressed (null: nothing was shown) and whether the user cancelled.
    using DeleteCompletion =
        std::function<void(const std::shared_ptr<kit::AlertAction>& button, bool cancelled)>;

    UIUtils() = delete;

    // Names.
    /// Gives an item another name and keeps its extension, see computeNewURLNewBasename(); for a reference,
    /// the document that it stands for. Nothing on success, also when it has that name already; InvalidName
    /// for a name that cannot be one.
    static MaybeError renameItemAtURLToName(const platform::Url& url, const std::string& name);
    /// Where an item will be under a new name. Its extension is appended, unless the new name ends with it,
    /// whatever its letter case.
    static platform::Url computeNewURLNewBasename(const platform::Url& url, const std::string& name);
    /// Puts the caret before the last dot; without one it stays where it is.
    static void setCursorInTextFieldToBeforeExtension(kit::TextField& field);
    static void selectTextInTextFieldRange(kit::TextField& field, kit::TextRange range);

    // Errors. Only an error's code is looked at, not its domain.
    /// What a name prompt says about an error; empty without one.
    static std::string bestMessage(const MaybeError& error);
    /// A failed move: the name is that of the error's destination.
    static void showFriendlyMoveErrorParentViewController(const platform::Error& error, const Screen& parent);
    /// A failed rename to a name that the user typed.
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
    /// Why an operation failed, as the title: the error's description, else its failure reason. An error that
    /// is not known is shown as one without either.
    static void showErrorParentViewController(const MaybeError& error, const Screen& parent);
    /// That this is never done, for the folders that must stay as they are.
    static void showUnsupportedError(const Screen& parent);

    // Deletion.
    /// Asks before items are deleted: a sheet, on tablets a popover that points at the view's middle or,
    /// without a view, at the button. Without items, or when nothing can be said about the one item, the
    /// completion is called at once as cancelled. `hasContainer` (app libraries are among the items) changes
    /// nothing here.
    static void showDeleteWarningAlertHasContainerViewControllerUsingViewUsingButtonCompletion(
        const std::vector<platform::Url>& items, bool hasContainer, const Screen& parent,
        const std::shared_ptr<kit::View>& view,
        const std::shared_ptr<kit::BarButtonItem>& button, DeleteCompletion completion);
    /// What will be lost; nothing when the one item cannot be read or has no name. Reads that item.
    static std::optional<std::string> messageForDeletePrompt(const std::vector<platform::Url>& items);

    /// Whether the device is a tablet.
    static bool tabulaMode();
    /// Makes a screen a part of another one: its view becomes a subview of the parent's, in front of the
    /// others.
    static void addChildViewControllerChildViewController(const Screen& parent, const Screen& child);
};

} // namespace tarrow
