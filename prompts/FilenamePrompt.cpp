// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "prompts/FilenamePrompt.h"

#include "items/FileUtils.h"
#include "kit/controllers/AlertController.h"
#include "kit/layout/LayoutConstraint.h"
#include "kit/views/TextField.h"
#include "platform/Localization.h"
#include "platform/Weakly.h"
#include "prompts/SimpleTextViewController.h"
#include "prompts/UIUtils.h"

#include <algorithm>
#include <utility>

namespace tarrow {

using kit::AlertAction;
using kit::AlertActionStyle;
using kit::AlertController;
using kit::TextField;
using platform::localized;
using platform::weakly;
using platform::weaklyOr;

namespace {

constexpr double fieldHeightToLineHeight = 1.2;

/// The characters with Unicode's property White_Space.
constexpr std::string_view whiteSpace[] = {"\t", "\n", "\v", "\f", "\r", " ", "\u0085", "\u00a0", "\u1680",
    "\u2000", "\u2001", "\u2002", "\u2003", "\u2004", "\u2005", "\u2006", "\u2007", "\u2008", "\u2009",
    "\u200a", "\u2028", "\u2029", "\u202f", "\u205f", "\u3000"};

std::string trimmed(std::string_view text)
{
    const auto atStart = [&](std::string_view space) { return text.starts_with(space); };
    const auto atEnd = [&](std::string_view space) { return text.ends_with(space); };
    for (const auto* space = std::ranges::find_if(whiteSpace, atStart); space != std::end(whiteSpace);
         space = std::ranges::find_if(whiteSpace, atStart))
        text.remove_prefix(space->size());
    for (const auto* space = std::ranges::find_if(whiteSpace, atEnd); space != std::end(whiteSpace);
         space = std::ranges::find_if(whiteSpace, atEnd))
        text.remove_suffix(space->size());
    return std::string(text);
}

/// Answers what is wrong with a name while it is typed. An empty name gets no message.
std::string complaintAbout(const std::string& name)
{
    if (name.empty() || FileUtils::isValidFilename(name))
        return {};
    return name.front() == '.' ? localized("Choose a different name.")
                               : localized("Character not allowed in filename");
}

} // namespace

std::shared_ptr<FilenamePrompt>
FilenamePrompt::newWithTitleMessagePlaceholderFilenameDoneButtonTextCompletion(const MaybeText& title,
    const MaybeText& message, const MaybeText& placeholder, const MaybeText& filename,
    const MaybeText& doneButtonText, ValidateNewFilenameCallback completion)
{
    return initWithTitleMessagePlaceholderFilenameDoneButtonTextCompletion(
        title, message, placeholder, filename, doneButtonText, std::move(completion));
}

std::shared_ptr<FilenamePrompt>
FilenamePrompt::initWithTitleMessagePlaceholderFilenameDoneButtonTextCompletion(const MaybeText& title,
    const MaybeText& message, const MaybeText& placeholder, const MaybeText& filename,
    const MaybeText& doneButtonText, ValidateNewFilenameCallback completion)
{
    auto prompt = std::make_shared<FilenamePrompt>(Token{});
    prompt->build({title, message, placeholder, filename, doneButtonText}, std::move(completion));
    return prompt;
}

void FilenamePrompt::build(const Texts& texts, ValidateNewFilenameCallback completion)
{
    _origFilename = texts.filename;
    _validateNewFilenameCallback = std::move(completion);
    _alert = std::make_shared<AlertController>(
        texts.title.value_or(""), texts.message.value_or(""), kit::AlertStyle::Alert);
    addTextField(texts);
    addCancelAction({});
    addDefaultAction(texts.doneButtonText);
    _errMsgViewController = std::make_shared<SimpleTextViewController>();
    _alert->setContentViewController(_errMsgViewController);
    updateErrorMessage({});
}

void FilenamePrompt::addTextField(const Texts& texts)
{
    _alert->addTextField([&](TextField& field) {
        field.setText(texts.filename.value_or(""));
        field.setPlaceholder(texts.placeholder.value_or(""));
        field.setInputTraits({.returnKey = kit::ReturnKey::Done,
            .returnKeyNeedsText = true,
            .capitalization = kit::Capitalization::Words,
            .autocorrection = kit::Autocorrection::Off,
            .clearButton = kit::ClearButton::WhileEditing});
        field.setDelegate(weak_from_this());
        field.setOnEditingChanged(weakly(this, [edited = field.weak_from_this()](FilenamePrompt& self) {
            self.folderPromptTextFieldChanged(static_cast<const TextField*>(edited.lock().get()));
        }));
        field.setPlacedByFrame(false);
        const double height = field.font().lineHeight() * fieldHeightToLineHeight;
        field.anchor(kit::LayoutAttribute::Height).equalToConstant(height)->setActive(true);
    });
}

void FilenamePrompt::addCancelAction(std::function<void()> handler)
{
    const auto cancel = std::make_shared<AlertAction>(
        localized("Cancel"), AlertActionStyle::Default, [handler = std::move(handler)](const auto&) {
            if (handler)
                handler();
        });
    cancel->setShouldClose(weaklyOr(true, this, &FilenamePrompt::withdraw));
    _alert->addAction(cancel);
    // The action's plain style does not mark it as the one that Escape presses.
    _alert->setEscapeAction(cancel);
}

void FilenamePrompt::addDefaultAction(const MaybeText& text)
{
    _defaultAction = std::make_shared<AlertAction>(
        text && !text->empty() ? *text : localized("Done"), AlertActionStyle::Default);
    _defaultAction->setShouldClose(weaklyOr(false, this, &FilenamePrompt::handleDoneAction));
    _defaultAction->setEnabled(_origFilename && !_origFilename->empty());
    _alert->addAction(_defaultAction);
}

void FilenamePrompt::folderPromptTextFieldChanged(const TextField* field)
{
    if (!field || !_defaultAction)
        return;
    const auto name = trimmed(field->text());
    updateErrorMessage(complaintAbout(name));
    _defaultAction->setEnabled(FileUtils::isValidFilename(name) && !_isWaiting);
}

std::string FilenamePrompt::typedName() const
{
    return trimmed(_alert->textFields().front()->text());
}

bool FilenamePrompt::handleDoneAction()
{
    // The return key may still arrive while the alert is closing.
    if (_alert->textFields().empty() || _isAccepted || _isWaiting)
        return false;
    const auto name = typedName();
    if (!FileUtils::isValidFilename(name))
        return false;
    _confirmedName = name;
    // The callback may release the prompt.
    const auto keepsSelf = shared_from_this();
    bool accepted = false;
    const auto message = _validateNewFilenameCallback(name, accepted);
    if (_isWaiting)
        return false;
    if (!accepted)
        updateErrorMessage(message);
    _isAccepted = accepted;
    return accepted;
}

void FilenamePrompt::waitForAnswer(std::function<void()> withdraw)
{
    _isWaiting = true;
    _withdraw = std::move(withdraw);
    updateErrorMessage({});
    _defaultAction->setEnabled(false);
    // The button loses the keyboard with this, and Escape has to reach the alert.
    _alert->textFields().front()->becomeFirstResponder();
}

bool FilenamePrompt::withdraw()
{
    if (std::exchange(_isWaiting, false) && _withdraw)
        std::exchange(_withdraw, {})();
    return true;
}

void FilenamePrompt::answer(bool accepted, const std::string& message)
{
    if (!std::exchange(_isWaiting, false))
        return;
    _withdraw = {};
    _isAccepted = accepted;
    const auto& field = _alert->textFields().front();
    if (accepted) {
        field->endEditing();
        _alert->dismissViewController(true);
        return;
    }
    folderPromptTextFieldChanged(field.get());
    if (typedName() == _confirmedName)
        updateErrorMessage(message);
}

void FilenamePrompt::updateErrorMessage(const std::string& message)
{
    const auto area = _errMsgViewController->view();
    _errMsgViewController->messageLabel()->setText(message);
    if (area->isHidden() != message.empty())
        area->setHidden(message.empty());
}

bool FilenamePrompt::textFieldShouldReturn(TextField& field)
{
    static constexpr Operation op{"-[FilenamePrompt textFieldShouldReturn:]"};
    op.debug("textFieldShouldReturn");
    const bool mayClose = handleDoneAction();
    if (mayClose) {
        field.endEditing();
        _alert->dismissViewController(true);
    }
    return mayClose;
}

void FilenamePrompt::textFieldDidBeginEditing(TextField& field)
{
    UIUtils::setCursorInTextFieldToBeforeExtension(field);
}

} // namespace tarrow
