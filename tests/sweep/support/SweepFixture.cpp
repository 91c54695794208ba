// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "tests/sweep/support/SweepFixture.h"

#include "host/drive/changes/ContentCollection.h"
#include "host/drive/changes/LocalCloudStore.h"
#include "host/drive/changes/Recovery.h"
#include "host/drive/records/ItemMarks.h"
#include "host/drive/records/PromiseFile.h"
#include "host/drive/trash/LocalTrash.h"
#include "host/system/files/DriveNames.h"

#include <sys/syscall.h>
#include <sys/xattr.h>

#include <algorithm>
#include <cerrno>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <ostream>
#include <set>

namespace sweep_tests {

namespace fs = std::filesystem;

using host::drive::ContentCollection;
using host::drive::PromiseRecord;
using host::drive::TrashRecord;

/// The name in the trash of a folder that was moved there.
constexpr const char* trashedFolder = ".trwtrash-1";
/// An app library, and what lies in its folder.
constexpr const char* library = "BrindleLetters";
/// What stands in the picture of a drive for a tag or an identifier.
constexpr const char* marked = "marked";

/// Names that are too long for the suffix of a promise.
const std::string longDocument = "long/" + std::string(250, 'd'),
                  longPromise = "long/" + std::string(255, 'p');
/// Folders that a person sees as documents.
const std::string package = "inner/here.textbundle", packagePromise = "inner/far.textbundle";

void PrintTo(const Operation& operation, std::ostream* stream)
{
    *stream << operation.name;
}

std::vector<Operation> operations()
{
    return {{"mkdir", {"mkdir", "new/one/two"}}, {"removeFile", {"remove", "inner/file.txt"}},
        {"removeFolder", {"remove", "folder"}}, {"removePromise", {"remove", "inner/p.txt"}},
        {"removeTwin", {"remove", "inner/twin.txt"}},
        {"moveFile", {"move", "inner/file.txt", "target/new.txt"}},
        {"moveFolder", {"move", "folder", "target/new"}},
        {"movePromise", {"move", "inner/p.txt", "target/new.txt"}},
        {"moveFileAcross", {"move", "inner/file.txt", "target/new.txt"}, FileSystems::Several},
        {"moveFolderAcross", {"move", "folder", "target/new"}, FileSystems::Several},
        {"movePromiseAcross", {"move", "inner/p.txt", "target/new.txt"}, FileSystems::Several},
        {"trashFile", {"trash", "inner/file.txt"}}, {"trashFolder", {"trash", "folder"}},
        {"trashPromise", {"trash", "inner/p.txt"}}, {"trashTwin", {"trash", "inner/twin.txt"}},
        {"trashFolderAcross", {"trash", "folder"}, FileSystems::Several},
        {"restore", {"restore", trashedFolder}},
        {"restoreAcross", {"restore", trashedFolder}, FileSystems::Several},
        {"drop", {"drop", trashedFolder}}, {"save", {"save", "inner/file.txt", "folder/a.txt"}},
        {"evict", {"evict", "inner/file.txt"}}, {"fetch", {"fetch", "inner/p.txt"}},
        {"evictPackage", {"evict", package}}, {"fetchPackage", {"fetch", packagePromise}},
        {"tagFile", {"tag", "inner/file.txt", "Red", "Blue"}},
        {"tagPromise", {"tag", "inner/p.txt", "Red", "Blue"}}, {"evictLong", {"evict", longDocument}},
        {"fetchLong", {"fetch", longPromise}}, {"renameLong", {"move", longPromise, longDocument + "x"}},
        {"shortenLong", {"move", longPromise, "inner/new.txt"}},
        {"lengthenPromise", {"move", "inner/p.txt", longDocument + "x"}},
        {"docid", {"docid", "inner/file.txt"}}, {"docidPromise", {"docid", "inner/p.txt"}},
        {"copyFile", {"copy", "inner/file.txt", "target/new.txt"}},
        {"copyPackage", {"copy", package, "target/new.textbundle"}},
        {"copyLink", {"copy", "folder/sub/link", "target/new"}},
        {"add", {"add", "target/new.txt", "folder/a.txt"}}, {"removeLibrary", {"remove-library", library}}};
}

void SweepFixture::makeDrive() const
{
    fs::remove_all(_layout.home());
    for (const auto& folder : {"inner", "folder/sub", "folder/empty", "target", "gone", "long"})
        fs::create_directories(at(folder));
    fs::create_directories(_layout.cloud());
    write(at("inner/file.txt"), std::string(100'000, 'f'));
    ::setxattr(at("inner/file.txt").c_str(), host::drive::itemMark::tags, "Green", 5, 0);
    write(at("folder/a.txt"), "a");
    write(at("folder/sub/b.txt"), "bb");
    fs::create_symlink("../a.txt", at("folder/sub/link"));
    promise("folder/sub/c.pdf", "ccc");
    promise("inner/p.txt", "pppp");
    write(at("inner/twin.txt"), "of the document");
    promise("inner/twin.txt", "that nobody has seen");
    promise("bystander.pdf", "kept");
    writePackage(at(package), "here");
    promisePackage();
    write(at(longDocument), "dddd");
    promise(longPromise, "llll");
    promise("gone/q.pdf", "qqq");
    write(at("gone/q.txt"), "text");
    fs::create_directories(fs::path(libraryDocument()).parent_path());
    write(libraryDocument(), "letter");
    promise(fs::relative(fs::path(libraryDocument()).parent_path() / "l.pdf", at("")), "lll");
    fs::create_directories(_layout.trash() + '/' + trashedFolder);
    const auto place = _layout.trash() + '/' + trashedFolder;
    write(place + '/' + TrashRecord::fileName, TrashRecord{"BrindleDefault/inner/gone", {1}}.text());
    fs::rename(at("gone"), place + "/gone");
}

Ending SweepFixture::run(const FaultFor& faultFor) const
{
    std::vector<std::string> command{TARROW_FILES_COMMAND};
    command.insert(command.end(), GetParam().arguments.begin(), GetParam().arguments.end());
    return runWithFaults(command, _layout.home() + '/', [&](const FileCall& call) {
        const auto fault = faultFor(call);
        return fault.isNone() && isForOtherFileSystem(call) ? Fault{EXDEV} : fault;
    });
}

void SweepFixture::atEachCall(const FaultFor& faultFor,
    const std::function<void(const FileCall& met, const Ending& ending)>& check, const IsPossible& isPossible,
    Turns turns) const
{
    makeDrive();
    for (const int point : points(isPossible, turns)) {
        makeDrive();
        FileCall met;
        const auto ending = run([&](const FileCall& call) {
            if (call.index != point)
                return Fault{};
            met = call;
            return faultFor(call);
        });
        SCOPED_TRACE(
            "at call " + std::to_string(point) + ", " + std::to_string(met.number) + " on " + met.subject);
        check(met, ending);
    }
}

std::vector<int> SweepFixture::points(const IsPossible& isPossible, Turns turns) const
{
    std::vector<FileCall> calls;
    run([&](const FileCall& call) {
        if (isPossible(call))
            calls.push_back(call);
        return Fault{};
    });
    constexpr std::size_t some = 48;
    const bool isShort = turns == Turns::Some && !::getenv("TARROW_LONG_SWEEP");
    const auto step = isShort ? 1 + calls.size() / some : 1;
    std::vector<int> chosen;
    for (std::size_t turn = 0; turn < calls.size(); ++turn) {
        if (turn % step == 0 || (isShort && calls[turn].changesNames()))
            chosen.push_back(calls[turn].index);
    }
    return chosen;
}

void SweepFixture::startAgain() const
{
    constexpr int mostTries = 50;
    host::drive::LocalCloudStore store(_layout);
    host::drive::Recovery(_layout, store).run();
    auto outcome = host::drive::ContentCollection(_layout).run();
    for (int tries = 1; tries < mostTries && outcome && *outcome == ContentCollection::Outcome::Later;
         ++tries) {
        fs::remove(_layout.collection()); // else the next walk waits for as long as the last was slow
        outcome = host::drive::ContentCollection(_layout).run();
    }
    static_cast<void>(host::drive::LocalTrash(_layout, nullptr, nullptr).items());
    EXPECT_TRUE(outcome && *outcome == ContentCollection::Outcome::Done) << outcome.error.number();
}

bool SweepFixture::isRemoval() const
{
    const auto& command = GetParam().arguments[0];
    return command.starts_with("remove") || command == "save" || command == "drop";
}

Drive SweepFixture::seen() const
{
    Drive drive;
    addItems(drive, _layout.documents(), {});
    for (const auto& place : trashPlaces()) {
        const auto record = TrashRecord::parse(read(place + '/' + TrashRecord::fileName));
        addItems(drive, place, "trashed " + (record ? record->origin : "from nowhere") + "/");
    }
    return drive;
}

void SweepFixture::addMarks(
    Drive& drive, const std::string& shown, const std::vector<std::string>& tags, std::uint32_t identifier)
{
    for (const auto& tag : tags)
        drive["tag " + tag + " of " + shown] = marked;
    if (identifier != 0)
        drive["identifier of " + shown] = marked;
}

void SweepFixture::addItems(Drive& drive, const std::string& folder, const std::string& prefix) const
{
    for (auto each = fs::recursive_directory_iterator(folder); each != fs::recursive_directory_iterator();
         ++each) {
        const auto path = each->path().string();
        const auto shown = prefix.empty() ? path : prefix + path.substr(folder.size() + 1);
        if (const auto item = PromiseRecord::itemPathFor(path)) {
            const auto promised = prefix.empty() ? *item : prefix + item->substr(folder.size() + 1);
            addPromised(drive, "promise of " + promised, path);
            const auto record = host::drive::readPromise(path).value.value_or(PromiseRecord());
            addMarks(drive, promised, record.tags, record.documentIdentifier);
        } else if (each->path().filename().string().starts_with(".trw")) {
            each.disable_recursion_pending();
        } else {
            drive[shown] = each->is_symlink() ? "link to " + fs::read_symlink(path).string()
                : each->is_directory()        ? "folder"
                                              : read(path);
            const auto marks = host::drive::ItemMarks::glimpse(host::drive::AttributeReader(path));
            addMarks(drive, shown, marks.tags, marks.documentIdentifier);
        }
    }
}

/// Adds what is behind a promise, a package with everything in it.
void SweepFixture::addPromised(Drive& drive, const std::string& shown, const std::string& promisePath) const
{
    const auto content = contentBehind(promisePath);
    if (!fs::is_directory(content)) {
        drive[shown] = content.empty() ? "nothing" : read(content);
        return;
    }
    drive[shown] = "folder";
    for (const auto& each : fs::recursive_directory_iterator(content)) {
        const auto path = each.path().string();
        if (const auto item = PromiseRecord::itemPathFor(path))
            addPromised(drive, shown + item->substr(content.size()), path);
        else
            drive[shown + path.substr(content.size())] = each.is_symlink()
                ? "link to " + fs::read_symlink(path).string()
                : each.is_directory() ? "folder"
                                      : read(path);
    }
}

std::string SweepFixture::libraryDocument() const
{
    return _layout.containerDocuments(library) + "/letter.txt";
}

std::vector<std::string> SweepFixture::trashPlaces() const
{
    std::vector<std::string> places;
    std::error_code missing;
    for (const auto& place : fs::directory_iterator(_layout.trash(), missing)) {
        if (!host::drive::TrashPlace::isPlace(place.path().filename().string()))
            continue;
        const auto isItem = [](const auto& entry) {
            return !entry.path().filename().string().starts_with(".trw");
        };
        if (std::ranges::any_of(fs::directory_iterator(place), isItem)
            && fs::exists(place.path() / TrashRecord::fileName))
            places.push_back(place.path().string());
    }
    return places;
}

Drive SweepFixture::noticed() const
{
    static constexpr std::string_view promiseMark = "promise of ";
    auto drive = seen();
    const auto all = drive;
    std::erase_if(drive, [&](const auto& item) {
        if (!item.first.starts_with(promiseMark))
            return false;
        const auto document = all.find(item.first.substr(promiseMark.size()));
        return document != all.end() && (document->second == item.second || item.second == "nothing");
    });
    return drive;
}

std::vector<std::string> SweepFixture::leftovers() const
{
    std::vector<std::string> found;
    std::set<std::string> contents, named;
    const auto places = trashPlaces();
    const auto isInTrash = [&](const std::string& path) {
        return std::ranges::any_of(places, [&](const auto& place) {
            const auto rest = path.starts_with(place) ? path.substr(place.size()) : std::string("?");
            return rest.empty() || rest == "/" + std::string(TrashRecord::fileName)
                || (rest.starts_with('/') && !rest.starts_with("/.trw"));
        });
    };
    for (const auto& entry : fs::recursive_directory_iterator(_layout.home())) {
        const auto path = entry.path().string();
        const auto name = entry.path().filename().string();
        if (PromiseRecord::itemPathFor(path))
            named.insert(host::drive::readPromise(path).value.value_or(PromiseRecord()).content);
        if (path.starts_with(_layout.cloud() + '/'))
            contents.insert(*fs::relative(path, _layout.cloud()).begin());
        else if (isInTrash(path))
            continue;
        else if ((name.starts_with(".trw") && !PromiseRecord::itemPathFor(path))
            || path.starts_with(_layout.held() + '/') || path.starts_with(_layout.trash() + '/'))
            found.push_back(path.substr(_layout.home().size() + 1));
    }
    // Contents that no promise names.
    std::ranges::set_difference(contents, named, std::back_inserter(found));
    return found;
}

bool SweepFixture::isAllThere(const Drive& drive) const
{
    std::vector<std::string> contents;
    for (const auto& entry : fs::recursive_directory_iterator(_layout.home())) {
        if (entry.is_regular_file() && !entry.is_symlink())
            contents.push_back(read(entry.path().string()));
    }
    return std::ranges::all_of(drive, [&](const auto& item) {
        return item.second == "folder" || item.second == marked || item.second.starts_with("link to ")
            || std::ranges::find(contents, item.second) != contents.end();
    });
}

bool SweepFixture::isNothingHalf(const Drive& now, const Drive& before)
{
    return std::ranges::all_of(now, [&](const auto& item) {
        return item.second == "folder" || item.second == "nothing" || item.second == marked
            || std::ranges::any_of(before, [&](const auto& old) { return old.second == item.second; });
    });
}

bool SweepFixture::isBeforeOrAfter(const Drive& now, const Drive& before, const Drive& after) const
{
    const bool isOnTheWay = GetParam().arguments[0] == "mkdir" && std::ranges::includes(now, before)
        && std::ranges::includes(after, now);
    return now == before || now == after || isOnTheWay;
}

bool SweepFixture::isBeforeAfterOrBoth(const Drive& now, const Drive& before, const Drive& after) const
{
    auto both = before;
    both.insert(after.begin(), after.end());
    return isBeforeOrAfter(now, before, after)
        || (GetParam().fileSystems == FileSystems::Several && now == both);
}

std::string SweepFixture::differences(const Drive& now, const Drive& before)
{
    std::string text;
    const auto add = [&](const char* what, const Drive& some, const Drive& others) {
        for (const auto& item : some) {
            if (const auto other = others.find(item.first); other == others.end() || *other != item)
                text += what + item.first + ": " + item.second.substr(0, 20);
        }
    };
    add("\n  is now ", now, before);
    add("\n  was ", before, now);
    return text;
}

bool SweepFixture::isForOtherFileSystem(const FileCall& call) const
{
    const auto folderOf = [](const std::string& path) { return path.substr(0, path.rfind('/')); };
    const auto isPrivate = [](const std::string& path) {
        return path.substr(path.rfind('/') + 1).starts_with(".trw");
    };
    return GetParam().fileSystems == FileSystems::Several && call.number == SYS_renameat2
        && folderOf(call.subject) != folderOf(call.newName) && !isPrivate(call.subject)
        && !isPrivate(call.newName);
}

void SweepFixture::write(const std::string& path, const std::string& content)
{
    std::ofstream(path, std::ios::binary) << content;
}

std::string SweepFixture::read(const std::string& path)
{
    std::ifstream file(path, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), {}};
}

void SweepFixture::promise(const std::string& path, const std::string& content) const
{
    PromiseRecord record;
    const auto name = fs::path(path).filename().string();
    record.longName = name.size() > host::system::longestNameInPromise ? name : std::string();
    record.content = "content of " + name.substr(0, 99);
    record.size = content.size();
    record.modified = platform::Date{1'600'000'000'000'000'000};
    write(_layout.cloud() + '/' + record.content, content);
    write(PromiseRecord::pathFor(at(path)), record.toJson());
}

void SweepFixture::writePackage(const std::string& path, const std::string& text)
{
    fs::create_directories(path + "/assets/empty");
    write(path + "/text.md", text);
    write(path + "/assets/" + text, text + ", and more of it");
    fs::create_symlink("../text.md", path + "/assets/link");
}

/// Makes a package in the cloud, a part of which is in the cloud by itself.
void SweepFixture::promisePackage() const
{
    promise(packagePromise, {});
    const auto content = contentBehind(PromiseRecord::pathFor(at(packagePromise)));
    fs::remove(content);
    writePackage(content, "far");
    PromiseRecord record, part;
    record.kind = PromiseRecord::Kind::Package;
    record.content = fs::path(content).filename().string();
    write(PromiseRecord::pathFor(at(packagePromise)), record.toJson());
    part.content = "content of a part";
    write(_layout.cloud() + '/' + part.content, "part");
    write(PromiseRecord::pathFor(content + "/part.txt"), part.toJson());
}

std::string SweepFixture::contentBehind(const std::string& promisePath) const
{
    const auto record = host::drive::readPromise(promisePath);
    for (const auto& folder : {_layout.cloud(), _layout.released()}) {
        const auto content = folder + '/' + (record ? record->content : std::string("damaged"));
        if (fs::exists(content))
            return content;
    }
    return {};
}

} // namespace sweep_tests
