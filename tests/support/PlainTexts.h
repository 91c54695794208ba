// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "platform/Localization.h"

namespace testing_support {

/// A localization without a catalogue: every text is its key.
class PlainTexts : public platform::Localization {
public:
    std::string text(const std::string& key) const override { return key; }
    std::string pluralText(const std::string& key, double) const override { return key; }
    bool isRightToLeft() const override { return false; }
};

} // namespace testing_support
