#pragma once

#include "platform/Error.h"

#include <memory>
#include <optional>
#include <string>

namespace platform::ui {
class ViewController;
}

namespace tarrow {

/// What the screens share to tell the user something. Main thread.
class UIUtils {
public:
    UIUtils() = delete;

    /// Shows a message with the single button "OK" over a screen. Title and message may be empty.
    /// Without a screen nothing is shown.
    static void showAlertMessageParentViewController(const std::string& title, const std::string& message,
        const std::shared_ptr<platform::ui::ViewController>& parent);
    /// Shows why an operation failed: the error's description, else its failure reason, as the title.
    static void showErrorParentViewController(
        const platform::Error& error, const std::shared_ptr<platform::ui::ViewController>& parent);
    /// What a name prompt says about an error; empty without one. Only the code is looked at, not the domain.
    static std::string bestMessage(const std::optional<platform::Error>& error);

    /// Whether the device is a tablet.
    static bool tabulaMode();

    /// Makes a screen a part of another one: its view becomes a subview of the parent's, in front of the
    /// others.
    static void addChildViewControllerChildViewController(
        const std::shared_ptr<platform::ui::ViewController>& parent,
        const std::shared_ptr<platform::ui::ViewController>& child);
};

} // namespace tarrow
