// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Dispatch.h"
#include "platform/PropertyValue.h"

#include <memory>
#include <string>

namespace host::gtk {

/// The state of the interface that is kept from run to run: the window's size and the state of its screens.
/// Main thread only; the file is written on another thread, and what is not written yet when this ends is
/// written then.
class StateFile {
public:
    /// Reads the file. The folder of the path is made when it is missing. Without a dispatch every change is
    /// written at once.
    explicit StateFile(std::string path, const std::shared_ptr<platform::Dispatch>& dispatch = nullptr);
    ~StateFile();
    StateFile(const StateFile&) = delete;
    StateFile& operator=(const StateFile&) = delete;

    /// Answers the values that were stored last, or none when the file is missing or damaged.
    const platform::PropertyDictionary& values() const { return _values; }
    /// Stores a value under a key; null removes the key. The file is replaced atomically, and not written
    /// when nothing changes.
    void set(const std::string& key, platform::PropertyValue value);

private:
    class Writer;

    std::shared_ptr<Writer> _writer;
    std::shared_ptr<platform::Queue> _queue;
    platform::PropertyDictionary _values;
};

} // namespace host::gtk
