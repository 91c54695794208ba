// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "drawing/FileTags.h"
#include "fuzz/support/Fuzzing.h"
#include "host/drive/service/LocalKeyValueStore.h"
#include "platform/Services.h"
#include "tests/support/VirtualDispatch.h"

namespace {

using host::drive::DriveLayout;
using tarrow::FileTags;

/// Reads the file anew for every question.
class Store : public platform::KeyValueStore {
public:
    std::optional<platform::PropertyValue> objectForKey(const std::string& key) const override
    {
        const auto dispatch = testing_support::VirtualDispatch::create();
        return host::drive::LocalKeyValueStore::create(layout, {dispatch, nullptr, nullptr, nullptr, nullptr})
            ->objectForKey(key);
    }
    const DriveLayout layout = DriveLayout::at(fuzzing::folder());
};

} // namespace

void fuzzing::tryInput(std::string_view input)
{
    static const auto store = [] {
        const auto made = std::make_shared<Store>();
        platform::ServiceSet set;
        set.notificationCenter = std::make_shared<platform::NotificationCenter>();
        set.keyValueStore = made;
        platform::installServices(std::move(set));
        return made;
    }();
    writeFile(store->layout.keyValueStore(), input);
    FileTags::_tagColorsDidChange();
    for (const auto& tag : FileTags::allTags())
        require(FileTags::colorOfTag(tag).has_value(), "every tag has a colour");
}
