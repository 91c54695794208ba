// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/PropertyValue.h"

#include <string>

namespace host::gtk {

/// The state of the interface that is kept from run to run: the window's size and the state of its screens.
/// Main thread only.
class StateFile {
public:
    /// Reads the file. The folder of the path is made when it is missing.
    explicit StateFile(std::string path);

    /// Answers the values that were stored last, or none when the file is missing or damaged.
    const platform::PropertyDictionary& values() const { return _values; }
    /// Stores a value under a key; null removes the key. The file is replaced atomically, and not written
    /// when nothing changes.
    void set(const std::string& key, platform::PropertyValue value);

private:
    void write() const;

    std::string _path;
    platform::PropertyDictionary _values;
};

} // namespace host::gtk
