// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace host::system {

/// The natural order of names in a language: letters as in its dictionaries, case and accents only to break
/// ties, "file 2" before "file 10". Any thread.
class NameOrder {
public:
    /// `locale` is ICU's name of a locale.
    explicit NameOrder(const std::string& locale);
    NameOrder(NameOrder&&) noexcept;
    ~NameOrder();

    /// Appends the name's sort key, whose bytes are to be compared. Bytes that are not UTF-8 sort like the
    /// replacement character.
    void appendKey(std::string_view name, std::vector<std::uint8_t>& keys) const;

private:
    struct Data;
    std::unique_ptr<Data> _data;
};

} // namespace host::system
