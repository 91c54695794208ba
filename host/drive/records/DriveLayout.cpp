// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/records/DriveLayout.h"

#include <sys/stat.h>

#include <cstdlib>
#include <filesystem>

namespace host::drive {

namespace {

std::string environment(const char* name)
{
    const char* value = std::getenv(name);
    return value ? value : "";
}

// The base-directory rules say that a relative path in these variables is to be ignored.
std::string baseFolder(const char* variable, std::string_view belowHome)
{
    auto folder = environment(variable);
    if (!folder.starts_with('/'))
        folder = environment("HOME") + std::string(belowHome);
    return folder + "/tarrow-drive";
}

std::string stateFromEnvironment()
{
    const auto folder = environment("TARROW_DRIVE_STATE");
    return folder.empty() ? folder : std::filesystem::absolute(folder).lexically_normal().string();
}

// The local store itself provides only this account.
constexpr std::string_view localAccountFolder = "/local";

} // namespace

DriveLayout DriveLayout::fromEnvironment()
{
    if (const auto home = environment("TARROW_DRIVE_HOME"); !home.empty())
        return at(std::filesystem::absolute(home).lexically_normal().string(), stateFromEnvironment());
    return at(baseFolder("XDG_DATA_HOME", "/.local/share") + std::string(localAccountFolder),
        baseFolder("XDG_STATE_HOME", "/.local/state"));
}

DriveLayout DriveLayout::at(std::string home, std::string state)
{
    while (home.size() > 1 && home.ends_with('/'))
        home.pop_back();
    DriveLayout layout;
    layout._documents = home + "/documents";
    layout._trash = home + "/trash";
    layout._containers = home + "/containers";
    layout._state = state.empty() ? home + "/state" : std::move(state);
    layout._home = std::move(home);
    return layout;
}

std::string DriveLayout::container(std::string_view identifier) const
{
    return _documents + '/' + std::string(identifier);
}

std::string DriveLayout::containerDocuments(std::string_view identifier) const
{
    auto folder = container(identifier);
    if (identifier != defaultContainerIdentifier)
        folder.append("/").append(documentsFolderName);
    return folder;
}

std::string DriveLayout::containerDescription(std::string_view identifier) const
{
    return _containers + '/' + std::string(identifier) + ".json";
}

platform::Url DriveLayout::documentsURL() const
{
    return platform::Url::fileURL(_documents, platform::PathKind::Directory);
}

platform::Url DriveLayout::defaultContainerURL() const
{
    return platform::Url::fileURL(defaultContainer(), platform::PathKind::Directory);
}

DriveLayout DriveLayout::prepare() const
{
    std::error_code error;
    const std::filesystem::path home(_home);
    std::filesystem::create_directories(home.parent_path(), error);
    ::mkdir(_home.c_str(), 0700);
    const auto resolved = std::filesystem::canonical(home, error);
    if (error)
        return *this;
    const bool stateInside = _state == _home + "/state";
    auto layout = at(resolved.string(), stateInside ? std::string() : _state);
    // What is needed to remove an item is made now, because a full disk must not keep an item from being
    // removed.
    for (const auto& folder : {layout.held(), layout.released(), layout.locks()})
        ::mkdir(folder.c_str(), 0700);
    return layout;
}

} // namespace host::drive
