// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/UserDefaults.h"

namespace host::system {

/// Archives as JSON: {"version": 1, "root": value}. Values that JSON has no kind for are objects with their
/// kind under "$" and their content under "v".
class JsonKeyedArchiver : public platform::KeyedArchiver {
public:
    platform::Data archive(const platform::PropertyValue& value) const override;
    std::optional<platform::PropertyValue> unarchive(const platform::Data& data) const override;
};

} // namespace host::system
