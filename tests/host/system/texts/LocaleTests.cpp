// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/texts/GettextLocalization.h"
#include "host/system/texts/IcuFormatters.h"
#include "host/system/texts/UserLocale.h"
#include "platform/Services.h"

#include <gtest/gtest.h>

#include <clocale>
#include <cstdlib>

using namespace platform;
using namespace host::system;

namespace {

constexpr const char* variables[] = {"LANGUAGE", "LC_ALL", "LC_MESSAGES", "LC_TIME", "LC_COLLATE", "LANG"};

/// Gives each test an environment without languages, and leaves none behind.
class LocaleTest : public testing::Test {
protected:
    LocaleTest() { forgetLanguages(); }
    ~LocaleTest() override
    {
        forgetLanguages();
        std::setlocale(LC_ALL, "");
        installServices({});
    }
    static void forgetLanguages()
    {
        for (const char* name : variables)
            ::unsetenv(name);
    }
    static void install(const UserLocale& locale)
    {
        ServiceSet set;
        set.localization = std::make_shared<GettextLocalization>(TRW_LOCALE_FOLDER, locale);
        set.formatters = std::make_shared<IcuFormatters>(locale.formats, "UTC");
        installServices(std::move(set));
    }
};

TEST_F(LocaleTest, ReadsTheUsersLocaleAsTheCLibraryDoes)
{
    const auto none = UserLocale::fromEnvironment();
    EXPECT_EQ(none.languages, "en");
    EXPECT_EQ(none.formats, "en_US");
    ::setenv("LANG", "de_AT.UTF-8", 1);
    EXPECT_EQ(UserLocale::fromEnvironment().languages, "de_AT:en");
    EXPECT_EQ(UserLocale::fromEnvironment().formats, "de_AT");
    ::setenv("LANGUAGE", "fr:en:de", 1);
    ::setenv("LC_TIME", "ar_EG.UTF-8@x", 1);
    EXPECT_EQ(UserLocale::fromEnvironment().languages, "fr:en:de");
    EXPECT_EQ(UserLocale::fromEnvironment().languageList(), (std::vector<std::string>{"fr", "en", "de"}));
    EXPECT_EQ(UserLocale::fromEnvironment().formats, "ar_EG");
    ::setenv("LC_ALL", "C.UTF-8", 1);
    EXPECT_EQ(UserLocale::fromEnvironment().languages, "en");
    EXPECT_EQ(UserLocale::fromEnvironment().formats, "en_US");
}

TEST_F(LocaleTest, EnglishTextsAndPluralsWithoutAnyLocale)
{
    install(UserLocale::fromEnvironment());
    EXPECT_EQ(localized("New Folder"), "New Folder");
    EXPECT_EQ(localized("no such key"), "no such key");
    EXPECT_EQ(localized(""), "");
    EXPECT_EQ(localizedPlural(".DICT.ITEMS.%d", {std::int64_t{1}}), "1 item");
    EXPECT_EQ(localizedPlural(".DICT.ITEMS.%d", {std::int64_t{0}}), "0 items");
    EXPECT_EQ(localizedPlural(".DICT.ITEMS.%d", {std::int64_t{12'345}}), "12,345 items");
    EXPECT_EQ(localizedPlural(".DICT.ITEMS_SELECTED.%d", {std::int64_t{3}}), "3 Items Selected");
    EXPECT_EQ(localizedPlural(".DICT.AVAILABLE.%g", {1.2, "1.2 GB"}), "1.2 GB available");
    EXPECT_EQ(localizedPlural(".DICT.NONE.%d", {std::int64_t{3}}), ".DICT.NONE.3");
    EXPECT_FALSE(services().localization().isRightToLeft());
}

TEST_F(LocaleTest, OtherLanguagesWithoutTheirLocaleInstalled)
{
    ::setenv("LANG", "ar_EG.UTF-8", 1);
    install(UserLocale::fromEnvironment());
    EXPECT_TRUE(services().localization().isRightToLeft());
    EXPECT_EQ(localizedPlural(".DICT.ITEMS.%d", {std::int64_t{2}}), "عنصران");
    EXPECT_EQ(localizedPlural(".DICT.ITEMS.%d", {std::int64_t{3}}), "٣ عناصر");
    EXPECT_EQ(localizedPlural(".DICT.ITEMS.%d", {std::int64_t{11}}), "١١ عنصرًا");
    ::setenv("LANG", "de_DE.UTF-8", 1);
    install({"de_DE:en", "de_DE"});
    EXPECT_FALSE(services().localization().isRightToLeft());
    EXPECT_EQ(localized("The name “%@” is already taken.", {"a"}), "Der Name „a“ ist bereits vergeben.");
    EXPECT_EQ(localized("The name “%@” is already taken.", {"a\u202Efdp.exe"}),
        "Der Name „a\uFFFDfdp.exe“ ist bereits vergeben.");
    // A language without a catalogue reads English texts from left to right.
    install({"he_IL:en", "he_IL"});
    EXPECT_EQ(localizedPlural(".DICT.ITEMS.%d", {std::int64_t{1}}), "1 item");
    EXPECT_FALSE(services().localization().isRightToLeft());
}

TEST(IcuFormatters, ByteCountsReadAsFilesAreShown)
{
    const struct {
        const char* locale;
        std::uint64_t bytes;
        ByteCountStyle style;
        const char* text;
        double number;
    } rows[] = {
        {"en_US", 0, ByteCountStyle::File, "Zero KB", 0},
        {"en_US", 1, ByteCountStyle::File, "1 byte", 1},
        {"en_US", 1000, ByteCountStyle::Binary, "1,000 bytes", 1000},
        {"en_US", 999'499, ByteCountStyle::File, "999 KB", 999},
        {"en_US", 999'500, ByteCountStyle::File, "1 MB", 1},
        {"en_US", 1'048'575, ByteCountStyle::Binary, "1 MB", 1},
        {"en_US", 1'550'000, ByteCountStyle::File, "1.6 MB", 1.6},
        {"en_US", 1'288'490'189, ByteCountStyle::Binary, "1.2 GB", 1.2},
        {"en_US", 1'234'000'000, ByteCountStyle::File, "1.23 GB", 1.23},
        {"en_US", ~0ULL, ByteCountStyle::Binary, "16,384 PB", 16384},
        {"de_DE", 1'234'000'000, ByteCountStyle::File, "1,23\u00a0GB", 1.23},
    };
    for (const auto& row : rows) {
        const IcuFormatters formatters(row.locale);
        EXPECT_EQ(formatters.byteCount(row.bytes, row.style, ByteCountUnit::Included), row.text);
        EXPECT_DOUBLE_EQ(formatters.byteCountNumber(row.bytes, row.style), row.number) << row.text;
    }
}

TEST(IcuFormatters, DatesNumbersAndTextsFollowTheLocale)
{
    const Date date{1'669'132'800'000'000'000}; // 2022-11-22 16:00 UTC
    const IcuFormatters english("en_US", "UTC"), german("de_DE", "Europe/Vienna"), arabic("ar_EG", "UTC");
    EXPECT_EQ(english.date(date, DateStyle::Long, DateStyle::None), "November 22, 2022");
    EXPECT_EQ(english.date(date, DateStyle::None, DateStyle::Short), "4:00\u202fPM");
    EXPECT_EQ(german.date(date, DateStyle::Short, DateStyle::Short), "22.11.22, 17:00");
    EXPECT_EQ(german.date({-1}, DateStyle::Medium, DateStyle::None), "01.01.1970");
    EXPECT_EQ(english.date(date, DateStyle::None, DateStyle::None), "");
    EXPECT_EQ(english.number(-1'234'567), "-1,234,567");
    EXPECT_EQ(german.number(1'234'567), "1.234.567");
    EXPECT_EQ(arabic.number(12), "١٢");
    EXPECT_EQ(german.byteCount(1'234'000'000, ByteCountStyle::File, ByteCountUnit::LeftOut), "1,23");
    EXPECT_EQ(german.byteCount(0, ByteCountStyle::File, ByteCountUnit::LeftOut), "0");
}

TEST(IcuFormatters, ComparesWithoutLetterCaseByTheLanguage)
{
    const IcuFormatters english("en_US"), turkish("tr_TR");
    EXPECT_TRUE(english.equalIgnoringCase("ALIAS", "Alias"));
    EXPECT_TRUE(english.equalIgnoringCase("Zo\u00cb", "zoe\u0308"));
    EXPECT_FALSE(english.equalIgnoringCase("Zoe", "Zoë"));
    EXPECT_FALSE(english.equalIgnoringCase("Alias", "Alia"));
    EXPECT_FALSE(turkish.equalIgnoringCase("ALIAS", "alias")); // I is the capital of ı there
    EXPECT_TRUE(english.equalIgnoringCase("\xff", "\xff"));
}

} // namespace
