#include "kit/TraitCollection.h"

namespace platform::ui {

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

} // namespace platform::ui
