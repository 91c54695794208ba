// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "kit/controllers/PopoverAnchor.h"
#include "platform/AppRegistry.h"
#include "platform/Error.h"
#include "platform/FileSystem.h"
#include "platform/Geometry.h"
#include "platform/LatestLook.h"
#include "platform/Url.h"
#include "screens/PlatformNames.h"

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace kit {
class AlertController;
class BarButtonItem;
class View;
class ViewController;
} // namespace kit

namespace screens {

class DocumentInteractionSheet;

/// Is told when the sheet has closed. Main thread only.
class DocumentInteractionSheetDelegate {
public:
    virtual ~DocumentInteractionSheetDelegate() = default;
    /// Called once after each menu that was shown, whatever the user chose in it.
    virtual void documentInteractionControllerDidDismissOptionsMenu(
        const std::shared_ptr<DocumentInteractionSheet>&)
    {
    }
};

/// The menu of actions on one item outside the drive: open it in an app, send it, copy its path or a link to
/// it, show it in the file manager, print it. Actions that need the content are offered only when it is
/// downloaded. The caller that shows the menu keeps the sheet until it is dismissed. Main thread only.
class DocumentInteractionSheet : public std::enable_shared_from_this<DocumentInteractionSheet> {
public:
    /// So many apps have a line of their own in the menu; further ones stand behind a line "Other Apps…".
    static constexpr std::size_t directApps = 3;

    /// What the disk says about an item.
    struct ItemFacts {
        std::string name; ///< for people
        std::optional<FileType> type; ///< of what is here; absent for an item that is not downloaded
    };
    /// Looks them up. Any thread.
    static ItemFacts lookUp(const Url& url);

    static std::shared_ptr<DocumentInteractionSheet> interactionControllerWithURL(const Url& url);
    /// Makes the same with facts that were looked up, and looks at nothing.
    static std::shared_ptr<DocumentInteractionSheet> interactionControllerWithURLFacts(
        const Url& url, ItemFacts facts);
    DocumentInteractionSheet(Url url, ItemFacts facts);

    const Url& url() const { return _url; }
    /// The heading of the menu. It is the item's display name until another one is set.
    const std::string& name() const { return _facts.name; }
    void setName(std::string name) { _facts.name = std::move(name); }
    void setDelegate(std::weak_ptr<DocumentInteractionSheetDelegate> delegate)
    {
        _delegate = std::move(delegate);
    }

    /// Asks an app to open the document in its place. Answers false when the content was not downloaded at
    /// the look, or the app cannot be started.
    bool openDocumentInPlaceInApp(const AppHandle& app) const;

    /// Shows the menu over a screen, pointing at a rectangle of a view.
    void presentOptionsMenuFromRectInView(const std::shared_ptr<kit::ViewController>& presenter,
        const Rect& rect, const std::shared_ptr<kit::View>& view, bool animated);
    /// Shows the menu over a screen, pointing at a button of a bar.
    void presentOptionsMenuFromBarButtonItem(const std::shared_ptr<kit::ViewController>& presenter,
        const std::shared_ptr<kit::BarButtonItem>& item, bool animated);

private:
    using Apps = std::vector<AppHandle>;
    using Action = void (DocumentInteractionSheet::*)();

    void present(
        const std::shared_ptr<kit::ViewController>& presenter, kit::PopoverAnchor anchor, bool animated);
    std::shared_ptr<kit::AlertController> makeMenu(Apps apps);
    std::shared_ptr<kit::AlertController> makeAppMenu(const Apps& apps);
    void showMenu(const std::shared_ptr<kit::AlertController>& menu, bool animated);
    void addApp(kit::AlertController& menu, const AppHandle& app);
    void add(kit::AlertController& menu, const std::string& title, Action action);
    void addCancel(kit::AlertController& menu);
    bool contentIsHere() const { return _facts.type.has_value(); }
    std::function<void(const std::optional<Error>&)> reportFailure();

    void openIn(const AppHandle& app);
    void sendByMail();
    void copyPath();
    void copyLink();
    void tell(const std::string& notice);
    void showInFileManager();
    void print();
    void showFailure(const std::string& title, const std::string& message);
    void ended();

    Url _url;
    ItemFacts _facts;
    const std::shared_ptr<platform::LatestLook> _look = std::make_shared<platform::LatestLook>();
    std::weak_ptr<DocumentInteractionSheetDelegate> _delegate;
    std::weak_ptr<kit::ViewController> _presenter;
    kit::PopoverAnchor _anchor;
};

} // namespace screens
