// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/controllers/ViewController.h"

#include <memory>

namespace screens {

/// Is shown while the drive cannot be used because nobody is signed in. It says what happened and what to do.
class UnavailableScreen : public kit::ViewController {
public:
    static std::shared_ptr<UnavailableScreen> create();

    UnavailableScreen();
    void loadView() override;
};

} // namespace screens
