// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#include "WindowFixture.h"
#include "host/gtk/base/LocalFiles.h"
#include "host/gtk/base/ObjectRef.h"
#include "kit/controllers/ViewController.h"

#include <gmock/gmock.h>

namespace {

using host::gtk::ObjectRef;
using testing::ElementsAre;

/// A screen that keeps what it is offered.
class TakingScreen : public kit::ViewController {
public:
    bool takesFiles() const override { return isTaking; }
    bool filesOffered(const std::vector<platform::Url>& files) override
    {
        for (const auto& file : files)
            offered.push_back(file.path());
        return true;
    }
    bool isTaking = true;
    std::vector<std::string> offered;
};

class FileOffersTests : public testing_support::WindowFixture {
protected:
    /// Answers the first controller of the window of a type.
    template <typename T>
    ObjectRef<T> controller(GType type, const std::function<bool(T*)>& isMeant) const
    {
        const auto all = ObjectRef<GListModel>::adopt(gtk_widget_observe_controllers(windowWidget()));
        for (guint i = 0; i < g_list_model_get_n_items(all.get()); ++i) {
            const auto each = ObjectRef<GObject>::adopt(G_OBJECT(g_list_model_get_item(all.get(), i)));
            auto* found = reinterpret_cast<T*>(each.get());
            if (g_type_is_a(G_OBJECT_TYPE(each.get()), type) && isMeant(found))
                return ObjectRef<T>::retain(found);
        }
        return {};
    }
    /// Presses Ctrl+V in the window. Answers whether the key meant something.
    bool paste() const
    {
        bool isTaken = false;
        controller<GListModel>(GTK_TYPE_SHORTCUT_CONTROLLER, [&](GListModel* shortcuts) {
            const auto first =
                ObjectRef<GtkShortcut>::adopt(GTK_SHORTCUT(g_list_model_get_item(shortcuts, 0)));
            if (!first)
                return false;
            const std::unique_ptr<char, decltype(&g_free)> keys(
                gtk_shortcut_trigger_to_string(gtk_shortcut_get_trigger(first.get())), g_free);
            if (std::string_view(keys.get()) == "<Control>v")
                isTaken = gtk_shortcut_action_activate(
                    gtk_shortcut_get_action(first.get()), GtkShortcutActionFlags(0), windowWidget(), nullptr);
            return false;
        });
        return isTaken;
    }
    static GSList* fileList(const std::vector<const char*>& uris)
    {
        GSList* files = nullptr;
        for (const char* uri : uris)
            files = g_slist_append(files, g_file_new_for_uri(uri));
        return files;
    }
    void copy(const char* type, const std::string& text) const
    {
        const auto bytes = std::unique_ptr<GBytes, decltype(&g_bytes_unref)>(
            g_bytes_new(text.data(), text.size()), g_bytes_unref);
        const auto content =
            ObjectRef<GdkContentProvider>::adopt(gdk_content_provider_new_for_bytes(type, bytes.get()));
        gdk_clipboard_set_content(gtk_widget_get_clipboard(windowWidget()), content.get());
    }
    const std::shared_ptr<TakingScreen> screen = std::make_shared<TakingScreen>();
};

TEST_F(FileOffersTests, FilesOnTheClipboardArePasted)
{
    show(screen);
    copy("text/plain", "file:///tmp/a");
    EXPECT_FALSE(paste()) << "that is a text";
    copy("text/uri-list", "file:///tmp/a%20b\r\nsftp://far/c\r\nfile:///tmp/d\r\n");
    screen->isTaking = false;
    EXPECT_FALSE(paste());
    screen->isTaking = true;
    EXPECT_TRUE(paste());
    waitFor([&] { return !screen->offered.empty(); }, "the clipboard");
    EXPECT_THAT(screen->offered, ElementsAre("/tmp/a b", "/tmp/d"));
}

TEST_F(FileOffersTests, WhatIsCopiedIsWhatOtherProgramsFindAndIsPastedAgain)
{
    show(screen);
    auto* clipboard = gtk_widget_get_clipboard(windowWidget());
    const std::vector<std::string> paths{"/tmp/a b%.txt", "/tmp/ü\n.txt", "/tmp/Trip"};
    std::vector<platform::Url> files;
    for (const auto& path : paths)
        files.push_back(platform::Url::fileURL(path));
    gdk_clipboard_set_content(
        clipboard, ObjectRef<GdkContentProvider>::adopt(host::gtk::contentOf(files)).get());
    const std::unique_ptr<GdkContentFormats, decltype(&gdk_content_formats_unref)> formats(
        gdk_content_formats_union_serialize_mime_types(
            gdk_content_formats_ref(gdk_clipboard_get_formats(clipboard))),
        gdk_content_formats_unref);
    for (const char* type : {"text/uri-list", "x-special/gnome-copied-files"})
        EXPECT_TRUE(gdk_content_formats_contain_mime_type(formats.get(), type)) << type;
    EXPECT_TRUE(paste());
    waitFor([&] { return screen->offered.size() == paths.size(); }, "the clipboard");
    EXPECT_EQ(screen->offered, paths);
}

TEST_F(FileOffersTests, FilesThatAreDroppedAreOffered)
{
    show(screen);
    const auto target = controller<GtkDropTarget>(GTK_TYPE_DROP_TARGET, [](auto*) { return true; });
    ASSERT_TRUE(target);
    const auto drop = [&](std::vector<const char*> uris) {
        GValue value = G_VALUE_INIT;
        g_value_init(&value, GDK_TYPE_FILE_LIST);
        g_value_take_boxed(&value, fileList(uris));
        gboolean isTaken = FALSE;
        g_signal_emit_by_name(target.get(), "drop", &value, 1.0, 1.0, &isTaken);
        g_value_unset(&value);
        return isTaken;
    };
    EXPECT_TRUE(drop({"file:///tmp/a", "file:///tmp/b"}));
    screen->isTaking = false;
    EXPECT_FALSE(drop({"file:///tmp/c"}));
    EXPECT_THAT(screen->offered, ElementsAre("/tmp/a", "/tmp/b"));
}

} // namespace
