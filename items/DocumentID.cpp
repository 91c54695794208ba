// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "items/DocumentID.h"

#include "items/FileUtils.h"

#include <cerrno>
#include <charconv>
#include <limits>
#include <system_error>

namespace tarrow {

namespace {

/// Answers the number at the start of a text. One that is too large counts as the largest.
std::optional<std::uint64_t> leadingNumber(std::string_view text)
{
    text.remove_prefix(std::min(text.find_first_not_of(" \t\n\v\f\r"), text.size()));
    std::uint64_t number = 0;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), number);
    if (error == std::errc::result_out_of_range)
        return std::numeric_limits<std::uint64_t>::max();
    return error == std::errc{} ? std::optional(number) : std::nullopt;
}

using platform::DocumentIdentifiers;

DocumentIdentifiers& documentIdentifiers()
{
    return services().cloudDocumentService().documentIdentifiers();
}

std::string textOf(const Error& error)
{
    return std::generic_category().message(error.code());
}

Result<DocumentIdentifiers::File> resolveDocumentId(std::uint64_t identifier)
{
    // The file system stores 32 bits. A longer number must not be taken for the document with its lower half.
    if (identifier > std::numeric_limits<std::uint32_t>::max())
        return Error(platform::errorDomain::system, ENOENT);
    return documentIdentifiers().resolve(static_cast<std::uint32_t>(identifier));
}

} // namespace

std::int64_t trw_DocumentID(const Url& url)
{
    const auto value = FileUtils::getResourceValueForURL(AttributeKey::DocumentIdentifier, url);
    const auto* number = value ? std::get_if<std::uint64_t>(&*value) : nullptr;
    return number ? static_cast<std::int64_t>(*number) : 0;
}

std::optional<Url> trw_URLFromDocumentID(const std::optional<std::string>& documentID)
{
    static constexpr Operation op{"+[Url(TarrowDriveApp_StrataAdditions) trw_URLFromDocumentID:]"};
    if (!documentID) {
        op.error("trw_URLFromDocumentID: missing document ID");
        return std::nullopt;
    }
    const auto identifier = leadingNumber(*documentID);
    if (!identifier)
        return std::nullopt;
    auto& identifiers = documentIdentifiers();
    if (!identifiers.deviceIdentifier()) {
        op.error("could not get device ID");
        return std::nullopt;
    }
    const auto file = resolveDocumentId(*identifier);
    if (!file) {
        op.error("VXLibraryResolveDocumentId2 failed, errno:%d(%s)", file.error->code(), textOf(*file.error));
        return std::nullopt;
    }
    const auto open = identifiers.open(*file);
    if (!open) {
        op.error("openDocument failed, errno:%d(%s)", open.error->code(), textOf(*open.error));
        return std::nullopt;
    }
    const auto found = (*open)->attributes();
    if (!found) {
        op.error("readAttributes failed, error:%d(%s)", found.error->code(), textOf(*found.error));
        return std::nullopt;
    }
    if (found->documentIdentifier != *identifier) {
        op.error("document IDs didn't match (%d v/s %@)", found->documentIdentifier, *identifier);
        return std::nullopt;
    }
    return found->url;
}

} // namespace tarrow
