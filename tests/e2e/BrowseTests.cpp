#include "Accessible.h"

#include <gmock/gmock.h>

#include <cstdlib>
#include <fcntl.h>
#include <filesystem>
#include <fstream>
#include <map>
#include <regex>
#include <signal.h>
#include <spawn.h>
#include <sys/wait.h>

namespace {

using e2e::Accessible;

/// The real program on the sample drive, driven through its accessibility tree.
class BrowseTests : public ::testing::Test {
protected:
    void SetUp() override
    {
        ASSERT_LE(atspi_init(), 1); // 1: a test before this one did it
        // The first look starts the registry; a program that comes before it may stay unseen.
        atspi_accessible_get_child_count(atspi_get_desktop(0), nullptr);
        start();
        ASSERT_TRUE(
            Accessible::waitFor([this] { return bool(program = Accessible::application("tarrow-drive")); }));
    }

    void TearDown() override
    {
        if (process > 0)
            stop();
        std::ifstream errors(getenv("TRW_ERRORS"));
        const std::regex complaint(
            "(Gtk|Gdk|Gsk|Adwaita|GLib|GLib-GObject|GLib-GIO|Pango)-(WARNING|CRITICAL|ERROR)");
        for (std::string line; std::getline(errors, line);)
            EXPECT_FALSE(std::regex_search(line, complaint)) << line;
    }

    void start()
    {
        const char* path = getenv("TRW_PROGRAM");
        posix_spawn_file_actions_t actions;
        posix_spawn_file_actions_init(&actions);
        posix_spawn_file_actions_addopen(
            &actions, 2, getenv("TRW_ERRORS"), O_WRONLY | O_CREAT | O_TRUNC, 0600);
        char* const arguments[] = {const_cast<char*>(path), nullptr};
        EXPECT_EQ(posix_spawn(&process, path, &actions, nullptr, arguments, environ), 0);
        posix_spawn_file_actions_destroy(&actions);
    }

    /// Asks the program to end, and expects that it does so in order.
    void stop()
    {
        kill(process, SIGTERM);
        int status = 0;
        EXPECT_TRUE(Accessible::waitFor([&] { return waitpid(process, &status, WNOHANG) == process; }));
        EXPECT_TRUE(WIFEXITED(status) && WEXITSTATUS(status) == 0) << status;
        process = -1;
    }

    std::vector<Accessible> buttons(const std::string& beginning) const
    {
        return program.all([&](const Accessible& node) {
            return node.isButton() && node.name().compare(0, beginning.size(), beginning) == 0;
        });
    }
    bool shows(const std::string& beginning) const { return !buttons(beginning).empty(); }
    /// Presses the frontmost button whose name begins so.
    void press(const std::string& beginning)
    {
        ASSERT_TRUE(Accessible::waitFor([&] { return shows(beginning); })) << beginning;
        ASSERT_TRUE(buttons(beginning).back().press()) << beginning;
    }

    Accessible program;
    pid_t process = -1;
};

TEST_F(BrowseTests, TwoFoldersInAndBack)
{
    press("Notebook");
    EXPECT_TRUE(Accessible::waitFor([this] { return shows("Ideas.md"); }));
    press("Travel");
    // The list of the second folder has its own back button in front of the first one's.
    EXPECT_TRUE(Accessible::waitFor([this] { return buttons("Back").size() == 2; }));
    press("Back");
    EXPECT_TRUE(Accessible::waitFor([this] { return buttons("Back").size() == 1; }));
    EXPECT_TRUE(shows("Ideas.md"));
    press("Back");
    EXPECT_TRUE(Accessible::waitFor([this] { return !shows("Ideas.md"); }));
    EXPECT_TRUE(shows("Photos"));
}

TEST_F(BrowseTests, ANewFolderIsMadeOnceItsNameIsAccepted)
{
    const auto find = [this](auto matches) { return program.all(matches); };
    const auto entries = [&] { return find([](const Accessible& node) { return node.isEntry(); }); };
    const auto says = [&](const char* text) {
        return !find([&](const Accessible& node) { return node.name() == text; }).empty();
    };
    press("Photos");
    EXPECT_TRUE(Accessible::waitFor([&] { return shows("Summer in Tuscany"); }));
    // A press that meets the bar while it still slides in is lost with the button, so it is made again.
    int looks = 0;
    EXPECT_TRUE(Accessible::waitFor([&] {
        if (shows("New Folder"))
            return true;
        if (looks++ % 20 == 0)
            press("Select");
        return false;
    }));
    press("New Folder");
    ASSERT_TRUE(Accessible::waitFor([&] { return !entries().empty(); }));
    EXPECT_EQ(entries().back().name(), "Folder Name");
    const auto dialogs = find([](const Accessible& node) { return node.isDialog(); });
    ASSERT_EQ(dialogs.size(), 1);
    EXPECT_EQ(dialogs.front().name(), "New Folder");

    EXPECT_TRUE(entries().back().enter("a/b"));
    EXPECT_TRUE(Accessible::waitFor([&] { return says("Character not allowed in filename"); }));
    EXPECT_TRUE(entries().back().enter("Old pictures"));
    EXPECT_TRUE(Accessible::waitFor([&] { return !says("Character not allowed in filename"); }));
    press("Create");
    EXPECT_TRUE(Accessible::waitFor([&] { return shows("Old pictures"); }));
    EXPECT_TRUE(Accessible::waitFor([&] { return entries().empty(); }));
}

/// The activities that devices publish on this drive, by the names of their files.
std::map<std::string, std::string> activities()
{
    std::map<std::string, std::string> found;
    std::error_code problem;
    const auto folder = std::filesystem::path(getenv("TARROW_DRIVE_HOME")) / "activities";
    for (const auto& entry : std::filesystem::directory_iterator(folder, problem)) {
        std::ifstream file(entry.path());
        if (entry.path().extension() == ".json")
            found[entry.path().stem()] = std::string(std::istreambuf_iterator<char>(file), {});
    }
    return found;
}

TEST_F(BrowseTests, ADocumentIsHandedOverAndTakenFromAnotherDevice)
{
    press("Notebook");
    press("Ideas.md");
    ASSERT_TRUE(Accessible::waitFor([] { return activities().size() == 1; }));
    const auto [device, activity] = *activities().begin();
    press("Back");
    EXPECT_TRUE(Accessible::waitFor([] { return activities().empty(); })) << "taken back with its screen";

    // Another device shows the same document.
    const auto folder = std::string(getenv("TARROW_DRIVE_HOME")) + "/activities/";
    auto other = activity;
    other.replace(other.find(device), device.size(), "phone");
    std::ofstream(folder + ".phone") << other;
    std::filesystem::rename(folder + ".phone", folder + "phone.json");
    press("Continue");
    EXPECT_TRUE(Accessible::waitFor([device = device] { return activities().contains(device); }));
    EXPECT_TRUE(Accessible::waitFor([this] { return !shows("Continue"); }));
    std::filesystem::remove(folder + "phone.json");
}

} // namespace
