// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "drawing/ColorBlending.h"

#include <gtest/gtest.h>

#include <ostream>

namespace tarrow {
namespace {

namespace filter = compositingFilter;
using platform::Color;

struct Blending {
    const char* name;
    std::optional<std::string_view> with;
    Color base, blend, result;
};

std::ostream& operator<<(std::ostream& out, const Blending& blending)
{
    return out << blending.name;
}

constexpr Color gray(float white, float alpha = 1)
{
    return Color::gray(white, alpha);
}

// Every sum and product here is exact in single precision.
constexpr Blending blendings[] = {
    {"WhiteOverRed", filter::sourceOver, {1, 0, 0, 1}, gray(1, 0.5F), {1, 0.5F, 0.5F, 1}},
    {"NormalIsSourceOver", filter::normal, {1, 0, 0, 1}, gray(1, 0.5F), {1, 0.5F, 0.5F, 1}},
    {"NoFilterIsSourceOver", std::nullopt, {1, 0, 0, 1}, gray(1, 0.5F), {1, 0.5F, 0.5F, 1}},
    {"OverNothing", filter::sourceOver, gray(0, 0), {0.25F, 0.5F, 1, 0.5F}, {0.25F, 0.5F, 1, 0.5F}},
    {"OverHalf", filter::sourceOver, gray(0, 0.5F), gray(1, 0.5F), gray(0.5F / 0.75F, 0.75F)},
    {"NothingIsLeft", filter::sourceOver, gray(0, -1), gray(0, 0.5F), gray(1, 0)},
    {"Multiply", filter::multiply, gray(0.5F), gray(0.5F), gray(0.25F)},
    {"MultiplyByHalf", filter::multiply, gray(0.5F), gray(0.5F, 0.5F), gray(0.375F)},
    {"KeepsTheBasesAlpha", filter::multiply, gray(0.5F, 0.25F), gray(0.5F), gray(0.25F, 0.25F)},
    {"Screen", filter::screen, {0.5F, 0, 1, 1}, {0.5F, 0.25F, 0.5F, 1}, {0.75F, 0.25F, 1, 1}},
    {"OverlaySwitchesAtHalf", filter::overlay, {0.25F, 0.5F, 0.75F, 1}, gray(0.25F),
        {0.125F, 0.25F, 0.625F, 1}},
    {"Darken", filter::darken, {0.25F, 0.75F, 0, 1}, gray(0.5F), {0.25F, 0.5F, 0, 1}},
    {"Lighten", filter::lighten, {0.25F, 0.75F, 0, 1}, gray(0.5F), {0.5F, 0.75F, 0.5F, 1}},
    {"DodgeIsNotLimited", filter::colorDodge, {0.25F, 0.25F, 0.75F, 1}, {1, 0, 0.5F, 1}, {1, 0.25F, 1.5F, 1}},
    {"DodgeByHalf", filter::colorDodge, gray(0.25F), gray(1, 0.5F), gray(0.625F)},
    {"BurnIsNotLimited", filter::colorBurn, {0.75F, 0.5F, 0.25F, 1}, {0, 1, 0.5F, 1}, {0, 0.5F, -0.5F, 1}},
    {"BurnMultipliesByTheBasesAlpha", filter::colorBurn, gray(0.75F, 0.5F), gray(0.5F, 0.5F),
        gray(0.5F * -0.25F + 0.5F * 0.375F, 0.5F)},
    {"PlusLighterIsLimited", filter::plusLighter, {0.25F, 0.75F, 0, 1}, gray(0.5F), {0.75F, 1, 0.5F, 1}},
    {"PlusDarkerOfOpaque", filter::plusDarker, {0.75F, 0.25F, 1, 1}, {0.5F, 0.5F, 1, 1}, {0.25F, 0, 1, 1}},
    {"PlusDarkerOfHalf", filter::plusDarker, gray(0.375F, 0.5F), gray(0.5F, 0.25F), gray(0.25F, 0.5F)},
    {"PlusDarkerIsLimited", filter::plusDarker, gray(1, 0.5F), gray(1, 0.75F), gray(1, 0.5F)},
    {"PlusDarkerOfNothing", filter::plusDarker, gray(1, 0), gray(1), gray(0, 0)},
    {"PlusDarkerTogetherNothing", filter::plusDarker, gray(0.5F, -0.5F), gray(0.5F, 0.5F), gray(0, -0.5F)},
    {"Unknown", "hardLight", gray(0.25F), gray(1, 0.5F), gray(0.25F)},
    // These come out differently when a term is in the other precision, or is rounded at another place.
    {"SourceOverSumsInDouble", filter::sourceOver, gray(0.75F, 0.95F), gray(0.6F, 0.25F),
        gray(0.7110389471F, 0.9625F)},
    {"ScreenTermInDouble", filter::screen, gray(0.2F), gray(0.1F, 0.25F), gray(0.2199999988F)},
    {"OverlayTermInDouble", filter::overlay, gray(0.6F), gray(0.15F, 0.7F), gray(0.4040000439F)},
    {"DodgeTermInDouble", filter::colorDodge, gray(0.1F), gray(0.1F, 0.65F), gray(0.1072222218F)},
    {"BurnTermInDouble", filter::colorBurn, gray(0.45F), gray(0.85F, 0.4F), gray(0.4111765027F)},
    {"MixesInSingle", filter::multiply, gray(0.1F), gray(0.5F, 0.05F), gray(0.0974999964F)},
};

class ColorBlending : public testing::TestWithParam<Blending> { };

TEST_P(ColorBlending, Answers)
{
    const auto& [name, with, base, blend, expected] = GetParam();
    const auto result = trw_colorBlendedWithColorCompositingFilter(base, blend, with);
    EXPECT_EQ(result.red, expected.red);
    EXPECT_EQ(result.green, expected.green);
    EXPECT_EQ(result.blue, expected.blue);
    EXPECT_EQ(result.alpha, expected.alpha);
}

INSTANTIATE_TEST_SUITE_P(, ColorBlending, testing::ValuesIn(blendings),
    [](const auto& row) { return std::string(row.param.name); });

TEST(ColorBlendingOfNothing, AnswersTheBaseForEveryFilter)
{
    const Color base{0.25F, 0.5F, 0.75F, 0.5F};
    for (const auto& blending : blendings) {
        EXPECT_EQ(trw_colorBlendedWithColorCompositingFilter(base, gray(1, 1e-8F), blending.with), base);
        EXPECT_EQ(trw_colorBlendedWithColorCompositingFilter(base, std::nullopt, blending.with), base);
    }
    EXPECT_EQ(trw_colorBlendedWithColor(gray(0), gray(1, 0.5F)), gray(0.5F));
}

} // namespace
} // namespace tarrow
