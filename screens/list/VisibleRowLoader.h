// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/values/ListRow.h"
#include "platform/Dispatch.h"
#include "platform/FolderSnapshot.h"
#include "platform/Services.h"
#include "platform/Url.h"
#include "platform/Weakly.h"
#include "screens/PlatformNames.h"

#include <cstdint>
#include <functional>
#include <memory>
#include <mutex>
#include <unordered_map>
#include <utility>
#include <vector>

namespace screens {

/// A row for which a value is to be read.
struct RowRequest {
    kit::RowId id;
    Url url;
    FolderEntryKind kind;
};

/// Reads a value for each visible row off the main thread. A row that is no longer wanted when its turn comes
/// is skipped, and a value that arrives too late is dropped. Main thread only.
template <typename Value>
class VisibleRowLoader : public std::enable_shared_from_this<VisibleRowLoader<Value>> {
public:
    using Read = std::function<Value(const RowRequest&)>; ///< called on threads of a queue
    /// Called on the main thread, once for each row that is still wanted.
    using Arrived = std::function<void(kit::RowId, Value)>;

    VisibleRowLoader(std::string name, QualityOfService quality, Read read, Arrived arrived)
        : _shared(std::make_shared<Shared>())
        , _arrived(std::move(arrived))
        , _queue(services().dispatch().makeOperationQueue(std::move(name), quality))
    {
        _shared->read = std::move(read);
    }

    /// Sets the rows that still lack their value. Other rows are not wanted any more.
    void setWanted(const std::vector<RowRequest>& requests)
    {
        std::unordered_map<kit::RowId, Ticket> wanted;
        std::vector<std::pair<const RowRequest*, Ticket>> added;
        const std::lock_guard lock(_shared->mutex);
        for (const auto& request : requests) {
            const auto known = _shared->wanted.find(request.id);
            const bool isNew = known == _shared->wanted.end();
            const auto ticket = isNew ? _nextTicket++ : known->second;
            if (wanted.emplace(request.id, ticket).second && isNew)
                added.emplace_back(&request, ticket);
        }
        _shared->wanted = std::move(wanted);
        for (const auto& [request, ticket] : added)
            fetch(*request, ticket);
    }

    /// Forgets the reads that are under way, so that the next `setWanted` reads everything again.
    void cancelAll()
    {
        const std::lock_guard lock(_shared->mutex);
        _shared->wanted.clear();
    }

    /// Forgets the read that is under way for one row.
    void cancel(kit::RowId id)
    {
        const std::lock_guard lock(_shared->mutex);
        _shared->wanted.erase(id);
    }

private:
    using Ticket = std::uint64_t;
    struct Found {
        kit::RowId id;
        Ticket ticket;
        Value value;
    };
    /// The state that the worker threads share.
    struct Shared {
        std::mutex mutex;
        Read read;
        std::unordered_map<kit::RowId, Ticket> wanted;
        std::vector<Found> found;
        bool isDeliveryPosted = false;

        bool isWanted(kit::RowId id, Ticket ticket)
        {
            const std::lock_guard lock(mutex);
            const auto known = wanted.find(id);
            return known != wanted.end() && known->second == ticket;
        }
        // Keeps a value. Answers whether a delivery has to be posted; a delivery that is already posted takes
        // this value with it.
        bool keep(Found value)
        {
            const std::lock_guard lock(mutex);
            found.push_back(std::move(value));
            return !std::exchange(isDeliveryPosted, true);
        }
        std::vector<Found> take()
        {
            const std::lock_guard lock(mutex);
            isDeliveryPosted = false;
            std::vector<Found> arrived;
            for (auto& value : std::exchange(found, {})) {
                const auto known = wanted.find(value.id);
                if (known == wanted.end() || known->second != value.ticket)
                    continue;
                wanted.erase(known);
                arrived.push_back(std::move(value));
            }
            return arrived;
        }
    };

    void fetch(const RowRequest& request, Ticket ticket)
    {
        const auto main = services().dispatch().mainQueue();
        _queue->addOperation([weak = this->weak_from_this(), shared = _shared, request, ticket, main] {
            if (!shared->isWanted(request.id, ticket)
                || !shared->keep({request.id, ticket, shared->read(request)}))
                return;
            main->async(weakly(weak, &VisibleRowLoader::deliver));
        });
    }

    void deliver()
    {
        for (auto& found : _shared->take())
            _arrived(found.id, std::move(found.value));
    }

    std::shared_ptr<Shared> _shared;
    Arrived _arrived;
    std::shared_ptr<OperationQueue> _queue;
    Ticket _nextTicket = 1;
};

} // namespace screens
