// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "items/DRItem.h"
#include "platform/Dispatch.h"
#include "tests/items/support/ItemsFixture.h"

#include <gmock/gmock.h>

using namespace tarrow;
using items_tests::ItemsFixture;
using platform::Thumbnail;

namespace {

class ThumbnailTest : public ItemsFixture {
protected:
    /// Gives every item these thumbnails, and counts the requests for them.
    void provide(ThumbnailMap map)
    {
        decorated->decoratedItems.changePromised = [this, map = std::move(map)](
                                                       const Url&, Result<AttributeMap>& values) {
            values.value.emplace();
            values.value->set(AttributeKey::ThumbnailMap, map);
            ++fetches;
        };
    }
    int fetches = 0;
};

TEST_F(ThumbnailTest, IsFetchedOnceWhetherThereIsOneOrNot)
{
    const auto large = Image::fromPixels(2, 1, 1, {0, 0});
    const auto first = DRItem::initWithURL(writeDocument("a.png", "1"));
    const auto second = DRItem::initWithURL(writeDocument("b.png", "1"));

    provide({{256, Image::named("small")}, {1024, large}});
    EXPECT_EQ(first->thumbnail(), large);
    EXPECT_EQ(first->thumbnail(), large);
    EXPECT_EQ(log->count("DEBUG URL Thumbs: (256: 0x0, 1024: 2x1)"), 1U);
    provide({{256, Image::named("small")}});
    EXPECT_FALSE(second->thumbnail());
    EXPECT_FALSE(second->thumbnail());
    EXPECT_EQ(fetches, 2);
}

TEST_F(ThumbnailTest, IgnoresWhatIsNoMapOfThumbnails)
{
    const auto item = DRItem::initWithURL(writeDocument("a.png", "1"));
    item->updateThumbnailImage(AttributeValue(std::string("no map")));
    item->updateThumbnailImage(std::nullopt);
    EXPECT_EQ(log->count("DEBUG URL Thumbs: ()"), 0U);
    item->updateThumbnailImage(AttributeValue(ThumbnailMap()));
    EXPECT_EQ(log->count("DEBUG URL Thumbs: ()"), 1U);
    EXPECT_FALSE(item->thumbnail());
}

TEST_F(ThumbnailTest, IsNotGeneratedHere)
{
    const auto item = DRItem::initWithURL(writeDocument("a.png", "1"));
    int calls = 0;
    item->generateThumbnail([&](const std::optional<Image>& image) {
        ++calls;
        EXPECT_FALSE(image);
    });
    EXPECT_EQ(calls, 1);
    EXPECT_FALSE(item->canGenerateThumbnail());
}

TEST_F(ThumbnailTest, HasOneQueueForTheProcess)
{
    const auto queue = DRItem::getThumbnailQueue();
    EXPECT_EQ(queue->name(), "thumbnailQueue");
    EXPECT_EQ(queue->qualityOfService(), platform::QualityOfService::Background);
    EXPECT_EQ(queue, DRItem::getThumbnailQueue());
}

} // namespace
