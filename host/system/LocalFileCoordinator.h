#pragma once

#include "host/system/CoordinatedRead.h"
#include "platform/FileCoordinator.h"

namespace host::system {

/// Coordination of reads on this machine. A read runs at once: what is being written lies under another name
/// until it is whole, so a reader never sees half of it and has nothing to wait for.
class LocalFileCoordinator : public platform::FileCoordinator {
public:
    std::optional<platform::Error> coordinateReading(
        const platform::Url& url, platform::ReadingOptions options, const Accessor& accessor) override
    {
        if (options == platform::ReadingOptions::ImmediatelyAvailableMetadataOnly) {
            const CoordinatedRead marked;
            accessor(url);
        } else {
            accessor(url);
        }
        return std::nullopt;
    }
};

} // namespace host::system
