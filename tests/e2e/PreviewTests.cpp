// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "DriveTests.h"

#include <gmock/gmock.h>

namespace e2e {
namespace {

class PreviewTests : public DriveTests {
protected:
    bool reads(const Program& shown, const std::string& text) const
    {
        return shown.document().find(text) != std::string::npos;
    }
    void expectText(const Program& shown, const std::string& text) const
    {
        EXPECT_TRUE(eventually([&] { return reads(shown, text); })) << text;
    }
    void write(const std::string& path, const std::string& text) const { std::ofstream(top / path) << text; }
};

TEST_F(PreviewTests, ADocumentIsFollowedWhereverOthersTakeIt)
{
    write("Desktop/Errands.txt", "Buy flour");
    start();
    program->press("Desktop");
    program->press("Errands.txt");
    expectText(*program, "Buy flour");
    write("Desktop/Errands.txt", "Buy flour and eggs");
    expectText(*program, "flour and eggs");

    ASSERT_EQ(files({"move", "Desktop/Errands.txt", "Documents/Letters/Chores.txt"}), 0);
    EXPECT_TRUE(eventually([this] { return program->says("Chores.txt") && !program->says("Errands.txt"); }));
    expectText(*program, "flour and eggs");
    program->press("Back");
    EXPECT_TRUE(eventually([this] { return program->shows("旅行メモ.txt"); })) << "not at its new place";

    program->pressUntil("Chores.txt", [this] { return reads(*program, "flour and eggs"); });
    ASSERT_EQ(files({"remove", "Documents/Letters/Chores.txt"}), 0);
    EXPECT_TRUE(eventually([this] { return program->document().empty() && !program->shows("Chores.txt"); }));
    EXPECT_TRUE(program->shows("旅行メモ.txt"));
}

TEST_F(PreviewTests, PicturesAndPagesSayWhatTheyAre)
{
    start();
    const auto isShown = [this](AtspiRole role, const std::string& name) {
        return !program
                    ->all([&](const Accessible& node) {
                        return node.hasRole(role) && node.name().starts_with(name);
                    })
                    .empty();
    };
    program->press("Photos");
    program->press("Biscuit the cat.png");
    EXPECT_TRUE(eventually([&] { return isShown(ATSPI_ROLE_IMAGE, "Biscuit the cat.png"); }));
    program->press("Back");
    expectShown("Winter hike");
    program->press("Back");
    program->press("Documents");
    program->press("Tickets");
    program->press("Night train");
    EXPECT_TRUE(eventually(
        [&] { return isShown(ATSPI_ROLE_DOCUMENT_TEXT, "Night train Berlin – Florence.pdf, page 1 of"); }));
}

TEST_F(PreviewTests, ADocumentInTheCloudIsFetchedWhenItIsOpened)
{
    write("Desktop/Errands.txt", "Buy flour");
    ASSERT_EQ(files({"evict", "Desktop/Errands.txt"}), 0);
    EXPECT_FALSE(std::filesystem::exists(top / "Desktop/Errands.txt"));
    start();
    const auto isInCloud = [this] {
        const auto rows = program->buttons("Errands.txt");
        return !rows.empty() && rows.back().name().find("In the cloud") != std::string::npos;
    };
    program->press("Desktop");
    EXPECT_TRUE(eventually(isInCloud));
    program->press("Errands.txt");
    expectText(*program, "Buy flour");
    EXPECT_TRUE(std::filesystem::exists(top / "Desktop/Errands.txt"));
    program->press("Back");
    EXPECT_TRUE(eventually([&] { return program->document().empty() && !isInCloud(); }));
}

TEST_F(PreviewTests, AnotherDeviceGoesOnWithWhatThisOneShows)
{
    write("Desktop/Errands.txt", "Buy flour");
    start();
    auto elsewhere = environment;
    elsewhere["XDG_STATE_HOME"] = home / "other-state";
    elsewhere["DISPLAY"] = getenv("TRW_OTHER_DISPLAY");
    elsewhere["DBUS_SESSION_BUS_ADDRESS"] = getenv("TRW_OTHER_BUS");
    const Program other(elsewhere);
    program->press("Desktop");
    program->press("Errands.txt");
    expectText(*program, "Buy flour");
    EXPECT_TRUE(eventually([&] { return other.shows("Continue"); }));
    program->press("Back");
    EXPECT_TRUE(eventually([&] { return !other.shows("Continue"); })) << "nothing is shown any more";

    program->press("Errands.txt");
    EXPECT_TRUE(eventually([&] { return other.shows("Continue"); }));
    other.press("Continue");
    expectText(other, "Buy flour");
    EXPECT_TRUE(eventually([&] { return !other.shows("Continue"); }));
}

} // namespace
} // namespace e2e
