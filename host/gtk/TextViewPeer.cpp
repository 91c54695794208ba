#include "host/gtk/TextViewPeer.h"

#include "platform/ui/TextView.h"

namespace host::gtk {

namespace ui = platform::ui;

namespace {

constexpr int margin = 12; ///< around the text, points

} // namespace

TextViewPeer::TextViewPeer(
    std::shared_ptr<PeerContext> context, const std::shared_ptr<ui::TextView>& textView)
    : ViewPeer(std::move(context), textView)
    , _textView(textView)
    , _text(gtk_text_view_new())
    , _style(ObjectRef<GtkCssProvider>::adopt(gtk_css_provider_new()))
{
    auto* text = GTK_TEXT_VIEW(_text);
    gtk_text_view_set_editable(text, FALSE);
    gtk_text_view_set_cursor_visible(text, FALSE);
    gtk_text_view_set_wrap_mode(text, GTK_WRAP_WORD_CHAR);
    gtk_text_view_set_left_margin(text, margin);
    gtk_text_view_set_right_margin(text, margin);
    gtk_text_view_set_top_margin(text, margin);
    gtk_text_view_set_bottom_margin(text, margin);
    gtk_style_context_add_provider(gtk_widget_get_style_context(_text), GTK_STYLE_PROVIDER(_style.get()),
        GTK_STYLE_PROVIDER_PRIORITY_APPLICATION);
    auto* window = gtk_scrolled_window_new();
    gtk_scrolled_window_set_policy(GTK_SCROLLED_WINDOW(window), GTK_POLICY_NEVER, GTK_POLICY_AUTOMATIC);
    gtk_scrolled_window_set_child(GTK_SCROLLED_WINDOW(window), _text);
    setNative(window);
}

bool TextViewPeer::grabFocus()
{
    return gtk_widget_grab_focus(_text);
}

void TextViewPeer::mirror(ui::View& shown, ui::ViewChanges changes)
{
    ViewPeer::mirror(shown, changes);
    const auto textView = _textView.lock();
    if (!textView || !changes.contains(ui::ViewChange::Content))
        return;
    mirrorFont(*textView);
    if (_shownText == textView->text())
        return;
    // A new text in the buffer loses the place, so the same one is not set again.
    _shownText = textView->text();
    gtk_text_buffer_set_text(gtk_text_view_get_buffer(GTK_TEXT_VIEW(_text)), _shownText.c_str(),
        static_cast<int>(_shownText.size()));
}

void TextViewPeer::mirrorFont(const ui::TextView& textView)
{
    const bool isMonospaced = textView.spacing() == ui::TextSpacing::Monospaced;
    gtk_text_view_set_monospace(GTK_TEXT_VIEW(_text), isMonospaced);
    const auto description = context().theme().describe(textView.font());
    const int pixels = pango_font_description_get_size(description.get()) / PANGO_SCALE;
    const std::string css = "textview { font-size: " + std::to_string(pixels) + "px; }";
    gtk_css_provider_load_from_data(_style.get(), css.c_str(), static_cast<gssize>(css.size()));
}

} // namespace host::gtk
