#include "platform/components/RowDetailsLoader.h"

#include "platform/Services.h"

#include <utility>

namespace platform::components {

std::shared_ptr<RowDetailsLoader> RowDetailsLoader::create(Arrived arrived)
{
    return std::make_shared<RowDetailsLoader>(std::move(arrived));
}

RowDetailsLoader::RowDetailsLoader(Arrived arrived)
    : _arrived(std::move(arrived))
    , _queue(services().dispatch().makeOperationQueue("row details", QualityOfService::UserInitiated))
{
}

void RowDetailsLoader::setWanted(const std::vector<Request>& requests)
{
    std::unordered_map<ui::RowId, Ticket> wanted;
    std::vector<std::pair<const Request*, Ticket>> added;
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

void RowDetailsLoader::cancelAll()
{
    const std::lock_guard lock(_shared->mutex);
    _shared->wanted.clear();
}

void RowDetailsLoader::fetch(const Request& request, Ticket ticket)
{
    const auto main = services().dispatch().mainQueue();
    _queue->addOperation([weak = weak_from_this(), shared = _shared, request, ticket, main] {
        if (!isWanted(*shared, request.id, ticket))
            return;
        if (!keepFound(*shared, {request.id, ticket, readRowDetails(request.url, request.kind)}))
            return;
        main->async([weak] {
            if (const auto self = weak.lock())
                self->deliver();
        });
    });
}

bool RowDetailsLoader::isWanted(Shared& shared, ui::RowId id, Ticket ticket)
{
    const std::lock_guard lock(shared.mutex);
    const auto found = shared.wanted.find(id);
    return found != shared.wanted.end() && found->second == ticket;
}

// Whether a delivery has to be posted: rows that are found in the meantime go with the one that waits.
bool RowDetailsLoader::keepFound(Shared& shared, Found found)
{
    const std::lock_guard lock(shared.mutex);
    shared.found.push_back(std::move(found));
    return !std::exchange(shared.isDeliveryPosted, true);
}

void RowDetailsLoader::deliver()
{
    std::vector<Found> arrived;
    {
        const std::lock_guard lock(_shared->mutex);
        _shared->isDeliveryPosted = false;
        for (auto& found : std::exchange(_shared->found, {})) {
            const auto wanted = _shared->wanted.find(found.id);
            if (wanted == _shared->wanted.end() || wanted->second != found.ticket)
                continue;
            _shared->wanted.erase(wanted);
            arrived.push_back(std::move(found));
        }
    }
    for (auto& found : arrived)
        _arrived(found.id, std::move(found.details));
}

} // namespace platform::components
