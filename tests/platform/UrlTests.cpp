// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "platform/Url.h"

#include <gtest/gtest.h>

using namespace platform;

namespace {

TEST(Url, RefusesWhatCannotBeALocation)
{
    for (const std::string text : {"", "no-scheme", "://x", "1a:/x", "s:/a b", "s:/a\nb", "s:/%", "s:/%4",
             "s:/%zz", "s:/%00", "s:/%ff", "s:/%c0%ae", "s:/x?a=%", "file:relative"})
        EXPECT_FALSE(Url::parse(text)) << text;
    EXPECT_FALSE(Url::parse("s:/" + std::string(Url::maximumLength, 'a')));
}

TEST(Url, KeepsAFilesBytesThroughItsText)
{
    for (const std::string path : {"/a/b c%20d", "/caf\xc3\xa9", "/bad\xff\xfe", "/q?x#y", "/-x'\"&"}) {
        const auto url = Url::fileURL(path);
        const auto again = Url::parse(url.absoluteString());
        ASSERT_TRUE(again) << path;
        EXPECT_EQ(again->path(), path);
        EXPECT_EQ(*again, url);
        EXPECT_FALSE(again->isSameObject(url));
    }
}

TEST(Url, HasACleanPathHoweverItIsWritten)
{
    const std::pair<const char*, const char*> rows[] = {{"/a/./b", "/a/b"}, {"/a/b/.", "/a/b"},
        {"/./a//./b/./", "/a/b"}, {"/a/../b", "/b"}, {"/a/b/..", "/a"}, {"/a/..", "/"}, {"/..", "/"},
        {"/../../a/../..", "/"}, {"/../a", "/a"}, {"/a/b/../../c/", "/c"}, {"/.", "/"},
        {"/a/.b/..c/c..d/e./...", "/a/.b/..c/c..d/e./..."}, {"/a/.../..", "/a"}};
    for (const auto& [written, path] : rows) {
        SCOPED_TRACE(written);
        EXPECT_EQ(Url::fileURL(written).path(), path);
        EXPECT_EQ(Url::parse("file://" + std::string(written))->path(), path);
        EXPECT_EQ(Url::fileURL("/x").appendingPathComponent(written + 1).path(),
            Url::fileURL("/x" + std::string(written)).path());
    }
    EXPECT_EQ(Url::parse("file:///a/%2E/b/%2e%2E/c%2fd")->path(), "/a/c/d");
    EXPECT_EQ(Url::parse("s:/a/../%2Fb/.")->path(), "/a/../b/.") << "only its reader knows what that means";
}

TEST(Url, SplitsAndJoinsNames)
{
    const auto folder = Url::fileURL("//a//b/", PathKind::Directory);
    EXPECT_EQ(folder.path(), "/a/b");
    EXPECT_EQ(folder.absoluteString(), "file:///a/b/");
    EXPECT_EQ(folder.appendingPathComponent("c.tar.gz").path(), "/a/b/c.tar.gz");
    EXPECT_EQ(folder.deletingLastPathComponent().deletingLastPathComponent().path(), "/");
    EXPECT_EQ(Url::fileURL("/").deletingLastPathComponent().path(), "/");
    const std::pair<const char*, const char*> extensions[] = {{"/x/c.tar.gz", "gz"}, {"/x/.hidden", ""},
        {"/x/.hidden.txt", "txt"}, {"/x.d/none", ""}, {"/x/a.b c", ""}};
    for (const auto& [path, extension] : extensions)
        EXPECT_EQ(Url::fileURL(path).pathExtension(), extension) << path;
}

} // namespace
