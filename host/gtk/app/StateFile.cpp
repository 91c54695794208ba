// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/gtk/app/StateFile.h"

#include "host/system/files/AtomicWrite.h"
#include "host/system/files/JsonKeyedArchiver.h"
#include "platform/Log.h"

#include <algorithm>
#include <filesystem>
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

StateFile::StateFile(std::string path)
    : _path(std::move(path))
{
    const auto content = system::readWholeFile(_path, largestFile);
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
    write();
}

void StateFile::write() const
{
    static constexpr platform::Operation op{"-[StateFile write]"};
    std::error_code ignored; // the write below reports what is wrong with the folder
    std::filesystem::create_directories(std::filesystem::path(_path).parent_path(), ignored);
    const auto error = system::writeFileAtomically(_path, text(system::JsonKeyedArchiver().archive(_values)));
    if (error)
        op.error("Failed to store the interface's state: %{public}@", error->debugDescription());
}

} // namespace host::gtk
