#pragma once

#include "platform/Error.h"
#include "platform/Url.h"

#include <functional>
#include <optional>

namespace platform {

enum class ReadingOptions {
    None,
    ImmediatelyAvailableMetadataOnly, ///< never waits for a download or for a writer: only what is known is
                                      ///< read
};

/// Coordinates access to files with other presenters and processes. Synchronous on the caller's thread; any
/// thread.
class FileCoordinator {
public:
    using Accessor = std::function<void(const Url&)>;

    virtual ~FileCoordinator() = default;

    /// Runs the accessor once with the location to use, which may differ from `url`. Answers an error, and
    /// does not run the accessor, when the read cannot be coordinated.
    virtual std::optional<Error> coordinateReading(
        const Url& url, ReadingOptions options, const Accessor& accessor) = 0;
};

} // namespace platform
