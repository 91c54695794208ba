#pragma once

#include "platform/PropertyValue.h"

#include <string>
#include <string_view>

namespace platform::ui {

class ViewController;

/// Collects or hands out the state that one screen keeps from run to run.
class StateCoder {
public:
    StateCoder() = default;
    explicit StateCoder(PropertyDictionary values);

    void encode(std::string key, PropertyValue value);
    /// Null when nothing was kept under the key.
    const PropertyValue* decode(std::string_view key) const;

    const PropertyDictionary& values() const { return _values; }

private:
    PropertyDictionary _values;
};

/// The state of a screen and of the screens that it contains: one dictionary for each restoration identifier.
PropertyDictionary encodeInterfaceState(ViewController& root);
/// Gives every screen in the tree that has a restoration identifier its dictionary back, parents first.
/// Screens without a kept state are not called.
void decodeInterfaceState(ViewController& root, const PropertyDictionary& state);

} // namespace platform::ui
