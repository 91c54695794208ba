// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "platform/Services.h"

#include "platform/AppRegistry.h"
#include "platform/Application.h"
#include "platform/CharacterData.h"
#include "platform/CloudDocumentService.h"
#include "platform/Dispatch.h"
#include "platform/DocumentSharing.h"
#include "platform/FileChanges.h"
#include "platform/FileCoordinator.h"
#include "platform/FileSystem.h"
#include "platform/FolderLister.h"
#include "platform/Formatters.h"
#include "platform/ImageLoader.h"
#include "platform/KeyValueStore.h"
#include "platform/LauncherShortcuts.h"
#include "platform/LinkOpener.h"
#include "platform/Localization.h"
#include "platform/NameSearch.h"
#include "platform/NotificationCenter.h"
#include "platform/PagedDocument.h"
#include "platform/PreviewSupport.h"
#include "platform/StorageOffers.h"
#include "platform/Trash.h"
#include "platform/TypeRegistry.h"
#include "platform/UserDefaults.h"

namespace platform {

namespace {

Services& installed()
{
    static Services instance{ServiceSet{}};
    return instance;
}

} // namespace

const Services& services()
{
    return installed();
}

void installServices(ServiceSet set)
{
    installed() = Services(std::move(set));
}

} // namespace platform
