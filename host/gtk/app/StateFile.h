// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/PropertyValue.h"

#include <string>

namespace host::gtk {

/// What the interface keeps from run to run: the window's size, and the state of its screens. Main thread
/// only.
class StateFile {
public:
    /// The folder of the path is made when it is missing.
    explicit StateFile(std::string path);

    /// As it was stored last; empty when nothing was, or what is there is damaged.
    const platform::PropertyDictionary& values() const { return _values; }
    /// Stores a value under a key, without the key when it is null. The file changes in one step; it is left
    /// alone when it would not change.
    void set(const std::string& key, platform::PropertyValue value);

private:
    void write() const;

    std::string _path;
    platform::PropertyDictionary _values;
};

} // namespace host::gtk
