// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/desktop/GioAppRegistry.h"

#include "host/system/desktop/MimeTypeRegistry.h"
#include "tests/support/TemporaryDirectory.h"

#include <gmock/gmock.h>
#include <sys/stat.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <memory>

namespace {

using host::system::GioAppRegistry;
using platform::Url;
using testing::ElementsAre;
using testing::IsEmpty;
using testing_support::TemporaryDirectory;

/// A desktop with a few apps. The library reads their descriptions once for a process, so they are written
/// before anything else.
class Desktop : public testing::Environment {
public:
    void SetUp() override
    {
        folder = std::make_unique<TemporaryDirectory>();
        std::filesystem::create_directory_symlink("/usr/share/mime", folder->at("mime"));
        for (const auto& [variable, place] : {std::pair("XDG_DATA_DIRS", "."), {"XDG_DATA_HOME", "home"},
                 {"XDG_CONFIG_HOME", "config"}, {"XDG_CONFIG_DIRS", "none"}})
            setenv(variable, folder->at(place).c_str(), 1);
        unsetenv("XDG_CURRENT_DESKTOP");
        // The app writes its arguments into a pipe, which waits for both ends.
        folder->write("open", "#!/bin/sh\nprintf '%s\\n' \"$#\" \"$1\" > " + answer() + "\n");
        chmod(folder->at("open").c_str(), 0700);
        mkfifo(answer().c_str(), 0600);
        const auto open = folder->at("open");
        describe("org.example.Editor", open + " %f", "Comment=Edits texts");
        describe("org.example.Viewer", open + " %u");
        describe("org.example.Console", open + " %F", "Terminal=true");
        describe("org.example.Importer", open);
        describe("org.example.Packer", open + " %F", "X-Tarrow-OwnedTypes=image/png;application/zip;");
        describe("org.example.Broken", open + "-not-there %f");
        folder->write("applications/mimeinfo.cache",
            "[MIME Cache]\n"
            "text/plain=org.example.Editor.desktop;org.example.Viewer.desktop;\n"
            "text/x-csrc=org.example.Console.desktop;\n"
            "application/zip=org.example.Importer.desktop;org.example.Packer.desktop;\n"
            "inode/directory=org.example.Editor.desktop;\n");
        folder->write(
            "config/mimeapps.list", "[Default Applications]\ntext/plain=org.example.Viewer.desktop;\n");
    }
    void TearDown() override { folder = nullptr; }

    std::string answer() const { return folder->at("answer"); }
    std::unique_ptr<TemporaryDirectory> folder;

private:
    void describe(const std::string& identifier, const std::string& command, const std::string& more = {})
    {
        folder->write("applications/" + identifier + ".desktop",
            "[Desktop Entry]\nType=Application\nName=" + identifier + "\nExec=" + command + '\n' + more
                + '\n');
    }
};

auto* const desktop = dynamic_cast<Desktop*>(testing::AddGlobalTestEnvironment(new Desktop));

class GioAppRegistryTest : public testing::Test {
protected:
    /// Answers the apps of a document by their ranks, as "Rank: app app+", with a plus for apps that open in
    /// place.
    std::vector<std::string> ranked(const std::string& name) const
    {
        std::vector<std::string> lines;
        for (const auto& [rank, apps] : registry.availableApps({Url::fileURL("/drive/" + name)})) {
            lines.push_back(rank + ':');
            for (const auto& app : apps)
                lines.back() += ' ' + app.bundleIdentifier.substr(12) + (app.supportsOpenInPlace ? "+" : "");
        }
        return lines;
    }
    static std::vector<std::string> answered()
    {
        std::ifstream answer(desktop->answer());
        std::vector<std::string> lines;
        for (std::string line; std::getline(answer, line);)
            lines.push_back(line);
        return lines;
    }

    GioAppRegistry registry{std::make_shared<host::system::MimeTypeRegistry>(), "app.tarrow.Drive"};
};

TEST_F(GioAppRegistryTest, RanksTheAppsOfADocument)
{
    EXPECT_THAT(ranked("a.txt"), ElementsAre("Owner: Viewer+", "Alternate: Editor+"));
    EXPECT_THAT(ranked("a.zip"), ElementsAre("Owner: Importer Packer+"));
    EXPECT_THAT(ranked("a.c"), ElementsAre("Owner: Console", testing::StartsWith("Alternate: ")))
        << "who only opens texts in general does not own a program's";
    for (const auto* name : {"a.png", "a", "a.unheard-of", "a.textbundle", "a.rtfd"})
        EXPECT_THAT(ranked(name), IsEmpty()) << name;
}

TEST_F(GioAppRegistryTest, TellsWhatAnAppSaysOfItself)
{
    const auto app = registry.appWithBundleIdentifier("org.example.Editor");
    ASSERT_TRUE(app);
    EXPECT_EQ(app->localizedName, "org.example.Editor");
    EXPECT_EQ(app->description, "Edits texts");
    EXPECT_EQ(app->executableName, desktop->folder->at("open"));
    for (const auto* identifier : {"org.example.Nobody", "", "../applications/org.example.Editor"})
        EXPECT_FALSE(registry.appWithBundleIdentifier(identifier)) << identifier;
}

TEST_F(GioAppRegistryTest, HandsOverTheDocumentItself)
{
    const auto path = desktop->folder->write("a b'$x.txt", "1");
    const auto open = [&](const std::string& identifier, const Url& document) {
        platform::AppHandle app;
        app.bundleIdentifier = identifier;
        return registry.openInPlace(document, app);
    };
    for (const auto* app : {"org.example.Editor", "org.example.Viewer", "org.example.Packer"}) {
        ASSERT_TRUE(open(app, Url::fileURL(path))) << app;
        EXPECT_THAT(answered(), ElementsAre("1", path)) << app;
    }

    EXPECT_FALSE(open("org.example.Nobody", Url::fileURL(path)));
    EXPECT_FALSE(open("org.example.Broken", Url::fileURL(path)));
}

} // namespace
