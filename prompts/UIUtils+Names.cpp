// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "items/FileUtils.h"
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

} // namespace

UIUtils::MaybeError UIUtils::renameItemAtURLToName(
    const Url& url, const std::string& name, const FileUtils::StillWanted& stillWanted)
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
    const auto destination = computeNewURLNewBasename(resolved, name);
    if (resolved == destination) {
        op.debug("Rename: Old and new URLs are the same: %@ - %@", resolved, destination);
        return std::nullopt;
    }
    return FileUtils::moveTo(resolved, destination, stillWanted);
}

std::shared_ptr<ItemChange> UIUtils::renameItemAtURLToNameCompletion(const Url& url, const std::string& name,
    std::function<void(const MaybeError& error)> renamed, const AccountSession& asked)
{
    return ItemChange::begin(
        asked, {url},
        [url, name](ItemChange& change) {
            return change.isWanted() ? renameItemAtURLToName(url, name, change.stillWanted())
                                     : MaybeError(Error(FileErrorCode::Cancelled));
        },
        std::move(renamed));
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
