// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include <memory>

namespace platform {
class Dispatch;
class FileCoordinator;
class LinkOpener;
class Localization;
class NotificationCenter;
class TypeRegistry;
} // namespace platform

namespace host::drive {

/// The services that the drive's own services need.
struct DriveDependencies {
    std::shared_ptr<platform::Dispatch> dispatch;
    std::shared_ptr<platform::NotificationCenter> notificationCenter;
    std::shared_ptr<platform::TypeRegistry> typeRegistry;
    std::shared_ptr<platform::Localization> localization; ///< null: names are not translated
    std::shared_ptr<platform::LinkOpener> linkOpener; ///< null: no page can be opened
    std::shared_ptr<platform::FileCoordinator> fileCoordinator = {}; ///< null: no other writers are kept out
};

} // namespace host::drive
