// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/values/TextMeasurer.h"

#include <algorithm>
#include <cmath>

namespace kit {

namespace {

std::size_t characterCount(std::string_view text)
{
    return static_cast<std::size_t>(
        std::ranges::count_if(text, [](unsigned char byte) { return (byte & 0xC0U) != 0x80U; }));
}

/// Fills lines word by word, and breaks a word that is wider than a line.
class LineFiller {
public:
    explicit LineFiller(double maxWidth)
        : _maxWidth(maxWidth)
    {
    }

    void addWord(double width, double spaceWidth)
    {
        const double joined = _line == 0 ? width : _line + spaceWidth + width;
        if (_maxWidth <= 0 || joined <= _maxWidth) {
            _line = joined;
            return;
        }
        if (_line > 0)
            breakLine();
        for (; width > _maxWidth; width -= _maxWidth) {
            _line = _maxWidth;
            breakLine();
        }
        _line = width;
    }
    void breakLine()
    {
        _widest = std::max(_widest, _line);
        _line = 0;
        ++_lines;
    }
    double widest() const { return std::max(_widest, _line); }
    int lines() const { return _lines + 1; }

private:
    double _maxWidth, _line = 0, _widest = 0;
    int _lines = 0;
};

class PlainMeasurer : public TextMeasurer {
public:
    Size measure(std::string_view text, const Font& font, const TextLimits& limits) const override
    {
        return measure(AttributedText(std::string(text)), font, limits);
    }

    Size measure(const AttributedText& text, const Font& font, const TextLimits& limits) const override
    {
        LineFiller filler(limits.maxLines == 1 ? 0 : limits.maxWidth);
        double lineHeight = metrics(font).lineHeight;
        for (const auto& run : text.runs()) {
            const Font runFont = run.attributes.font.value_or(font);
            lineHeight = std::max(lineHeight, metrics(runFont).lineHeight);
            if (run.attachment)
                filler.addWord(run.attachment->size().width, 0);
            else
                addText(filler, run.text, runFont.pointSize * characterShare);
        }
        const int lines = limits.maxLines > 0 ? std::min(limits.maxLines, filler.lines()) : filler.lines();
        const double width =
            limits.maxWidth > 0 ? std::min(limits.maxWidth, filler.widest()) : filler.widest();
        return {width, lines * lineHeight};
    }

    FontMetrics metrics(const Font& font) const override
    {
        return {0.95 * font.pointSize, -0.25 * font.pointSize, 0.7 * font.pointSize, 1.2 * font.pointSize};
    }

private:
    static constexpr double characterShare = 0.5;

    static void addText(LineFiller& filler, std::string_view text, double characterWidth)
    {
        double space = 0;
        while (true) {
            const auto end = std::min(text.find_first_of(" \n"), text.size());
            filler.addWord(static_cast<double>(characterCount(text.substr(0, end))) * characterWidth, space);
            if (end == text.size())
                return;
            space = text[end] == '\n' ? 0 : characterWidth;
            if (text[end] == '\n')
                filler.breakLine();
            text.remove_prefix(end + 1);
        }
    }
};

std::shared_ptr<const TextMeasurer>& installedMeasurer()
{
    static std::shared_ptr<const TextMeasurer> measurer = std::make_shared<PlainMeasurer>();
    return measurer;
}

} // namespace

const TextMeasurer& TextMeasurer::current()
{
    return *installedMeasurer();
}

void TextMeasurer::install(std::shared_ptr<const TextMeasurer> measurer)
{
    installedMeasurer() = measurer ? std::move(measurer) : std::make_shared<PlainMeasurer>();
}

} // namespace kit
