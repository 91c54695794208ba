#pragma once

#include "host/gtk/ViewPeer.h"

namespace platform::ui {
class TextView;
}

namespace host::gtk {

/// A read-only GtkTextView in a scrolled window.
class TextViewPeer : public ViewPeer {
public:
    TextViewPeer(
        std::shared_ptr<PeerContext> context, const std::shared_ptr<platform::ui::TextView>& textView);

    bool grabFocus() override;

protected:
    void mirror(platform::ui::View& view, platform::ui::ViewChanges changes) override;

private:
    void mirrorFont(const platform::ui::TextView& textView);

    std::weak_ptr<platform::ui::TextView> _textView;
    GtkWidget* _text;
    ObjectRef<GtkCssProvider> _style;
    std::string _shownText;
};

} // namespace host::gtk
