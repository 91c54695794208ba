#include "host/system/GdkPixbufImageLoader.h"
#include "tests/support/TemporaryDirectory.h"

#include <gtest/gtest.h>
#include <sys/stat.h>

using namespace platform;
using host::system::GdkPixbufImageLoader;
using testing_support::TemporaryDirectory;

namespace {

/// A picture whose left half is red and whose right half is blue.
std::string twoColors(int width, int height)
{
    std::string file = "P6 " + std::to_string(width) + ' ' + std::to_string(height) + " 255\n";
    for (int i = 0; i < width * height; ++i)
        file += i % width < width / 2 ? std::string("\xFF\0\0", 3) : std::string("\0\0\xFF", 3);
    return file;
}

struct ErrorRow {
    const char* name;
    std::string content;
    std::string_view domain;
    int code;
};

TEST(ImageLoader, KeepsColorsAndMakesLargePicturesSmaller)
{
    const TemporaryDirectory folder;
    const auto path = folder.write("wide.ppm", twoColors(400, 100));
    const GdkPixbufImageLoader loader;

    const auto whole = loader.load(path, {.maxWidth = 400, .maxHeight = 400, .scale = 2});
    ASSERT_TRUE(whole);
    EXPECT_EQ(whole->pixelWidth(), 400);
    EXPECT_EQ(whole->size(), (Size{200, 50}));
    EXPECT_EQ(whole->pixels().front(), 0xFFFF0000);
    EXPECT_EQ(whole->pixels().back(), 0xFF0000FF);

    const auto small = loader.load(path, {.maxWidth = 100, .maxHeight = 10});
    ASSERT_TRUE(small);
    EXPECT_EQ(small->pixelWidth(), 40);
    EXPECT_EQ(small->pixelHeight(), 10);
}

TEST(ImageLoader, SaysWhyAPictureCannotBeShown)
{
    const TemporaryDirectory folder;
    const GdkPixbufImageLoader loader;
    const ImageLimits limits{.maxFileBytes = 100'000, .maxSourcePixels = 10'000};
    const auto damaged = static_cast<int>(ImageErrorCode::Damaged);
    const auto tooLarge = static_cast<int>(ImageErrorCode::TooLarge);
    const ErrorRow rows[] = {
        {"no picture", "just words", errorDomain::image, damaged},
        {"empty", "", errorDomain::image, damaged},
        {"header names too many pixels", "P6 30000 30000 255\n", errorDomain::image, tooLarge},
        {"too many bytes", std::string(100'001, ' '), errorDomain::image, tooLarge},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(row.name);
        const auto loaded = loader.load(folder.write("picture.ppm", row.content), limits);
        ASSERT_TRUE(loaded.error);
        EXPECT_EQ(loaded.error->domain(), row.domain);
        EXPECT_EQ(loaded.error->code(), row.code);
    }
    const auto missing = loader.load(folder.at("missing.png"), limits);
    ASSERT_TRUE(missing.error);
    EXPECT_TRUE(missing.error->is(FileErrorCode::NoSuchFile));
}

TEST(ImageLoader, DoesNotWaitForAPipe)
{
    const TemporaryDirectory folder;
    ASSERT_EQ(::mkfifo(folder.at("pipe.png").c_str(), 0600), 0);
    EXPECT_TRUE(GdkPixbufImageLoader().load(folder.at("pipe.png"), {}).error);
}

} // namespace
