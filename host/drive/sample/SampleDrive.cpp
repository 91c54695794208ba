// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/drive/sample/SampleDrive.h"

#include "host/drive/records/AccountRecord.h"
#include "host/drive/records/ContainerRecord.h"
#include "host/drive/records/LinkRecords.h"
#include "host/drive/sample/SamplePictures.h"
#include "host/drive/sample/SampleTexts.h"
#include "host/drive/sample/SampleWriter.h"

#include <gio/gio.h>
#include <nlohmann/json.hpp>

#include <cstdio>
#include <memory>
#include <mutex>

extern "C" void trw_sample_register_resource();

namespace host::drive::sample {

namespace {

using platform::SharedItemRole;

constexpr const char* notebook = "app.tarrow.Notebook";
constexpr const char* sketchbook = "app.tarrow.Sketchbook";
constexpr const char* recorder = "app.tarrow.Recorder";

// The tags, and their colours in the shared table: 1 grey, 2 green, 3 purple, 4 blue, 5 yellow, 6 red, 7
// orange.
constexpr std::pair<const char*, int> tagTable[] = {{"Important", 6}, {"Travel", 7}, {"Ideas", 5},
    {"Home", 2}, {"University", 4}, {"Family", 3}, {"Archive", 1}, {"Someday", 0}};

SampleWriter::Content text(const char* content)
{
    return [content] { return std::string(content); };
}

/// Answers a file of data/sample, which the program contains as a resource.
SampleWriter::Content file(const char* name)
{
    return [path = std::string("/app/tarrow/Drive/sample/") + name] {
        static std::once_flag once;
        std::call_once(once, trw_sample_register_resource);
        const std::unique_ptr<GBytes, decltype(&g_bytes_unref)> bytes(
            g_resources_lookup_data(path.c_str(), G_RESOURCE_LOOKUP_FLAGS_NONE, nullptr), g_bytes_unref);
        gsize size = 0;
        const auto* data = static_cast<const char*>(g_bytes_get_data(bytes.get(), &size));
        return std::string(data, size);
    };
}

Traits dated(int daysAgo, std::vector<std::string> tags = {})
{
    return {daysAgo, std::move(tags), {}, false};
}

Traits shared(int daysAgo, SharedItemRole role)
{
    return {daysAgo, {}, role, false};
}

std::string numbered(const char* format, int number)
{
    char name[128];
    std::snprintf(name, sizeof name, format, number);
    return name;
}

/// Writes items below one folder.
class Folder {
public:
    Folder(SampleWriter& writer, std::string path)
        : _writer(writer)
        , _path(std::move(path))
    {
    }

    Folder in(const std::string& name) const { return {_writer, at(name)}; }
    std::string at(const std::string& name) const { return _path + '/' + name; }

    void add(const std::string& name, const SampleWriter::Content& content, const Traits& traits = {}) const
    {
        _writer.document(at(name), content, traits);
    }
    void promise(
        const std::string& name, const SampleWriter::Content& content, const Traits& traits = {}) const
    {
        _writer.promised(at(name), content, traits);
    }
    void link(const std::string& name, const std::string& target) const { _writer.link(at(name), target); }
    void make(const std::string& name, const Traits& traits = {}) const { _writer.folder(at(name), traits); }

private:
    SampleWriter& _writer;
    std::string _path;
};

std::string account()
{
    AccountRecord record{localIdentity("Mira Keller"), "Mira Keller", {}};
    record.storageOffer = platform::StorageOffer{1, false, "Get More Storage",
        {platform::StorageOfferLink::actionUpgradeInApplication, "https://drive.example/storage"}};
    return record.toJson();
}

std::string keyValues()
{
    auto tags = nlohmann::json::array();
    for (const auto& [name, colour] : tagTable)
        tags.push_back({{"n", name}, {"l", colour}});
    const nlohmann::json table{{"PathwellTagDict", {{"PathwellTagDictVersion", 2}, {"PathwellTags", tags}}}};
    return table.dump(2) + '\n';
}

ContainerRecord library(const char* english, const char* german, const char* arabic,
    std::vector<std::optional<std::string>> types, std::string_view levels, const char* icon)
{
    ContainerRecord record;
    record.names = {{"en", english}, {"de", german}, {"ar", arabic}};
    record.documentTypes = {{english, std::move(types)}};
    record.supportedFolderLevels = std::string(levels);
    record.iconName = icon;
    return record;
}

void describeContainers(SampleWriter& writer, const DriveLayout& layout)
{
    const auto describe = [&](const char* identifier, ContainerRecord record, const char* app) {
        if (app)
            record.owningApps = {app};
        writer.record(layout.containerDescription(identifier), record.toJson());
    };
    namespace levels = platform::folderLevels;
    ContainerRecord drive;
    drive.names = {{"en", "Tarrow Drive"}};
    drive.iconName = "folder-remote";
    describe(std::string(DriveLayout::defaultContainerIdentifier).c_str(), drive, nullptr);
    describe(notebook,
        library("Notebook", "Notizbuch", "دفتر الملاحظات", {"public.text"}, levels::any,
            "accessories-text-editor"),
        "org.gnome.TextEditor");
    describe(sketchbook,
        library("Sketchbook", "Skizzenbuch", "دفتر الرسم", {"public.image"}, levels::one,
            "applications-graphics"),
        "org.inkscape.Inkscape");
    describe(recorder,
        library("Recorder", "Rekorder", "المسجل", {"public.audio", "public.movie"}, levels::none,
            "audio-x-generic"),
        "org.gnome.SoundRecorder");
}

void fillDesktop(const Folder& desktop)
{
    desktop.add("To do.txt", text(texts::toDo), dated(0, {"Important"}));
    desktop.add("Packing list.md", text(texts::packingList), dated(2, {"Travel"}));
    desktop.add(
        "Screenshot.png", [] { return windowShotPng(); }, dated(1));
    desktop.add("🎉 Birthdays 🎂.md", text(texts::birthdayList), dated(20, {"Family", "Important"}));
    desktop.add(
        "Recipes.trwalias", [] { return aliasJson("BrindleDefault/Documents/Household/Recipes"); },
        dated(40));
    desktop.add(
        "Trip itinerary.trwref", [] { return referenceJson(notebook, "Travel/Tuscany.md"); }, dated(6));
    desktop.link("Thesis", "../Documents/University/Thesis");
    desktop.link("System pictures", "/usr/share/icons");
}

void fillUniversity(const Folder& university)
{
    const auto thesis = university.in("Thesis");
    thesis.add("Thesis draft.md", text(texts::thesis), dated(1, {"University", "Important"}));
    thesis.add("References.bib", text(texts::references), dated(9, {"University"}));
    thesis.add(
        "Figures/Figure 1.svg", [] { return chartSvg(); }, dated(12));
    thesis.add(
        "Figures/Figure 2.png", [] { return windowShotPng(); }, dated(11));
    thesis.promise("Thesis draft (printed).pdf", file("thesis-draft.pdf"), dated(5, {"University"}));
    const auto algorithms = university.in("Algorithms");
    algorithms.add("quicksort.cpp", text(texts::quicksort), dated(60));
    algorithms.add("tram_map.py", text(texts::graphSearch), dated(52));
    algorithms.add("balcony.json", text(texts::sensorData), dated(50, {"Ideas"}));
    algorithms.add("garden.html", text(texts::htmlPage), dated(48));
    const auto algebra = university.in("Linear Algebra");
    for (int i = 1; i <= 8; ++i) {
        const auto name = numbered("Lecture %d.md", i);
        if (i <= 3)
            algebra.add(
                name, [i] { return texts::lecture(i); }, dated(120 - 7 * i, {"University"}));
        else
            algebra.promise(
                name, [i] { return texts::lecture(i); }, dated(120 - 7 * i, {"University"}));
    }
    university.add("Seminar timetable.pdf", file("seminar-timetable.pdf"), dated(80, {"University"}));
}

void fillHousehold(const Folder& household)
{
    const auto recipes = household.in("Recipes");
    recipes.add("Lemon cake.md", text(texts::lemonCake), dated(90, {"Home"}));
    recipes.add("Shakshuka.md", text(texts::shakshuka), dated(70, {"Home"}));
    recipes.add("Grandma's plum dumplings.txt", text(texts::plumDumplings), dated(300, {"Family", "Home"}));
    recipes.promise("Quick miso ramen.md", text(texts::ramen), dated(33, {"Home"}));
    household.add("Insurance.pdf", file("insurance.pdf"), dated(400, {"Home", "Archive"}));
    household.promise("Rent contract.pdf", file("rent-contract.pdf"), dated(800, {"Home", "Important"}));
    household.add("Flat share budget.csv", text(texts::flatBudget), shared(4, SharedItemRole::Owner));
    for (int i = 1; i <= largeFolderCount; ++i)
        household.in("Receipts")
            .add(
                numbered("Receipt %04d.txt", i), [i] { return texts::receipt(i); }, dated(i));
}

void fillDocuments(SampleWriter& writer, const Folder& documents)
{
    fillUniversity(documents.in("University"));
    fillHousehold(documents.in("Household"));
    const auto tickets = documents.in("Tickets");
    tickets.add("Night train Berlin – Florence.pdf", file("night-train.pdf"), dated(8, {"Travel"}));
    tickets.promise("Open-air concert.pdf", file("open-air-concert.pdf"), dated(21));
    documents.promise(
        "Climbing weekend.md", text(texts::climbingPlan), shared(3, SharedItemRole::Participant));
    documents.add("Reading notes.md", text(texts::readingNotes), Traits{14, {"Ideas", "Someday"}, {}, true});
    const auto letters = documents.in("Letters");
    letters.add("رسالة إلى جدتي.txt", text(texts::arabicLetter), dated(16, {"Family"}));
    letters.add("مواعيد العائلة.txt", text(texts::arabicDates), dated(10, {"Family"}));
    letters.add("רשימת קניות.txt", text(texts::hebrewNotes), dated(25));
    letters.add("旅行メモ.txt", text(texts::japaneseNotes), dated(31, {"Travel"}));
    letters.add(
        "Notes about everything that still has to be arranged with the landlord before the balcony, the "
        "cellar and the old bicycle shed are painted, and about who keeps which of the three keys while we "
        "are away in the summer.txt",
        text(texts::toDo), dated(45));
    documents.make("Ideas for later", dated(100, {"Someday"}));
    documents.add("Travel diary.textbundle/text.md", text(texts::diary), dated(28));
    documents.add("Travel diary.textbundle/info.json",
        text("{ \"version\": 2, \"type\": \"public.plain-text\", \"transient\": false }\n"), dated(28));
    documents.add(
        "Travel diary.textbundle/assets/arrival.jpg", [] { return landscapeJpeg(4); }, dated(28));
    writer.lockedFolder(lockedFolder);
}

void fillPhotos(const Folder& photos)
{
    static constexpr const char* summer[] = {
        "Arrival", "White road", "Evening on the hill", "Cypresses", "Hot springs", "Last morning"};
    for (int i = 0; i < 6; ++i) {
        const auto name = numbered("%02d ", i + 1) + summer[i] + ".jpg";
        photos.in("Summer in Tuscany 🌻")
            .add(
                name, [i] { return landscapeJpeg(i); }, dated(60 - i, {"Travel"}));
    }
    static constexpr const char* winter[] = {"Snowed in", "The frozen lake", "Stars over the hut"};
    for (int i = 0; i < 3; ++i) {
        const auto name = std::string(winter[i]) + ".jpg";
        const auto picture = [i] { return landscapeJpeg(i == 2 ? 5 : 3 + 6 * (i + 1)); };
        if (i == 0)
            photos.in("Winter hike").add(name, picture, dated(250 - i));
        else
            photos.in("Winter hike").promise(name, picture, dated(250 - i));
    }
    photos.add(
        "Biscuit the cat.png", [] { return portraitPng(0); }, dated(18, {"Family"}));
    photos.promise(
        "Shadow the cat.png", [] { return portraitPng(1); }, dated(17, {"Family"}));
    photos.add("Sunrise.avi", file("sunrise.avi"), dated(59, {"Travel"}));
}

void fillLibraries(SampleWriter& writer)
{
    const Folder notes(writer, std::string(notebook) + "/Documents");
    notes.add("Travel/Tuscany.md", text(texts::tripItinerary), dated(6, {"Travel"}));
    notes.add("Ideas.md", text(texts::readingNotes), dated(13, {"Ideas"}));
    const Folder sketches(writer, std::string(sketchbook) + "/Documents");
    for (int i = 0; i < 3; ++i)
        sketches.add(
            numbered("Pattern %d.svg", i + 1), [i] { return sketchSvg(i); }, dated(35 + i, {"Ideas"}));
    sketches.add(
        "Garden/Cat study.png", [] { return portraitPng(2); }, dated(41));
    const Folder recordings(writer, std::string(recorder) + "/Documents");
    recordings.add("Morning melody.wav", file("morning-melody.wav"), dated(22));
    recordings.promise("Rainy evening.wav", file("rainy-evening.wav"), dated(23, {"Ideas"}));
}

} // namespace

Outcome makeSampleDrive(const DriveLayout& wanted)
{
    const auto layout = wanted.prepare();
    SampleWriter writer(layout);
    const Folder drive(writer, std::string(DriveLayout::defaultContainerIdentifier));
    describeContainers(writer, layout);
    fillDesktop(drive.in("Desktop"));
    fillDocuments(writer, drive.in("Documents"));
    fillPhotos(drive.in("Photos"));
    fillLibraries(writer);
    writer.record(layout.keyValueStore(), keyValues());
    // The account is written last, so that nobody is signed in to a drive that is half made.
    writer.record(layout.account(), account());
    return {writer.written(), writer.error()};
}

} // namespace host::drive::sample
