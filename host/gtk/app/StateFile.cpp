// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/app/StateFile.h"

#include "host/system/files/AtomicWrite.h"
#include "host/system/files/JsonKeyedArchiver.h"
#include "platform/Log.h"

#include <algorithm>
#include <filesystem>
#include <mutex>
#include <optional>
#include <utility>

namespace host::gtk {

namespace {

constexpr std::size_t largestFile = std::size_t{64} * 1024;

platform::Data bytes(const std::string& text)
{
    platform::Data data(text.size());
    std::ranges::transform(text, data.begin(), [](char c) { return static_cast<std::byte>(c); });
    return data;
}

std::string text(const platform::Data& data)
{
    std::string characters(data.size(), '\0');
    std::ranges::transform(data, characters.begin(), [](std::byte b) { return static_cast<char>(b); });
    return characters;
}

} // namespace

/// Writes the latest values, on any thread.
class StateFile::Writer {
public:
    explicit Writer(std::string path)
        : _path(std::move(path))
    {
    }
    const std::string& path() const { return _path; }
    void keep(platform::PropertyDictionary values)
    {
        const std::lock_guard lock(_mutex);
        _waiting = std::move(values);
    }
    void write()
    {
        static constexpr platform::Operation op{"-[StateFile write]"};
        // One writer at a time, so that older values do not replace newer ones.
        const std::lock_guard writing(_writing);
        const auto values = take();
        if (!values)
            return;
        std::error_code ignored; // the write below reports what is wrong with the folder
        std::filesystem::create_directories(std::filesystem::path(_path).parent_path(), ignored);
        const auto error =
            system::writeFileAtomically(_path, text(system::JsonKeyedArchiver().archive(*values)));
        if (error)
            op.error("Failed to store the interface's state: %{public}@", error->debugDescription());
    }

private:
    std::optional<platform::PropertyDictionary> take()
    {
        const std::lock_guard lock(_mutex);
        return std::exchange(_waiting, std::nullopt);
    }

    const std::string _path;
    std::mutex _mutex, _writing;
    std::optional<platform::PropertyDictionary> _waiting;
};

StateFile::StateFile(std::string path, const std::shared_ptr<platform::Dispatch>& dispatch)
    : _writer(std::make_shared<Writer>(std::move(path)))
    , _queue(dispatch ? dispatch->makeSerialQueue("TarrowDriveAppID.interfacestate") : nullptr)
{
    const auto content = system::readWholeFile(_writer->path(), largestFile);
    if (!content)
        return;
    const auto value = system::JsonKeyedArchiver().unarchive(bytes(*content));
    if (const auto* dictionary = value ? value->get<platform::PropertyDictionary>() : nullptr)
        _values = *dictionary;
}

void StateFile::set(const std::string& key, platform::PropertyValue value)
{
    const auto found = _values.find(key);
    if (value.isNull()) {
        if (found == _values.end())
            return;
        _values.erase(found);
    } else {
        if (found != _values.end() && found->second == value)
            return;
        _values.insert_or_assign(key, std::move(value));
    }
    _writer->keep(_values);
    if (_queue)
        _queue->async([writer = _writer] { writer->write(); });
    else
        _writer->write();
}

StateFile::~StateFile()
{
    _queue.reset();
    _writer->write();
}

} // namespace host::gtk
