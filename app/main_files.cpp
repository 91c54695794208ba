// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/service/LocalCloudDocumentService.h"
#include "host/system/coordination/LocalFileCoordinator.h"
#include "host/system/desktop/JournalLogSink.h"
#include "host/system/desktop/MimeTypeRegistry.h"
#include "host/system/files/PosixFileSystem.h"
#include "host/system/queues/GLibDispatch.h"
#include "items/DocumentIdentifiers.h"
#include "items/FileUtils.h"
#include "platform/FileSystem.h"
#include "platform/NotificationCenter.h"

#include <cstdio>
#include <future>
#include <map>
#include <string>
#include <string_view>
#include <vector>

/// The file operations of the program from a command line, for trying faults on them one call at a time
/// (kills, full disks, other writers). Paths are below the drive's top level.

namespace {

using host::drive::LocalCloudDocumentService;
using platform::Url;
using tarrow::FileUtils;

std::shared_ptr<LocalCloudDocumentService> installDrive(const std::shared_ptr<platform::Dispatch>& dispatch)
{
    platform::ServiceSet set;
    set.dispatch = dispatch;
    set.notificationCenter = std::make_shared<platform::NotificationCenter>();
    set.typeRegistry = std::make_shared<host::system::MimeTypeRegistry>();
    auto cloud = LocalCloudDocumentService::create(host::drive::DriveLayout::fromEnvironment(),
        {set.dispatch, set.notificationCenter, set.typeRegistry, nullptr, nullptr}, {});
    set.cloudDocumentService = cloud;
    set.fileCoordinator = std::make_shared<host::system::LocalFileCoordinator>(
        host::system::LocalFileCoordinator::Settings{.lockFile = cloud->layout().coordination()});
    set.fileSystem = std::make_shared<host::system::PosixFileSystem>(cloud->itemChanges());
    platform::installServices(std::move(set));
    return cloud;
}

int report(const std::optional<platform::Error>& error)
{
    if (error)
        std::fprintf(stderr, "%s\n", error->debugDescription().c_str());
    return error ? 1 : 0;
}

int printIdentifier(const Url& url)
{
    const auto identifier = platform::services().cloudDocumentService().documentIdentifiers().identify(url);
    if (identifier)
        std::printf("%u\n", *identifier);
    return report(identifier.error);
}

/// Takes an identifier, not a path.
int printLocation(const std::string& identifier)
{
    const auto url = tarrow::trw_URLFromDocumentID(identifier);
    if (url)
        std::printf("%s\n", url->path().c_str());
    return url ? 0 : 1;
}

const char* kindName(platform::FileType type)
{
    switch (type) {
    case platform::FileType::Regular:
        return "document";
    case platform::FileType::Directory:
        return "folder";
    case platform::FileType::SymbolicLink:
        return "link";
    case platform::FileType::Other:
        break;
    }
    return "other";
}

/// Brings a document here from the cloud, and waits for it.
int fetch(const Url& url, host::system::GLibDispatch& dispatch)
{
    std::optional<std::optional<platform::Error>> ended;
    const auto download = platform::services().cloudDocumentService().items().startDownload(
        url, {nullptr, [&](const std::optional<platform::Error>& error) { ended = error; }});
    dispatch.runMainQueueUntil([&] { return ended.has_value(); });
    return report(*ended);
}

/// Saves the content of one document in the place of another's.
int save(const Url& url, const Url& from)
{
    constexpr std::size_t mostBytes = 64UL * 1024 * 1024;
    auto& files = platform::services().fileSystem();
    const auto content = files.contentToReplace(from.path(), mostBytes);
    const auto before = files.contentToReplace(url.path(), mostBytes);
    if (!content || !before)
        return report(content ? before.error : content.error);
    return report(files.replaceContent(url.path(), *before, *content->bytes).error);
}

/// Prints what a user sees below a folder, sorted by path: the kind, a tab, the path. A document that hides a
/// promise is listed once.
int list(const Url& folder)
{
    using Continue = platform::FileSystem::Continue;
    auto& promised = platform::services().cloudDocumentService().promisedItems();
    std::map<std::string, const char*> kinds;
    std::optional<platform::Error> failed;
    platform::services().fileSystem().enumerateDeeply(
        folder,
        [&](const Url& item, platform::FileType type) {
            const auto logical = promised.logicalURLForPromise(item);
            if (logical != item)
                kinds.emplace(logical.path(), "promise");
            else if (!item.lastPathComponent().starts_with('.'))
                kinds.insert_or_assign(item.path(), kindName(type));
            return Continue::Yes;
        },
        [&](const Url&, const platform::Error& error) {
            failed = error;
            return Continue::Yes;
        });
    for (const auto& [path, kind] : kinds)
        std::printf("%s\t%s\n", kind, path.c_str() + folder.path().size() + 1);
    return report(failed);
}

/// The exit status; 2 for what is no command.
int run(std::string_view command, const std::vector<Url>& urls, host::system::GLibDispatch& dispatch)
{
    if (command == "mkdir" && urls.size() == 1)
        return report(FileUtils::mkdir(urls[0]));
    if (command == "remove" && urls.size() == 1)
        return report(FileUtils::remove(urls[0]));
    if (command == "move" && urls.size() == 2)
        return report(FileUtils::moveTo(urls[0], urls[1]));
    if (command == "save" && urls.size() == 2)
        return save(urls[0], urls[1]);
    if (command == "fetch" && urls.size() == 1)
        return fetch(urls[0], dispatch);
    if (command == "list" && urls.size() == 1)
        return list(urls[0]);
    if (command == "evict" && urls.size() == 1)
        return FileUtils::evictDocument(urls[0]) ? 0 : 1;
    if (command == "docid" && urls.size() == 1)
        return printIdentifier(urls[0]);
    return 2;
}

} // namespace

int main(int argc, char** argv)
{
    host::system::installSystemLog();
    const std::vector<std::string> arguments(argv, argv + argc);
    // The queues end last: the services may still hand them work while they end.
    const auto dispatch = std::make_shared<host::system::GLibDispatch>();
    const auto top = installDrive(dispatch)->layout().defaultContainer();
    std::vector<Url> urls;
    for (std::size_t i = 2; i < arguments.size(); ++i)
        urls.push_back(Url::fileURL(top + '/' + arguments[i]));
    if (arguments.size() == 2 && arguments[1] == "list")
        urls.push_back(Url::fileURL(top));
    const bool resolves = arguments.size() == 3 && arguments[1] == "resolve";
    // The main thread would look only as long as nobody notices.
    const int status = resolves ? std::async(std::launch::async, printLocation, arguments[2]).get()
        : arguments.size() > 1  ? run(arguments[1], urls, *dispatch)
                                : 2;
    if (status == 2)
        std::fputs("usage: tarrow-files list [PATH] | mkdir|remove|evict|fetch|docid PATH | move FROM TO | "
                   "save PATH FROM | resolve ID\n",
            stderr);
    platform::installServices({});
    return status;
}
