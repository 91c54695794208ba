// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/PlatformNames.h"
#include "platform/PropertyValue.h"

namespace kit {

class ViewController;

/// Answers the state of a screen and of the screens that it contains, with one dictionary for each
/// restoration identifier.
PropertyDictionary encodeInterfaceState(ViewController& root);
/// Gives every screen in the tree that has a restoration identifier its dictionary back, parents first. It
/// does not call screens that have no kept state.
void decodeInterfaceState(ViewController& root, const PropertyDictionary& state);

} // namespace kit
