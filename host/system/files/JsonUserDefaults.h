// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/system/files/JsonFile.h"
#include "platform/UserDefaults.h"

#include <memory>
#include <string>

namespace platform {
class Dispatch;
class Queue;
} // namespace platform

namespace host::system {

/// Keeps user defaults in one JSON file. The file is read once. Changes are written atomically on a queue,
/// several at once as one write; those that still wait are written by the destructor. A file that exists but
/// cannot be read, or that a newer version wrote, is left as it is.
class JsonUserDefaults : public platform::UserDefaults {
public:
    JsonUserDefaults(std::string path, platform::Dispatch& dispatch);
    ~JsonUserDefaults() override;

    std::optional<platform::Data> data(const std::string& key) const override;
    void setData(const std::string& key, platform::Data value) override;
    void remove(const std::string& key) override;

private:
    class Store;
    void writeSoon();

    std::shared_ptr<Store> _store;
    std::shared_ptr<platform::Queue> _queue;
};

} // namespace host::system
