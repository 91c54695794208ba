// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/records/ItemFacts.h"
#include "host/system/files/PosixFileSystem.h"
#include "platform/TypeRegistry.h"
#include "tests/support/DriveFixture.h"

#include <sys/stat.h>
#include <unistd.h>

namespace {

namespace itemMark = host::drive::itemMark;
using host::drive::PromiseRecord;
using namespace platform;
using testing_support::DriveFixture;

class ItemTests : public testing::Test {
protected:
    platform::PromisedItems& items() { return _drive.cloud->promisedItems(); }
    AttributeMap values(const Url& url)
    {
        constexpr AttributeKey keys[] = {AttributeKey::Name, AttributeKey::LocalizedName,
            AttributeKey::TypeIdentifier, AttributeKey::LocalizedTypeDescription, AttributeKey::FileSize,
            AttributeKey::CreationDate, AttributeKey::ContentModificationDate, AttributeKey::IsDirectory,
            AttributeKey::IsRegularFile, AttributeKey::IsPackage, AttributeKey::HasHiddenExtension,
            AttributeKey::ParentDirectoryURL, AttributeKey::IsShared, AttributeKey::SharedItemRole,
            AttributeKey::DownloadingStatus, AttributeKey::DocumentIdentifier};
        const auto result = items().promisedItemResourceValues(url, keys);
        EXPECT_TRUE(result) << url.path();
        return result.value.value_or(AttributeMap());
    }
    std::string text(const Url& url, AttributeKey key)
    {
        return values(url).optional<std::string>(key).value_or("(none)");
    }

    DriveFixture _drive;
};

TEST_F(ItemTests, kindsOfItems)
{
    _drive.makeFolder("Folder.txt");
    _drive.makeFolder("Bundle.RTFD");
    _drive.writeDocument("plain.txt", "12345");
    _drive.writeDocument("no extension");
    _drive.writeDocument("odd.zzzzzz");
    _drive.writeDocument(".hidden");
    _drive.writeLink("link.txt", "plain.txt");
    ASSERT_EQ(::mkfifo(_drive.url("pipe.txt").path().c_str(), 0600), 0);
    _drive.writeDocument(".Promised.trwpromise", R"({"kind": "directory"})");
    _drive.writeDocument(".Promised.rtfd.trwpromise", R"({"kind": "directory"})");
    _drive.writeDocument(".Thing.unheardof.trwpromise", R"({"kind": "package"})");
    const struct {
        const char *name, *type;
        bool isDirectory, isPackage, isFile, hasSize;
    } rows[] = {
        {"Folder.txt", "public.directory", true, false, false, false},
        {"Bundle.RTFD", "public.rtf-directory", true, true, false, false},
        {"plain.txt", "public.plain-text", false, false, true, true},
        {"no extension", "public.data", false, false, true, true},
        {".hidden", "public.data", false, false, true, true},
        {"link.txt", "public.symlink", false, false, false, true},
        {"pipe.txt", "public.data", false, false, false, false},
        {"Promised", "public.directory", true, false, false, false},
        {"Promised.rtfd", "public.rtf-directory", true, true, false, false},
        {"Thing.unheardof", "public.package", true, true, false, false},
    };
    for (const auto& row : rows) {
        const auto found = values(_drive.url(row.name));
        EXPECT_EQ(found.optional<std::string>(AttributeKey::TypeIdentifier), row.type) << row.name;
        EXPECT_EQ(found.flag(AttributeKey::IsDirectory), row.isDirectory) << row.name;
        EXPECT_EQ(found.flag(AttributeKey::IsPackage), row.isPackage) << row.name;
        EXPECT_EQ(found.flag(AttributeKey::IsRegularFile), row.isFile) << row.name;
        EXPECT_EQ(found.has(AttributeKey::FileSize), row.hasSize) << row.name;
        EXPECT_EQ(found.optional<std::string>(AttributeKey::Name), row.name);
        EXPECT_EQ(found.optional<Url>(AttributeKey::ParentDirectoryURL), _drive.url("")) << row.name;
    }
    EXPECT_EQ(text(_drive.url("plain.txt"), AttributeKey::LocalizedTypeDescription),
        platform::services().typeRegistry().description("public.plain-text"));
}

TEST_F(ItemTests, marksOfALocalItem)
{
    const auto url = _drive.writeDocument("Report.final.txt");
    const auto plain = values(url);
    for (const auto key :
        {AttributeKey::DownloadingStatus, AttributeKey::SharedItemRole, AttributeKey::DocumentIdentifier})
        EXPECT_FALSE(plain.has(key)) << static_cast<int>(key);
    EXPECT_FALSE(plain.flag(AttributeKey::IsShared));

    _drive.mark(url, itemMark::status, "current");
    _drive.mark(url, itemMark::shared, "1");
    _drive.mark(url, itemMark::role, "owner");
    _drive.mark(url, itemMark::documentIdentifier, "4294967295");
    _drive.mark(url, host::system::hiddenExtensionAttribute, "1");
    const auto marked = values(url);
    EXPECT_EQ(
        marked.optional<DownloadingStatus>(AttributeKey::DownloadingStatus), DownloadingStatus::Current);
    EXPECT_EQ(marked.optional<platform::SharedItemRole>(AttributeKey::SharedItemRole),
        platform::SharedItemRole::Owner);
    EXPECT_TRUE(marked.flag(AttributeKey::IsShared));
    EXPECT_EQ(marked.optional<std::uint64_t>(AttributeKey::DocumentIdentifier), 4'294'967'295U);
    EXPECT_TRUE(marked.flag(AttributeKey::HasHiddenExtension));
    EXPECT_EQ(marked.optional<std::string>(AttributeKey::LocalizedName), "Report.final");

    for (const char* attribute :
        {itemMark::status, itemMark::shared, itemMark::role, itemMark::documentIdentifier}) {
        for (const std::string& nonsense : {std::string("nonsense"), std::string(), std::string(5000, '9')})
            _drive.mark(url, attribute, nonsense.substr(0, 900));
    }
    const auto damaged = values(url);
    for (const auto key :
        {AttributeKey::DownloadingStatus, AttributeKey::SharedItemRole, AttributeKey::DocumentIdentifier})
        EXPECT_FALSE(damaged.has(key)) << static_cast<int>(key);
}

TEST_F(ItemTests, tagsAreReadInTheirOrder)
{
    const auto url = _drive.writeDocument("a.txt");
    using Tags = std::vector<std::string>;
    EXPECT_EQ(items().readItem(url, {}).tagNames, Tags());
    const std::pair<std::string, Tags> rows[] = {
        {"Work", {"Work"}},
        {"b,a,b", {"b", "a", "b"}},
        {",, two words ,", {" two words "}},
        {"ok,\xff\xfe,مهم", {"ok", "مهم"}},
        {std::string(2000, 'x') + ",end", {std::string(2000, 'x'), "end"}},
        {"", {}},
    };
    for (const auto& [attribute, tags] : rows) {
        _drive.mark(url, itemMark::tags, attribute);
        EXPECT_EQ(items().readItem(url, {}).tagNames, tags) << attribute.substr(0, 40);
    }
    EXPECT_TRUE(items().readItem(_drive.url("gone"), {}).unreachable->is(FileErrorCode::NoSuchItem));
}

TEST_F(ItemTests, namesAreKeptAsBytesAndShownAsText)
{
    const auto broken = _drive.writeDocument("caf\xe9.txt");
    EXPECT_EQ(text(broken, AttributeKey::Name), "caf\xe9.txt");
    EXPECT_EQ(text(broken, AttributeKey::LocalizedName), "caf\xef\xbf\xbd.txt");
    EXPECT_EQ(text(_drive.url("Desktop"), AttributeKey::LocalizedName), "Desktop");
    const auto hidden = _drive.layout().containerDocuments(".x");
    std::filesystem::create_directories(hidden);
    EXPECT_EQ(text(Url::fileURL(hidden), AttributeKey::LocalizedName), "Documents")
        << "no library has this name";
}

TEST_F(ItemTests, missingItemsAndOtherFailures)
{
    _drive.writeDocument("file.txt");
    for (const char* name : {"gone.txt", "gone/deeper.txt", "file.txt/below"}) {
        const auto error = items().checkPromisedItemIsReachable(_drive.url(name));
        EXPECT_TRUE(error && error->is(FileErrorCode::NoSuchItem)) << name;
    }
    const auto loop = _drive.writeLink("loop", "loop");
    const auto error = items().checkPromisedItemIsReachable(loop.appendingPathComponent("x"));
    EXPECT_TRUE(error && error->domain() == platform::errorDomain::system && error->code() == ELOOP);
}

TEST_F(ItemTests, anUnreadableFolderIsNoMissingItem)
{
    const auto inside = _drive.writeDocument("Locked/inside.txt");
    const auto promised = _drive.writePromise("Locked/promised.txt", {});
    std::filesystem::permissions(_drive.folder().path(), std::filesystem::perms::all);
    for (const auto& folder :
        {_drive.layout().home(), _drive.layout().documents(), _drive.layout().defaultContainer()})
        std::filesystem::permissions(folder, std::filesystem::perms::all);
    const auto locked = _drive.url("Locked").path();
    std::filesystem::permissions(locked, std::filesystem::perms::none);
    // Permissions do not stop root, as which many build machines run the tests.
    constexpr uid_t nobody = 65534;
    const bool isRoot = ::geteuid() == 0;
    if (isRoot) {
        ASSERT_EQ(::seteuid(nobody), 0);
    }
    for (const auto& url : {inside, promised}) {
        const auto error = items().checkPromisedItemIsReachable(url);
        EXPECT_TRUE(error && error->domain() == platform::errorDomain::system && error->code() == EACCES)
            << url.path();
        EXPECT_TRUE(items().physicalURLForPromise(url).isSameObject(url));
    }
    EXPECT_FALSE(items().checkPromisedItemIsReachable(_drive.url("Locked")));
    if (isRoot) {
        ASSERT_EQ(::seteuid(0), 0);
    }
    std::filesystem::permissions(locked, std::filesystem::perms::all);
}

TEST_F(ItemTests, aPromiseIsDescribedWithoutItsContent)
{
    PromiseRecord record;
    record.size = 12'345;
    record.created = Date{1'600'000'000'123'456'789};
    record.modified = Date{1'650'000'000'000'000'001};
    record.type = "public.pdf";
    record.shared = true;
    record.role = SharedItemRole::Participant;
    record.extensionHidden = true;
    record.documentIdentifier = 4'000'000'000;
    record.tags = {"Two words", "späte \"Arbeit\" \\ \n", "مهم", "🎂"};
    const auto url = _drive.writePromise("Plan.pdf", record);
    EXPECT_FALSE(items().checkPromisedItemIsReachable(url));
    const auto found = values(url);
    EXPECT_EQ(found.optional<std::string>(AttributeKey::Name), "Plan.pdf");
    EXPECT_EQ(found.optional<std::string>(AttributeKey::LocalizedName), "Plan") << "its extension is hidden";
    EXPECT_EQ(found.optional<std::string>(AttributeKey::TypeIdentifier), "public.pdf");
    EXPECT_EQ(found.optional<std::uint64_t>(AttributeKey::FileSize), record.size);
    EXPECT_EQ(found.optional<Date>(AttributeKey::CreationDate), record.created);
    EXPECT_EQ(found.optional<Date>(AttributeKey::ContentModificationDate), record.modified);
    EXPECT_EQ(
        found.optional<DownloadingStatus>(AttributeKey::DownloadingStatus), DownloadingStatus::NotDownloaded);
    EXPECT_EQ(found.optional<SharedItemRole>(AttributeKey::SharedItemRole), record.role);
    EXPECT_TRUE(found.flag(AttributeKey::IsShared));
    EXPECT_EQ(found.optional<std::uint64_t>(AttributeKey::DocumentIdentifier), record.documentIdentifier);
    EXPECT_EQ(items().readItem(url, {}).tagNames, record.tags);
    constexpr AttributeKey name[] = {AttributeKey::Name};
    EXPECT_TRUE(items().resourceValues(url, name).error->is(FileErrorCode::NoSuchItem));
}

TEST_F(ItemTests, physicalAndLogicalLocations)
{
    const auto promised = _drive.writePromise("Notes/Plan.pdf", {});
    const auto physical = items().physicalURLForPromise(promised);
    EXPECT_EQ(physical, _drive.url("Notes/.Plan.pdf.trwpromise"));
    EXPECT_TRUE(items().isItemPromise(physical));
    EXPECT_EQ(items().logicalURLForPromise(physical), promised);

    const auto here = _drive.writeDocument("here.txt");
    const auto nothing = _drive.url("nothing.txt");
    for (const auto& url : {here, nothing}) {
        EXPECT_TRUE(items().physicalURLForPromise(url).isSameObject(url)) << url.path();
        EXPECT_FALSE(items().isItemPromise(url)) << url.path();
        EXPECT_TRUE(items().logicalURLForPromise(url).isSameObject(url)) << url.path();
    }
    for (const char* name : {".trwpromise", "..trwpromise", "Plan.pdf.trwpromise", ".gone.trwpromise"})
        EXPECT_FALSE(items().isItemPromise(_drive.url(name))) << name;
}

TEST_F(ItemTests, theRealItemCountsWhereBothExist)
{
    _drive.writeDocument(".Plan.pdf.trwpromise", R"({"size": 12345, "tags": ["Red"]})");
    const auto url = _drive.writeDocument("Plan.pdf", "real");
    EXPECT_TRUE(items().physicalURLForPromise(url).isSameObject(url));
    const auto found = values(url);
    EXPECT_EQ(found.optional<std::uint64_t>(AttributeKey::FileSize), 4U);
    EXPECT_FALSE(found.has(AttributeKey::DownloadingStatus));
    EXPECT_TRUE(items().readItem(url, {}).tagNames.empty());

    // A broken link is an item as well.
    const auto link = _drive.writePromise("Link.pdf", {});
    _drive.writeLink("Link.pdf", "nowhere");
    EXPECT_EQ(text(link, AttributeKey::TypeIdentifier), "public.symlink");
}

TEST_F(ItemTests, aNameTooLongForAPromiseIsSimplyMissing)
{
    const auto url = _drive.url(std::string(250, 'n'));
    EXPECT_TRUE(items().checkPromisedItemIsReachable(url)->is(FileErrorCode::NoSuchItem));
    EXPECT_TRUE(items().physicalURLForPromise(url).isSameObject(url));
    EXPECT_TRUE(_drive.log->lines().empty());
}

TEST_F(ItemTests, referencesStandForDocumentsOfContainers)
{
    const auto documents = _drive.makeContainer("app.notes");
    const auto reference = _drive.writeReference("Trip.trwref", "app.notes", "Travel/Trip.md");
    EXPECT_TRUE(items().isExternalDocumentReference(reference));
    EXPECT_EQ(items().resolveExternalDocumentReference(reference).value,
        documents.appendingPathComponent("Travel").appendingPathComponent("Trip.md"))
        << "the document need not be there";
    const auto ownReference = _drive.writeReference("Own.trwref", "BrindleDefault", "Documents/a.txt");
    EXPECT_EQ(items().resolveExternalDocumentReference(ownReference).value, _drive.url("Documents/a.txt"));

    _drive.writeReference("plain.txt", "app.notes", "Trip.md");
    EXPECT_FALSE(items().isExternalDocumentReference(_drive.url("plain.txt")));
    EXPECT_TRUE(items().resolveExternalDocumentReference(_drive.url("plain.txt")).error);
    const std::pair<std::string, std::string> escapes[] = {{"..", "a"}, {".", "a"}, {"", "a"}, {"app/x", "a"},
        {"app.notes", "../a"}, {"app.notes", "a/../../b"}, {"app.notes", "/etc/passwd"}, {"app.notes", ""},
        {"app.notes", "a//b"}, {"app.notes", std::string("a\0b", 3)}, {"app.notes", std::string(5000, 'a')}};
    for (const auto& [container, path] : escapes) {
        const auto url = _drive.writeReference("Bad.trwref", container, path);
        EXPECT_FALSE(items().isExternalDocumentReference(url)) << container << ' ' << path;
        EXPECT_TRUE(items().resolveExternalDocumentReference(url).error) << container << ' ' << path;
    }
    for (const char* content : {"", "{", "[]", "{}", R"({"container": 1, "path": "a"})"}) {
        _drive.writeDocument("Bad.trwref", content);
        EXPECT_FALSE(items().isExternalDocumentReference(_drive.url("Bad.trwref"))) << content;
    }
    EXPECT_FALSE(items().isExternalDocumentReference(_drive.url("Gone.trwref")));
}

TEST_F(ItemTests, noPromiseStandsForTheFolderThatItLiesIn)
{
    for (const char* name : {"Documents/...trwpromise", "Documents/....trwpromise"}) {
        const auto url = _drive.writeDocument(name, host::drive::PromiseRecord{}.toJson());
        EXPECT_FALSE(items().isItemPromise(url)) << name;
        EXPECT_EQ(items().logicalURLForPromise(url), url);
    }
}

TEST_F(ItemTests, aliasesLeadToItemsThatAreThere)
{
    const auto document = _drive.writeDocument("Documents/a.txt");
    const auto promised = _drive.writePromise("Documents/b.txt", {});
    const auto alias = _drive.writeAlias("A.trwalias", "BrindleDefault/Documents/a.txt");
    EXPECT_EQ(items().resolveAliasFile(alias).value, document);
    EXPECT_EQ(text(alias, AttributeKey::LocalizedTypeDescription), "Alias");
    EXPECT_EQ(platform::services()
                  .typeRegistry()
                  .description(text(alias, AttributeKey::TypeIdentifier))
                  .value_or("Alias"),
        "Alias")
        << "the registry must not rename what aliases are told by";
    EXPECT_EQ(items().resolveAliasFile(_drive.writeAlias("A.trwalias", promised.path())).value, promised);

    EXPECT_TRUE(items()
                    .resolveAliasFile(_drive.writeAlias("A.trwalias", "BrindleDefault/gone"))
                    .error->is(FileErrorCode::NoSuchItem));
    for (const char* target : {"../../outside", "", ".", "/etc/../etc/passwd"})
        EXPECT_TRUE(items().resolveAliasFile(_drive.writeAlias("A.trwalias", target)).error) << target;
    EXPECT_TRUE(items().resolveAliasFile(_drive.writeDocument("A.trwalias", std::string(70'000, ' '))).error);
    EXPECT_TRUE(items().resolveAliasFile(_drive.url("gone.trwalias")).error->is(FileErrorCode::NoSuchItem));
}

} // namespace
