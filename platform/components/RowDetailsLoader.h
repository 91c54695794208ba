#pragma once

#include "platform/Dispatch.h"
#include "platform/components/RowDetails.h"

#include <functional>
#include <memory>
#include <mutex>
#include <unordered_map>
#include <vector>

namespace platform::components {

/// Fetches the details of the rows that are on the screen, off the main thread. What is no longer wanted when
/// its turn comes is skipped; what arrives too late is dropped. Main thread only.
class RowDetailsLoader : public std::enable_shared_from_this<RowDetailsLoader> {
public:
    struct Request {
        ui::RowId id;
        Url url;
        FolderEntryKind kind;
    };
    /// Called on the main thread, once for each row that is still wanted.
    using Arrived = std::function<void(ui::RowId, RowDetails)>;

    static std::shared_ptr<RowDetailsLoader> create(Arrived arrived);
    explicit RowDetailsLoader(Arrived arrived);

    /// The rows whose details are missing now: others are not wanted any more.
    void setWanted(const std::vector<Request>& requests);
    /// Forgets what is under way, so that the next `setWanted` reads everything again.
    void cancelAll();

private:
    using Ticket = std::uint64_t;
    struct Found {
        ui::RowId id;
        Ticket ticket;
        RowDetails details;
    };
    /// What the workers see.
    struct Shared {
        std::mutex mutex;
        std::unordered_map<ui::RowId, Ticket> wanted;
        std::vector<Found> found;
        bool isDeliveryPosted = false;
    };

    void fetch(const Request& request, Ticket ticket);
    static bool isWanted(Shared& shared, ui::RowId id, Ticket ticket);
    static bool keepFound(Shared& shared, Found found);
    void deliver();

    Arrived _arrived;
    std::shared_ptr<Shared> _shared = std::make_shared<Shared>();
    std::shared_ptr<OperationQueue> _queue;
    Ticket _nextTicket = 1;
};

} // namespace platform::components
