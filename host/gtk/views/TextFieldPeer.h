// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/gtk/base/ViewPeer.h"
#include "kit/views/TextFieldDelegate.h"

#include <optional>

namespace kit {
class TextField;
}

namespace host::gtk {

/// Shows a text field with a GtkEntry.
class TextFieldPeer : public ViewPeer {
public:
    TextFieldPeer(std::shared_ptr<PeerContext> context, const std::shared_ptr<kit::TextField>& field);

    void viewDidChange(kit::View& view, kit::ViewChanges changes) override;
    bool grabFocus() override;
    /// Answers the entry's own height, because the theme wants more room around a text than its line has.
    std::optional<platform::Size> nativeSize(const kit::View& view, double maxWidth) override;
    /// Sets the entry's accessible name when neither its label nor its placeholder gives one.
    void setAccessibleName(const std::string& name);
    /// The callback runs when the return key was pressed and the field's delegate did not object.
    void setOnReturn(std::function<void()> callback) { _onReturn = std::move(callback); }

protected:
    void mirror(kit::View& shown, kit::ViewChanges changes) override;

private:
    void connectEvents();
    void edited();
    void entered();
    void left();
    void selectionMoved();
    void returnPressed();
    void mirrorContent(const kit::TextField& field);
    void mirrorClearButton(const kit::TextField& field);
    void mirrorText(const kit::TextField& field);

    std::weak_ptr<kit::TextField> _field;
    SignalConnection _onChanged, _onCursor, _onBound;
    std::function<void()> _onReturn;
    std::optional<kit::TextRange> _wantedSelection; ///< what the delegate selected when the field was entered
    bool _isEntering = false;
};

} // namespace host::gtk
