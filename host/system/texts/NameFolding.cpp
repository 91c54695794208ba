// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/texts/NameFolding.h"

#include <unicode/bytestream.h>
#include <unicode/normalizer2.h>
#include <unicode/uchar.h>
#include <unicode/unistr.h>

#include <algorithm>

namespace host::system {

struct NameFolding::Data {
    /// The library owns these; they are null when its data is not installed.
    const icu::Normalizer2* caseFolding = nullptr;
    const icu::Normalizer2* decomposition = nullptr;
};

namespace {

bool isAscii(std::string_view text)
{
    return std::ranges::all_of(text, [](char c) { return static_cast<unsigned char>(c) < 0x80; });
}

char lower(char c)
{
    return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
}

icu::UnicodeString withoutMarks(const icu::UnicodeString& text)
{
    icu::UnicodeString kept;
    for (int32_t i = 0; i < text.length(); i = text.moveIndex32(i, 1)) {
        const auto point = text.char32At(i);
        if (u_charType(point) != U_NON_SPACING_MARK)
            kept.append(point);
    }
    return kept;
}

} // namespace

NameFolding::NameFolding()
    : _data(std::make_unique<Data>())
{
    auto status = U_ZERO_ERROR;
    _data->caseFolding = icu::Normalizer2::getNFKCCasefoldInstance(status);
    _data->decomposition = icu::Normalizer2::getNFDInstance(status);
    if (U_FAILURE(status))
        *_data = {};
}

NameFolding::NameFolding(NameFolding&&) noexcept = default;
NameFolding::~NameFolding() = default;

void NameFolding::append(std::string_view name, std::string& folded) const
{
    if (isAscii(name) || !_data->caseFolding) {
        std::ranges::transform(name, std::back_inserter(folded), lower);
        return;
    }
    auto status = U_ZERO_ERROR;
    const auto text =
        icu::UnicodeString::fromUTF8(icu::StringPiece(name.data(), static_cast<int32_t>(name.size())));
    const auto plain = _data->decomposition->normalize(_data->caseFolding->normalize(text, status), status);
    withoutMarks(U_SUCCESS(status) ? plain : text).toUTF8String(folded);
}

} // namespace host::system
