// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/trash/TrashRecord.h"

#include "host/drive/records/LinkRecords.h"

#include <charconv>

namespace host::drive {

namespace {

constexpr std::string_view trashedText = "trashed", keptCopyText = "kept-copy";

/// Answers a text up to the next NUL and takes both away, or nothing when there is no NUL.
std::optional<std::string_view> takeField(std::string_view& text)
{
    const auto end = text.find('\0');
    if (end == std::string_view::npos)
        return std::nullopt;
    const auto field = text.substr(0, end);
    text.remove_prefix(end + 1);
    return field;
}

} // namespace

std::string TrashRecord::text() const
{
    const auto why = reason == Reason::KeptCopy ? keptCopyText : trashedText;
    return origin + '\0' + std::to_string(trashed.nanoseconds) + '\0' + std::string(why) + '\0';
}

std::optional<TrashRecord> TrashRecord::parse(std::string_view text)
{
    const auto origin = takeField(text), date = takeField(text), why = takeField(text);
    if (!origin || !date || !why || !isPlainRelativePath(*origin))
        return std::nullopt;
    TrashRecord record{std::string(*origin), {}, *why == keptCopyText ? Reason::KeptCopy : Reason::Trashed};
    const auto* end = date->data() + date->size();
    const auto read = std::from_chars(date->data(), end, record.trashed.nanoseconds);
    if (read.ec != std::errc() || read.ptr != end || (*why != trashedText && *why != keptCopyText))
        return std::nullopt;
    return record;
}

} // namespace host::drive
