// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Url.h"

#include <string>
#include <string_view>

namespace host::drive {

/// Where everything of an account lies on disk. All paths are absolute; nothing is looked at or made but by
/// prepare().
class DriveLayout {
public:
    /// The identifier of the default container, whose folder is the top level of the drive.
    static constexpr std::string_view defaultContainerIdentifier = "BrindleDefault";
    /// The folder inside any other container that holds its documents.
    static constexpr std::string_view documentsFolderName = "Documents";

    /// `$TARROW_DRIVE_HOME`, else the local account's folder below `$XDG_DATA_HOME/tarrow-drive/`. A home of
    /// the environment's choice keeps the state inside, unless `$TARROW_DRIVE_STATE` says where.
    static DriveLayout fromEnvironment();
    /// A layout at a folder; `state` empty means a folder inside it.
    static DriveLayout at(std::string home, std::string state = {});

    const std::string& home() const { return _home; }
    const std::string& documents() const { return _documents; } ///< the documents area
    const std::string& trash() const { return _trash; }
    const std::string& containers() const { return _containers; } ///< the containers' descriptions
    std::string account() const { return _home + '/' + std::string(accountFileName); }
    std::string keyValueStore() const { return _home + '/' + std::string(keyValueFileName); }
    std::string index() const { return _home + "/index.sqlite"; } ///< document identifiers
    std::string cloud() const { return _home + "/cloud"; } ///< contents of what is not downloaded
    /// What the account's devices are doing, a file for each.
    std::string activities() const { return _home + "/activities"; }
    /// Items that are being removed, each under a private name.
    std::string held() const { return _home + "/held"; }
    /// Where the processes that use the drive exclude each other; its content is never read.
    std::string coordination() const { return locks() + "/coordination"; }
    /// Whoever gives a document identifier holds this file locked; its content is never read.
    std::string identification() const { return locks() + "/identifiers"; }
    std::string locks() const { return _home + "/locks"; }
    /// What the application keeps between runs: defaults and saved interface state.
    const std::string& state() const { return _state; }
    std::string defaults() const { return _state + "/defaults.json"; }
    std::string device() const { return _state + "/device"; } ///< what tells this device from others
    std::string interfaceState() const { return _state + "/interface.json"; }

    std::string container(std::string_view identifier) const;
    /// The documents folder of a container.
    std::string containerDocuments(std::string_view identifier) const;
    std::string containerDescription(std::string_view identifier) const;
    std::string defaultContainer() const { return container(defaultContainerIdentifier); }

    platform::Url documentsURL() const;
    platform::Url defaultContainerURL() const;

    /// Makes the home folder (only the user may enter it) when it is missing, and answers the same layout
    /// with the links in the home's path resolved, so that paths compare equal to what the file system
    /// answers.
    DriveLayout prepare() const;

    static constexpr std::string_view accountFileName = "account.json";
    static constexpr std::string_view keyValueFileName = "keyvalue.json";

private:
    DriveLayout() = default;

    std::string _home, _documents, _trash, _containers, _state;
};

} // namespace host::drive
