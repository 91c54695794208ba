#pragma once

#include "platform/components/DocumentListController.h"

namespace tarrow {

/// The folder list that a peek at a folder shows. Main thread.
class PeekFolderViewController : public platform::components::DocumentListController {
public:
    static std::shared_ptr<PeekFolderViewController> initWithURL(const platform::Url& url);

    using DocumentListController::DocumentListController;

    /// A peek has no room for a search field.
    bool shouldShowSearch() const override { return false; }
};

} // namespace tarrow
