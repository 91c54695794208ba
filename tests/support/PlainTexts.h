// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Localization.h"

namespace testing_support {

/// A localization without a catalogue: every text is its key. It is written from left to right unless a test
/// changes that.
class PlainTexts : public platform::Localization {
public:
    bool rightToLeft = false;

    std::string text(const std::string& key) const override { return key; }
    std::string pluralText(const std::string& key, double) const override { return key; }
    bool isRightToLeft() const override { return rightToLeft; }
};

} // namespace testing_support
