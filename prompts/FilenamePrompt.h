// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/views/TextFieldDelegate.h"

#include <functional>
#include <memory>
#include <optional>
#include <string>

namespace kit {
class AlertAction;
class AlertController;
} // namespace kit

namespace tarrow {

class SimpleTextViewController;

/// An alert in which the user types a name. It checks the name while it is typed, shows in red what is wrong
/// with it, and stays open until the name is accepted or the user cancels. The callback may answer later; the
/// prompt waits for it without holding up anything.
///
/// The caller presents the alert and keeps the prompt alive while it is shown, because the alert refers to
/// the prompt only weakly. Without the prompt the alert closes only on Cancel. Main thread.
class FilenamePrompt : public kit::TextFieldDelegate, public std::enable_shared_from_this<FilenamePrompt> {
public:
    /// Called with the name, without white space around it, when the user confirms. Setting `accepted` closes
    /// the prompt. Otherwise the prompt stays open and shows the answer (empty: no message).
    using ValidateNewFilenameCallback = std::function<std::string(const std::string& name, bool& accepted)>;
    using MaybeText = std::optional<std::string>;

    /// Makes a prompt. Without a text for the button it reads "Done". The callback is required.
    static std::shared_ptr<FilenamePrompt> newWithTitleMessagePlaceholderFilenameDoneButtonTextCompletion(
        const MaybeText& title, const MaybeText& message, const MaybeText& placeholder,
        const MaybeText& filename, const MaybeText& doneButtonText, ValidateNewFilenameCallback completion);
    static std::shared_ptr<FilenamePrompt> initWithTitleMessagePlaceholderFilenameDoneButtonTextCompletion(
        const MaybeText& title, const MaybeText& message, const MaybeText& placeholder,
        const MaybeText& filename, const MaybeText& doneButtonText, ValidateNewFilenameCallback completion);

    const std::shared_ptr<kit::AlertController>& alert() const { return _alert; }
    const std::shared_ptr<SimpleTextViewController>& errMsgViewController() const
    {
        return _errMsgViewController;
    }
    /// The confirming button.
    const std::shared_ptr<kit::AlertAction>& defaultAction() const { return _defaultAction; }
    /// The name with which the field begins; absent for a new folder.
    const MaybeText& origFilename() const { return _origFilename; }
    const ValidateNewFilenameCallback& validateNewFilenameCallback() const
    {
        return _validateNewFilenameCallback;
    }

    /// The callback calls this when its answer comes later; what it answers at once does not count then. The
    /// prompt stays open, and confirming again does nothing. Cancel closes it at once and calls `withdraw`.
    void waitForAnswer(std::function<void()> withdraw);
    /// Answers whether the prompt waits. It does not any more once the user has cancelled.
    bool isWaiting() const { return _isWaiting; }
    /// The answer has come: closes the prompt, or shows a message unless the user has typed another name
    /// since. Does nothing while the prompt does not wait.
    void answer(bool accepted, const std::string& message);

    /// The user confirmed. Answers whether the alert may close.
    bool handleDoneAction();
    /// Shows a message in red. An empty one hides the area.
    void updateErrorMessage(const std::string& message);
    /// The user edited the name. A null field is ignored.
    void folderPromptTextFieldChanged(const kit::TextField* field);

    bool textFieldShouldReturn(kit::TextField& field) override;
    void textFieldDidBeginEditing(kit::TextField& field) override;

protected:
    struct Texts {
        MaybeText title, message, placeholder, filename, doneButtonText;
    };
    struct Token {
        explicit Token() = default;
    };
    void build(const Texts& texts, ValidateNewFilenameCallback completion);

public:
    explicit FilenamePrompt(Token) { }

private:
    void addTextField(const Texts& texts);
    void addCancelAction(std::function<void()> handler);
    void addDefaultAction(const MaybeText& text);
    std::string typedName() const;
    bool withdraw();

    std::shared_ptr<kit::AlertController> _alert;
    std::shared_ptr<SimpleTextViewController> _errMsgViewController;
    std::shared_ptr<kit::AlertAction> _defaultAction;
    MaybeText _origFilename;
    ValidateNewFilenameCallback _validateNewFilenameCallback;
    std::string _confirmedName;
    std::function<void()> _withdraw;
    bool _isAccepted = false, _isWaiting = false;
};

} // namespace tarrow
