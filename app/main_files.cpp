// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/service/LocalCloudDocumentService.h"
#include "host/system/coordination/LocalFileCoordinator.h"
#include "host/system/desktop/JournalLogSink.h"
#include "host/system/desktop/MimeTypeRegistry.h"
#include "host/system/files/ItemPaths.h"
#include "host/system/files/PosixFileSystem.h"
#include "host/system/files/PromisedNames.h"
#include "host/system/files/SystemErrors.h"
#include "host/system/queues/GLibDispatch.h"
#include "items/DocumentID.h"
#include "items/FileUtils.h"
#include "items/TrashUtils.h"
#include "platform/DocumentContainers.h"
#include "platform/FileChanges.h"
#include "platform/FileCoordinator.h"
#include "platform/FileSystem.h"
#include "platform/NotificationCenter.h"
#include "platform/Trash.h"

#include <cerrno>
#include <cstdio>
#include <future>
#include <map>
#include <string>
#include <string_view>
#include <vector>

/// This program runs the application's file operations from a command line, so that faults (kills, full
/// disks, other writers) can be tried on them one call at a time. Paths are below the drive's top level.

namespace {

using host::drive::LocalCloudDocumentService;
using platform::Url;
using tarrow::FileUtils;
using tarrow::TrashUtils;

constexpr std::string_view removingLibrary = "remove-library";
constexpr std::size_t mostBytes = 64UL * 1024 * 1024; ///< of a document that is saved or added

std::shared_ptr<LocalCloudDocumentService> installDrive(const std::shared_ptr<platform::Dispatch>& dispatch)
{
    platform::ServiceSet set;
    set.dispatch = dispatch;
    set.notificationCenter = std::make_shared<platform::NotificationCenter>();
    set.typeRegistry = std::make_shared<host::system::MimeTypeRegistry>();
    const auto layout = host::drive::DriveLayout::fromEnvironment().prepare();
    set.fileCoordinator = std::make_shared<host::system::LocalFileCoordinator>(
        host::system::LocalFileCoordinator::Settings{.lockFile = layout.coordination()});
    auto cloud = LocalCloudDocumentService::create(layout,
        {set.dispatch, set.notificationCenter, set.typeRegistry, nullptr, nullptr, set.fileCoordinator}, {});
    set.cloudDocumentService = cloud;
    set.fileChanges = cloud->fileChanges();
    set.trash = cloud->trash();
    set.fileSystem = std::make_shared<host::system::PosixFileSystem>();
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

/// Prints the location of a document identifier.
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

const char* reasonName(platform::TrashedItem::Reason reason)
{
    switch (reason) {
    case platform::TrashedItem::Reason::Trashed:
        return "trashed";
    case platform::TrashedItem::Reason::NotPutBack:
        return "not put back";
    case platform::TrashedItem::Reason::KeptCopy:
        return "kept copy";
    case platform::TrashedItem::Reason::ContentWithoutPromise:
        break;
    }
    return "content without a promise";
}

/// Prints what is in the trash: the reason, a tab, the name for `restore` and `drop`, a tab, where it was.
int listTrash()
{
    const auto items = platform::services().trash().items();
    for (const auto& item : items.value.value_or(std::vector<platform::TrashedItem>()))
        std::printf("%s\t%s\t%s\n", reasonName(item.reason), item.identifier.c_str(), item.origin.c_str());
    return report(items.error);
}

/// Downloads a document from the cloud and waits for the end.
int fetch(const Url& url, host::system::GLibDispatch& dispatch)
{
    std::optional<std::optional<platform::Error>> ended;
    const auto download = platform::services().cloudDocumentService().items().startDownload(
        url, {nullptr, [&](const std::optional<platform::Error>& error) { ended = error; }});
    dispatch.runMainQueueUntil([&] { return ended.has_value(); });
    return report(*ended);
}

/// Replaces the content of one document by that of another.
int save(const Url& url, const Url& from)
{
    auto& files = platform::services().fileChanges();
    const auto content = files.contentToReplace(from.path(), mostBytes);
    const auto before = files.contentToReplace(url.path(), mostBytes);
    if (!content || !before)
        return report(content ? before.error : content.error);
    return report(files.replaceContent(url.path(), *before, *content->bytes).error);
}

/// Makes a document with the content, the tags and the access of another one.
int add(const Url& url, const Url& like)
{
    auto& files = platform::services().fileChanges();
    const auto content = files.contentToReplace(like.path(), mostBytes);
    return report(content ? files.addDocument(url.path(), like.path(), *content->bytes) : content.error);
}

/// Deletes the documents of an app library, whose description stays.
int removeLibrary(const Url& documents)
{
    auto& containers = platform::services().cloudDocumentService().containers();
    const auto library = containers.containerForItem(documents);
    if (!library)
        return report(library.error);
    std::optional<platform::Error> failed;
    const auto refused = platform::services().fileCoordinator().coordinateWriting(documents,
        platform::WritingOptions::ForDeleting,
        [&](const Url&) { failed = containers.deleteContents(**library); });
    return report(refused ? refused : failed);
}

/// Gives an item tags in place of its own.
int tag(const Url& url, const std::vector<Url>& tags)
{
    std::vector<std::string> names;
    names.reserve(tags.size());
    for (const auto& each : tags)
        names.push_back(each.lastPathComponent());
    const auto before = FileUtils::setTags(url, names);
    return report(before.error);
}

/// Prints the items that a user sees below a folder, sorted by path: the kind, a tab, the path. A document
/// beside its own promise is listed once.
int list(const Url& folder)
{
    using Continue = platform::FileSystem::Continue;
    std::map<std::string, const char*> kinds;
    std::optional<platform::Error> failed;
    platform::services().fileSystem().enumerateDeeply(
        folder,
        [&](const Url& item, platform::FileType type) {
            const auto name = host::system::promisedName(item.path());
            if (!name && !name.error.is(EBADMSG) && !name.error.is(ENOENT))
                failed = host::system::systemError(name.error, item.path());
            if (name)
                kinds.emplace(host::system::siblingPath(item.path(), *name), "promise");
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

/// Works on an item in the trash, or answers 2 for an unknown command.
int runInTrash(std::string_view command, const std::string& identifier)
{
    auto& trash = platform::services().trash();
    if (command == "restore")
        return report(trash.restore(identifier, std::nullopt).error);
    return command == "drop" ? report(trash.remove(identifier)) : 2;
}

/// Answers the exit status, which is 2 for an unknown command.
int run(std::string_view command, const std::vector<Url>& urls, host::system::GLibDispatch& dispatch)
{
    if (command == "mkdir" && urls.size() == 1)
        return report(FileUtils::mkdir(urls[0]));
    if (command == "remove" && urls.size() == 1)
        return report(FileUtils::remove(urls[0]));
    if (command == "trash" && urls.size() == 1)
        return report(TrashUtils::moveToTrash(urls[0]).error);
    if (command == "trashed" && urls.empty())
        return listTrash();
    if (command == "move" && urls.size() == 2)
        return report(FileUtils::moveTo(urls[0], urls[1]));
    if (command == "copy" && urls.size() == 2)
        return report(FileUtils::copyTo(urls[0], urls[1]));
    if (command == "save" && urls.size() == 2)
        return save(urls[0], urls[1]);
    if (command == "add" && urls.size() == 2)
        return add(urls[0], urls[1]);
    if (command == removingLibrary && urls.size() == 1)
        return removeLibrary(urls[0]);
    if (command == "tag" && !urls.empty())
        return tag(urls[0], {urls.begin() + 1, urls.end()});
    if (command == "fetch" && urls.size() == 1)
        return fetch(urls[0], dispatch);
    if (command == "list" && urls.size() == 1)
        return list(urls[0]);
    if (command == "evict" && urls.size() == 1)
        return report(FileUtils::evict(urls[0]));
    if (command == "docid" && urls.size() == 1)
        return printIdentifier(urls[0]);
    return urls.size() == 1 ? runInTrash(command, urls[0].lastPathComponent()) : 2;
}

} // namespace

int main(int argc, char** argv)
{
    host::system::installSystemLog();
    const std::vector<std::string> arguments(argv, argv + argc);
    // The queues are destroyed last, because the services may still post work to them while they are
    // destroyed.
    const auto dispatch = std::make_shared<host::system::GLibDispatch>();
    const auto layout = installDrive(dispatch)->layout();
    const auto top = layout.defaultContainer();
    std::vector<Url> urls;
    for (std::size_t i = 2; i < arguments.size(); ++i)
        urls.push_back(Url::fileURL(arguments[1] == removingLibrary ? layout.containerDocuments(arguments[i])
                                                                    : top + '/' + arguments[i]));
    if (arguments.size() == 2 && arguments[1] == "list")
        urls.push_back(Url::fileURL(top));
    const bool resolves = arguments.size() == 3 && arguments[1] == "resolve";
    // The look-up runs on another thread, because on the main thread the service limits its time.
    const int status = resolves ? std::async(std::launch::async, printLocation, arguments[2]).get()
        : arguments.size() > 1  ? run(arguments[1], urls, *dispatch)
                                : 2;
    if (status == 2)
        std::fputs("usage: tarrow-files list [PATH] | mkdir|remove|evict|fetch|docid|trash PATH | move|copy "
                   "FROM TO | "
                   "save|add PATH FROM | tag PATH [TAG...] | resolve ID | trashed | restore|drop NAME | "
                   "remove-library NAME\n",
            stderr);
    platform::installServices({});
    return status;
}
