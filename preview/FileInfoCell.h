// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/Font.h"
#include "kit/views/View.h"

#include <memory>
#include <string>

namespace kit {
class Label;
}

namespace tarrow {

/// A row of facts about an item: a grey name beside a value. The value wraps or is cut before the name is.
/// Main thread only.
class FileInfoCell : public kit::View {
public:
    /// Answers the font of every row.
    static kit::Font font();
    /// Makes a row without texts.
    static std::shared_ptr<FileInfoCell> init();
    /// `maxLines` is the number of lines that the value may take.
    static std::shared_ptr<FileInfoCell> initWithNameAndValueValueMaxLines(
        const std::string& name, const std::string& value, int maxLines);

    const std::shared_ptr<kit::Label>& nameLabel() const { return _nameLabel; }
    const std::shared_ptr<kit::Label>& valueLabel() const { return _valueLabel; }

private:
    void build(const std::string& name, const std::string& value, int maxLines);

    std::shared_ptr<kit::Label> _nameLabel, _valueLabel;
};

} // namespace tarrow
