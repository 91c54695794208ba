#include "prompts/UIUtils.h"

#include "platform/Localization.h"
#include "platform/ui/AlertController.h"
#include "platform/ui/Screen.h"
#include "platform/ui/View.h"

namespace tarrow {

using platform::Error;
using platform::FileErrorCode;
using platform::localized;
using platform::ui::AlertAction;
using platform::ui::AlertController;
using platform::ui::ViewController;

namespace {

std::string describe(const Error& error)
{
    for (const auto key :
        {platform::errorKey::localizedDescription, platform::errorKey::localizedFailureReason}) {
        if (auto text = error.text(key); text && !text->empty())
            return *text;
    }
    return localized("Mishap exception");
}

} // namespace

void UIUtils::showAlertMessageParentViewController(
    const std::string& title, const std::string& message, const std::shared_ptr<ViewController>& parent)
{
    if (!parent)
        return;
    const auto alert = std::make_shared<AlertController>(title, message, platform::ui::AlertStyle::Alert);
    alert->addAction(std::make_shared<AlertAction>(localized("OK"), platform::ui::AlertActionStyle::Default));
    parent->presentViewController(alert, true);
}

void UIUtils::showErrorParentViewController(const Error& error, const std::shared_ptr<ViewController>& parent)
{
    showAlertMessageParentViewController(describe(error), {}, parent);
}

std::string UIUtils::bestMessage(const std::optional<Error>& error)
{
    if (!error)
        return {};
    switch (static_cast<FileErrorCode>(error->code())) {
    case FileErrorCode::ItemExists:
        return localized("Name is already taken");
    case FileErrorCode::InvalidName:
        return localized("Character not allowed in filename");
    default:
        return describe(*error);
    }
}

bool UIUtils::tabulaMode()
{
    const auto& screen = platform::ui::Screen::main();
    return screen && screen->idiom == platform::ui::UserInterfaceIdiom::Tablet;
}

void UIUtils::addChildViewControllerChildViewController(
    const std::shared_ptr<ViewController>& parent, const std::shared_ptr<ViewController>& child)
{
    parent->addChildViewController(child);
    parent->view()->addSubview(child->view());
    child->didMoveToParentViewController(parent);
}

} // namespace tarrow
