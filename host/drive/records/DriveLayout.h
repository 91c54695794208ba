// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Url.h"

#include <string>
#include <string_view>

namespace host::drive {

/// The paths of everything that belongs to an account. All paths are absolute. Only prepare() reads or
/// changes the disk.
class DriveLayout {
public:
    /// The identifier of the default container, whose folder is the top level of the drive.
    static constexpr std::string_view defaultContainerIdentifier = "BrindleDefault";
    /// The folder inside any other container that holds its documents.
    static constexpr std::string_view documentsFolderName = "Documents";

    /// Answers `$TARROW_DRIVE_HOME`, else the local account's folder below `$XDG_DATA_HOME/tarrow-drive/`. A
    /// home from the environment contains the state as well, unless `$TARROW_DRIVE_STATE` names another
    /// folder.
    static DriveLayout fromEnvironment();
    /// Answers a layout at a folder. An empty `state` means a folder inside it.
    static DriveLayout at(std::string home, std::string state = {});

    const std::string& home() const { return _home; }
    const std::string& documents() const { return _documents; } ///< the documents area
    const std::string& trash() const { return _trash; }
    const std::string& containers() const { return _containers; } ///< the containers' descriptions
    std::string account() const { return _home + '/' + std::string(accountFileName); }
    std::string keyValueStore() const { return _home + '/' + std::string(keyValueFileName); }
    std::string index() const { return _home + "/index.sqlite"; } ///< document identifiers
    std::string cloud() const { return _home + "/cloud"; } ///< contents of items that are not downloaded
    /// The folder of contents whose promise has gone, until it is certain that no other promise names them.
    std::string released() const { return _home + "/released"; }
    /// The folder with one file for each device, which tells its current activity.
    std::string activities() const { return _home + "/activities"; }
    /// The folder of items that are being removed, each under a private name.
    std::string held() const { return _home + "/held"; }
    /// The lock file by which the processes that use the drive exclude each other. Its content is never read.
    std::string coordination() const { return locks() + "/coordination"; }
    /// The lock file that is held while an identifier is given to a document. Its content is never read.
    std::string identification() const { return locks() + "/identifiers"; }
    /// The lock file that is held while the released contents are looked through. It holds how long that took
    /// the last time, in milliseconds.
    std::string collection() const { return locks() + "/collection"; }
    std::string locks() const { return _home + "/locks"; }
    /// The folder of the application's own state: defaults and saved interface state.
    const std::string& state() const { return _state; }
    std::string defaults() const { return _state + "/defaults.json"; }
    std::string device() const { return _state + "/device"; } ///< this device's identifier
    std::string interfaceState() const { return _state + "/interface.json"; }
    std::string recentDocument() const { return _state + "/recent-document.json"; }

    std::string container(std::string_view identifier) const;
    /// Answers the documents folder of a container.
    std::string containerDocuments(std::string_view identifier) const;
    std::string containerDescription(std::string_view identifier) const;
    std::string defaultContainer() const { return container(defaultContainerIdentifier); }

    platform::Url documentsURL() const;
    platform::Url defaultContainerURL() const;

    /// Creates the home folder and the folders that removals need when they are missing, for the user alone,
    /// and answers the same layout with the
    /// links in the home's path resolved, so that paths compare equal to the file system's answers.
    DriveLayout prepare() const;

    static constexpr std::string_view accountFileName = "account.json";
    static constexpr std::string_view keyValueFileName = "keyvalue.json";

private:
    DriveLayout() = default;

    std::string _home, _documents, _trash, _containers, _state;
};

} // namespace host::drive
