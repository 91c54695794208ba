// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/files/JsonUserDefaults.h"

#include "host/system/files/Base64.h"
#include "platform/Dispatch.h"
#include "platform/Log.h"

#include <nlohmann/json.hpp>

#include <map>
#include <mutex>

namespace host::system {

using nlohmann::json;
using platform::Data;

namespace {

constexpr int formatVersion = 1;

} // namespace

/// The values and their file, which are shared with a write that is under way.
class JsonUserDefaults::Store {
public:
    explicit Store(std::string path)
        : _file(std::move(path))
    {
        load();
    }

    std::optional<Data> value(const std::string& key) const
    {
        const std::lock_guard lock(_mutex);
        const auto found = _values.find(key);
        return found == _values.end() ? std::nullopt : base64Decoded(found->second);
    }

    /// Answers whether a write has to be posted, which is not so when one is already waiting.
    bool set(const std::string& key, const std::optional<Data>& value)
    {
        const std::lock_guard lock(_mutex);
        if (value)
            _values.insert_or_assign(key, base64Encoded(*value));
        else if (_values.erase(key) == 0)
            return false;
        _isDirty = true;
        return !std::exchange(_writeWaits, true);
    }

    /// Writes the changes since the last write.
    void write()
    {
        static constexpr platform::Operation op{"-[JsonUserDefaults write]"};
        const std::lock_guard oneAtATime(_writing);
        json values;
        {
            const std::lock_guard lock(_mutex);
            _writeWaits = false;
            if (!_isDirty || !_mayWrite)
                return;
            _isDirty = false;
            values = _values;
        }
        const auto error = _file.write({{"version", formatVersion}, {"values", std::move(values)}});
        if (!error)
            return;
        op.error("User defaults not stored: %{public}@", *error);
        const std::lock_guard lock(_mutex);
        _isDirty = true;
    }

private:
    void load()
    {
        auto [state, content] = _file.read();
        if (state == JsonFile::State::Read)
            state = take(*content);
        _mayWrite = state != JsonFile::State::Unreadable;
    }

    JsonFile::State take(const json& content)
    {
        static constexpr platform::Operation op{"-[JsonUserDefaults take:]"};
        const auto version = content.is_object() ? content.value("version", json()) : json();
        if (!version.is_number_integer() || !content.contains("values") || !content["values"].is_object())
            return _file.setAside("it holds no user defaults");
        if (version != formatVersion) {
            op.error("%@ was written by a newer version; changes are not stored", _file.path());
            return JsonFile::State::Unreadable;
        }
        for (const auto& [key, value] : content["values"].items()) {
            if (value.is_string())
                _values.emplace(key, value.get<std::string>());
        }
        return JsonFile::State::Read;
    }

    JsonFile _file;
    bool _mayWrite = true;
    mutable std::mutex _mutex;
    std::mutex _writing;
    std::map<std::string, std::string> _values; // base64, as in the file
    bool _isDirty = false, _writeWaits = false;
};

JsonUserDefaults::JsonUserDefaults(std::string path, platform::Dispatch& dispatch)
    : _store(std::make_shared<Store>(std::move(path)))
    , _queue(dispatch.makeSerialQueue("TarrowDriveAppID.userdefaults"))
{
}

JsonUserDefaults::~JsonUserDefaults()
{
    _queue.reset();
    _store->write();
}

std::optional<Data> JsonUserDefaults::data(const std::string& key) const
{
    return _store->value(key);
}

void JsonUserDefaults::setData(const std::string& key, Data value)
{
    if (_store->set(key, value))
        writeSoon();
}

void JsonUserDefaults::remove(const std::string& key)
{
    if (_store->set(key, std::nullopt))
        writeSoon();
}

void JsonUserDefaults::writeSoon()
{
    _queue->async([store = _store] { store->write(); });
}

} // namespace host::system
