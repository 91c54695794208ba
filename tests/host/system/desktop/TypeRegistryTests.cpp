// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "host/system/desktop/MimeTypeRegistry.h"
#include "host/system/desktop/TypeGraph.h"
#include "host/system/desktop/TypePreviewSupport.h"
#include "host/system/desktop/TypeTable.h"

#include <gtest/gtest.h>

#include <atomic>
#include <set>
#include <thread>

using namespace platform;
using host::system::MimeTypeRegistry;

namespace {

class TypeRegistryTest : public testing::Test {
protected:
    MimeTypeRegistry types;
};

TEST_F(TypeRegistryTest, TableIsConsistent)
{
    std::set<std::string_view> identifiers, extensions, mimeTypes;
    for (const auto& row : host::system::typeTable()) {
        EXPECT_TRUE(identifiers.insert(row.identifier).second) << row.identifier;
        for (const auto parent : host::system::words(row.parents))
            EXPECT_TRUE(identifiers.contains(parent)) << row.identifier << " before " << parent;
        for (const auto extension : host::system::words(row.extensions))
            EXPECT_TRUE(extensions.insert(extension).second) << extension;
        for (const auto mime : host::system::words(row.mimeTypes))
            EXPECT_TRUE(mimeTypes.insert(mime).second) << mime;
    }
    for (const auto type : {typeIdentifier::data, typeIdentifier::content, typeIdentifier::directory,
             typeIdentifier::package, typeIdentifier::symlink, typeIdentifier::image, typeIdentifier::movie,
             typeIdentifier::audio, typeIdentifier::text, typeIdentifier::pdf})
        EXPECT_TRUE(identifiers.contains(type)) << type;
}

TEST_F(TypeRegistryTest, ExtensionsGiveTheirTypeInAnyCase)
{
    EXPECT_EQ(types.typeForExtension("PnG"), "public.png");
    EXPECT_EQ(types.typeForExtension("md"), "public.markdown");
    EXPECT_EQ(types.typeForExtension("ADS"), "dyn.mime.text/x-adasrc");
    for (const std::string_view unknown : {std::string_view(), std::string_view("no-such-extension"),
             std::string_view("p\0ng", 4), std::string_view("a/b"), std::string_view("\xff\xfe"),
             std::string_view("0123456789012345678901234567890123456789")})
        EXPECT_EQ(types.typeForExtension(unknown), std::nullopt) << unknown;
}

TEST_F(TypeRegistryTest, ConformanceGoesThroughEveryParent)
{
    EXPECT_TRUE(types.conformsTo("public.svg-image", "public.image"));
    EXPECT_TRUE(types.conformsTo("public.svg-image", "public.plain-text"));
    EXPECT_FALSE(types.conformsTo("public.image", "public.png"));
    EXPECT_FALSE(types.conformsTo("public.directory", "public.data"));
    EXPECT_FALSE(types.conformsTo("what.ever", "public.data"));
    EXPECT_TRUE(types.conformsTo("what.ever", "what.ever"));
    // Types that only the MIME database has follow its own tree.
    EXPECT_TRUE(types.conformsTo("dyn.mime.text/x-adasrc", "public.text"));
    EXPECT_TRUE(types.conformsTo("dyn.mime.application/x-fictionbook+xml", "public.xml"));
    EXPECT_FALSE(types.conformsTo("dyn.mime.inode/fifo", "public.data"));
    EXPECT_TRUE(types.conformsTo("dyn.mime.application/x-fictionbook+xml", "dyn.mime.application/xml"));
}

TEST_F(TypeRegistryTest, DescribesAndPictures)
{
    EXPECT_EQ(types.description("public.pdf"), "PDF document");
    EXPECT_EQ(types.description("dyn.mime.text/x-adasrc"), "Ada source code");
    EXPECT_EQ(types.description("public.data"), "Unknown kind");
    EXPECT_EQ(types.description("public.text-bundle"), "Package");
    EXPECT_EQ(types.description("public.image"), std::nullopt);
    EXPECT_EQ(types.iconName("public.jpeg"), "image-x-generic");
    EXPECT_EQ(types.iconName("what.ever"), "text-x-generic");
    EXPECT_EQ(types.typeForMimeType("application/x-bzip2"), "public.bzip2-archive");
    EXPECT_EQ(types.mimeType("public.bzip2-archive"), "application/x-bzip");
}

TEST_F(TypeRegistryTest, AnswersTheSameOnManyThreadsAndForManyMadeUpExtensions)
{
    std::atomic<int> wrong = 0;
    std::vector<std::jthread> threads;
    for (int thread = 0; thread < 4; ++thread)
        threads.emplace_back([&] {
            for (int i = 0; i < 2000; ++i) {
                wrong += types.typeForExtension("made-up-" + std::to_string(i)).has_value();
                wrong += types.typeForExtension("ads") != "dyn.mime.text/x-adasrc";
                wrong += !types.conformsTo("dyn.mime.text/x-adasrc", "public.text");
            }
        });
    threads.clear();
    EXPECT_EQ(wrong, 0);
}

TEST_F(TypeRegistryTest, PreviewShowsWhatItHasAViewFor)
{
    const host::system::TypePreviewSupport preview(std::make_shared<MimeTypeRegistry>());
    for (const char* shown : {"a.png", "a.MD", "a.cpp", "a.pdf", "a.mp3", "a.mkv", "a.ads", "a.svg"})
        EXPECT_TRUE(preview.canPreview(Url::fileURL(std::string("/") + shown))) << shown;
    for (const char* other : {"a.zip", "a.docx", "a", "a.pages", "a.unknown"})
        EXPECT_FALSE(preview.canPreview(Url::fileURL(std::string("/") + other))) << other;
    EXPECT_FALSE(preview.canPreview(Url::fileURL("/folder.png", PathKind::Directory)));
    EXPECT_FALSE(preview.canPreview(*Url::parse("https://host/a.png")));
}

} // namespace
