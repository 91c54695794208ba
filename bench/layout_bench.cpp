// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/layout/LayoutConstraint.h"
#include "kit/views/Label.h"

#include <benchmark/benchmark.h>

#include <memory>
#include <string>
#include <vector>

namespace {

using namespace platform;
using namespace kit;

/// A screen of 100 constrained views: fifty rows of a name and a value, where all names have the same width.
class Form {
public:
    Form()
    {
        std::shared_ptr<Label> above;
        for (int row = 0; row < 50; ++row) {
            const auto name = label("Name " + std::to_string(row * 37 % 50)),
                       value = label("A value of some length");
            name->setHugging(251, Axis::Horizontal);
            value->setCompressionResistance(250, Axis::Horizontal);
            LayoutConstraints row_{name->leadingAnchor().equalTo(root->leadingAnchor(), 16),
                value->leadingAnchor().equalTo(name->trailingAnchor(), 10),
                root->trailingAnchor().equalTo(value->trailingAnchor(), 16),
                value->topAnchor().equalTo(name->topAnchor()),
                name->topAnchor().equalTo(above ? above->bottomAnchor() : root->topAnchor(), 10)};
            if (above)
                row_.push_back(name->widthAnchor().equalTo(above->widthAnchor()));
            else
                top = row_.back();
            LayoutConstraint::activate(row_);
            above = name;
            names.push_back(name);
        }
    }

    std::shared_ptr<Label> label(const std::string& text)
    {
        const auto made = std::make_shared<Label>(text);
        made->setPlacedByFrame(false);
        root->addSubview(made);
        return made;
    }

    std::shared_ptr<View> root = std::make_shared<View>(Rect{0, 0, 360, 640});
    std::vector<std::shared_ptr<Label>> names;
    std::shared_ptr<LayoutConstraint> top;
};

void firstLayout(benchmark::State& state)
{
    std::unique_ptr<Form> form;
    for (auto _ : state) {
        state.PauseTiming();
        form = std::make_unique<Form>();
        state.ResumeTiming();
        form->root->layoutIfNeeded();
    }
}
BENCHMARK(firstLayout)->Unit(benchmark::kMicrosecond);

/// The floor: the same number of views, whose frames are computed by hand.
void placedByHand(benchmark::State& state)
{
    const Form form;
    double width = 360;
    for (auto _ : state) {
        width = width == 360 ? 400 : 360;
        double y = 10;
        for (std::size_t row = 0; row < form.names.size(); ++row, y += 30) {
            form.root->subviews()[2 * row]->setFrame({16, y, 60, 20});
            form.root->subviews()[2 * row + 1]->setFrame({86, y, width - 102, 20});
        }
    }
}
BENCHMARK(placedByHand)->Unit(benchmark::kMicrosecond);

void anotherWindowSize(benchmark::State& state)
{
    const Form form;
    double width = 360;
    for (auto _ : state) {
        width = width == 360 ? 400 : 360;
        form.root->setFrame({0, 0, width, 640});
        form.root->layoutIfNeeded();
    }
}
BENCHMARK(anotherWindowSize)->Unit(benchmark::kMicrosecond);

void anotherConstant(benchmark::State& state)
{
    const Form form;
    for (auto _ : state) {
        form.top->setConstant(form.top->constant() == 10 ? 60 : 10);
        form.root->layoutIfNeeded();
    }
}
BENCHMARK(anotherConstant)->Unit(benchmark::kMicrosecond);

void anotherText(benchmark::State& state)
{
    const Form form;
    bool isLong = false;
    for (auto _ : state) {
        isLong = !isLong;
        form.names[20]->setText(isLong ? "The longest of all names" : "Name");
        form.root->layoutIfNeeded();
    }
}
BENCHMARK(anotherText)->Unit(benchmark::kMicrosecond);

} // namespace

BENCHMARK_MAIN();
