// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "kit/values/TraitCollection.h"

namespace kit {

namespace {

TraitCollection& applicationTraits()
{
    static TraitCollection traits;
    return traits;
}

} // namespace

const TraitCollection& TraitCollection::application()
{
    return applicationTraits();
}

void TraitCollection::setApplication(const TraitCollection& traits)
{
    applicationTraits() = traits;
}

} // namespace kit
