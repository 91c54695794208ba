// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/values/Screen.h"

namespace kit {

namespace {

std::optional<Screen>& mainScreen()
{
    static std::optional<Screen> screen;
    return screen;
}

} // namespace

const std::optional<Screen>& Screen::main()
{
    return mainScreen();
}

void Screen::setMain(std::optional<Screen> screen)
{
    mainScreen() = screen;
}

double Screen::mainScale()
{
    return mainScreen() ? mainScreen()->scale : 1;
}

} // namespace kit
