// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "drawing/ColorBlending.h"
#include "drawing/FileTags.h"

#include "kit/values/Canvas.h"
#include "kit/values/ImageContext.h"

namespace tarrow {

using platform::Color;
using platform::Image;

namespace {

Color dotColor(std::string_view tag)
{
    return FileTags::colorOfTag(tag).value_or(FileTags::_tagBlipColors().front());
}

} // namespace

std::vector<kit::TagDot> FileTags::dotsForTags(const std::vector<std::string>& tags)
{
    std::vector<kit::TagDot> dots;
    dots.reserve(tags.size());
    for (const auto& tag : tags) {
        const auto color = dotColor(tag);
        dots.push_back({color, trw_colorBlendedWithColor(color, Color::gray(1, 0.5F))});
    }
    return dots;
}

std::optional<Image> FileTags::blipWithTagsHeightScale(
    const std::vector<std::string>& tags, float height, float scale)
{
    const auto context = kit::ImageContext::open(kit::TagDots::size(tags.size(), height), scale);
    if (!context)
        return std::nullopt;
    kit::TagDots::draw(context->canvas(), dotsForTags(tags), height);
    return context->image();
}

std::optional<Image> FileTags::blipWithTagImageSizeBlipHeightOffset(
    const std::optional<std::string>& tag, platform::Size imageSize, float blipHeight, platform::Point offset)
{
    const auto context = tag ? kit::ImageContext::open(imageSize, 1) : nullptr;
    if (!context)
        return std::nullopt;
    context->canvas().setFillColor(dotColor(*tag));
    context->canvas().fillEllipse({offset.x, offset.y, blipHeight, blipHeight});
    return context->image();
}

} // namespace tarrow
