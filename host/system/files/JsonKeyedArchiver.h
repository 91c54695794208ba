// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/UserDefaults.h"

namespace host::system {

/// Archives values as JSON: {"version": 1, "root": value}. A value of a type that JSON does not have becomes
/// an object with its type under "$" and its content under "v".
class JsonKeyedArchiver : public platform::KeyedArchiver {
public:
    platform::Data archive(const platform::PropertyValue& value) const override;
    std::optional<platform::PropertyValue> unarchive(const platform::Data& data) const override;
};

} // namespace host::system
