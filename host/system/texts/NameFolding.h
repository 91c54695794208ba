// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <memory>
#include <string>
#include <string_view>

namespace host::system {

/// Makes names comparable for a search: without case, accents and compatibility forms ("Café" becomes "cafe",
/// "ﬁ" becomes "fi"). Any thread.
class NameFolding {
public:
    NameFolding();
    NameFolding(NameFolding&&) noexcept;
    ~NameFolding();

    /// Appends the folded form of a name. Bytes that are not UTF-8 become the replacement character.
    void append(std::string_view name, std::string& folded) const;

private:
    struct Data;
    std::unique_ptr<Data> _data;
};

} // namespace host::system
