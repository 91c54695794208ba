// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "items/FileUtils.h"
#include "items/ItemMoves.h"
#include "items/UrlResolution.h"
#include "kit/views/TextField.h"
#include "prompts/UIUtils.h"

#include <algorithm>

namespace tarrow {

using kit::TextField;
using kit::TextRange;

namespace {

std::size_t characterCount(std::string_view text)
{
    return static_cast<std::size_t>(std::ranges::count_if(
        text, [](char byte) { return (static_cast<unsigned char>(byte) & 0xC0U) != 0x80U; }));
}

/// Gives an item another name and answers the move; neither value nor error says that it has the name
/// already.
Result<MovedItem> rename(const Url& url, const std::string& name, const FileUtils::StillWanted& stillWanted)
{
    static constexpr Operation op{"+[UIUtils renameItemAtURL:toName:]"};
    if (name.empty()) {
        op.debug("Rename: empty, reverting");
        return Error(FileErrorCode::InvalidName);
    }
    if (!FileUtils::isValidFilename(name)) {
        op.debug("Name is invalid: %@", name);
        return Error(FileErrorCode::InvalidName);
    }
    op.debug("Name is valid: %@", name);
    // A reference that cannot be read any more is renamed like any other item.
    const auto resolved = trw_URLByResolvingBookmark(url).value_or(url);
    if (services().cloudDocumentService().promisedItems().isExternalDocumentReference(url))
        op.debug("Renaming bookmark %@ (%@)", url, resolved);
    const auto destination = UIUtils::computeNewURLNewBasename(resolved, name);
    if (resolved == destination) {
        op.debug("Rename: Old and new URLs are the same: %@ - %@", resolved, destination);
        return {};
    }
    return moveItem(resolved, destination, stillWanted);
}

/// The outcome of giving an item another name.
struct RenameOutcome {
    UIUtils::MaybeError error;
    std::optional<UndoEntry> undo;
};

RenameOutcome renameWhileWanted(const Url& url, const std::string& name, const ItemChange& change)
{
    if (!change.isWanted())
        return {Error(FileErrorCode::Cancelled), {}};
    const auto renamed = rename(url, name, change.stillWanted());
    return {renamed.error, renamed ? undoOfMoves({*renamed}) : std::nullopt};
}

} // namespace

UIUtils::MaybeError UIUtils::renameItemAtURLToName(
    const Url& url, const std::string& name, const FileUtils::StillWanted& stillWanted)
{
    return rename(url, name, stillWanted).error;
}

std::shared_ptr<ItemChange> UIUtils::renameItemAtURLToNameCompletion(const Url& url, const std::string& name,
    std::function<void(const MaybeError& error)> renamed, const std::shared_ptr<UndoHistory>& history,
    const AccountSession& asked)
{
    return ItemChange::begin(
        asked, {url}, [url, name](ItemChange& change) { return renameWhileWanted(url, name, change); },
        [renamed = std::move(renamed), expected = UndoHistory::expect(history, asked)](
            const RenameOutcome& outcome) {
            renamed(outcome.error);
            if (outcome.undo)
                expected->add(*outcome.undo);
        });
}

Url UIUtils::computeNewURLNewBasename(const Url& url, const std::string& name)
{
    const auto folder = url.deletingLastPathComponent();
    auto renamed = folder.appendingPathComponent(name);
    const auto extension = url.pathExtension();
    if (extension.empty() || services().formatters().equalIgnoringCase(extension, renamed.pathExtension()))
        return renamed;
    return folder.appendingPathComponent(name + "." + extension);
}

void UIUtils::setCursorInTextFieldToBeforeExtension(TextField& field)
{
    const auto dot = field.text().rfind('.');
    if (dot != std::string::npos)
        selectTextInTextFieldRange(field, {characterCount(std::string_view(field.text()).substr(0, dot)), 0});
}

void UIUtils::selectTextInTextFieldRange(TextField& field, TextRange range)
{
    field.setSelectedRange(range);
}

} // namespace tarrow
