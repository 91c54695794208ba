// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "browser/ItemDeletion.h"

#include "items/FileUtils.h"
#include "platform/FileCoordinator.h"

namespace tarrow {

namespace {

constexpr Operation op{
    "-[NavController showWarningAndDeleteURLs:usingView:withDocumentListController:finishedCompletion:]"};

platform::DocumentContainers& containers()
{
    return services().cloudDocumentService().containers();
}

void failed(DeletionOutcome& outcome, std::optional<Error> error)
{
    ++outcome.failures;
    if (error)
        outcome.lastError = std::move(error);
}

void deleteItem(const Url& url, const ItemChange& change, DeletionOutcome& outcome)
{
    op.info("Deleting item %@", url);
    auto error = FileUtils::remove(url, change.stillWanted());
    outcome.deleted += !error;
    if (error && !change.wasTakenBack(*error)) {
        op.warning("Failed to delete URL %@: %{public}@", url, *error);
        failed(outcome, std::move(error));
    }
}

void deleteLibrary(const Url& url, DeletionOutcome& outcome)
{
    const auto found = containers().containerForItem(url);
    const auto container = found ? *found : nullptr;
    if (!container || found.error || container->identifier.empty()) {
        op.warning("No container for URL %@: %{public}@", url, found.error);
        failed(outcome, std::nullopt);
    } else if (container->identifier == containers().defaultContainerIdentifier()) {
        op.error("NOT Deleting root container %{public}@", container->identifier);
        failed(outcome, std::nullopt);
    } else {
        op.info("Deleting container %{public}@", container->identifier);
        std::optional<Error> error;
        const auto refused =
            services().fileCoordinator().coordinateWriting(url, platform::WritingOptions::ForDeleting,
                [&](const Url&) { error = containers().deleteContents(*container); });
        if (refused)
            error = refused;
        outcome.deleted += !error;
        if (error) {
            op.warning("Failed to delete container %{public}@: %{public}@", container->identifier, *error);
            failed(outcome, std::move(error));
        }
    }
}

} // namespace

DeletionOutcome deleteItems(ItemChange& change)
{
    DeletionOutcome outcome;
    change.forEachItem([&](const Url& item) {
        if (containers().isContainerTopFolder(item))
            deleteLibrary(item, outcome);
        else
            deleteItem(item, change, outcome);
        return std::nullopt;
    });
    return outcome;
}

} // namespace tarrow
