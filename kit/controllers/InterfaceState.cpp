// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/controllers/InterfaceState.h"

#include "kit/controllers/ViewController.h"

namespace kit {

PropertyDictionary encodeInterfaceState(ViewController& root)
{
    PropertyDictionary state;
    if (!root.restorationIdentifier().empty()) {
        StateCoder coder;
        root.encodeRestorableStateWithCoder(coder);
        state.emplace(root.restorationIdentifier(), coder.values());
    }
    for (const auto& child : root.children())
        state.merge(encodeInterfaceState(*child));
    return state;
}

void decodeInterfaceState(ViewController& root, const PropertyDictionary& state)
{
    const auto* kept =
        root.restorationIdentifier().empty() ? nullptr : find(state, root.restorationIdentifier());
    if (const auto* values = kept ? kept->get<PropertyDictionary>() : nullptr)
        root.decodeRestorableStateWithCoder(StateCoder(*values));
    // The list of children is copied, because a screen may give itself other children while it takes its
    // state back.
    const auto children = root.children();
    for (const auto& child : children)
        decodeInterfaceState(*child, state);
}

} // namespace kit
