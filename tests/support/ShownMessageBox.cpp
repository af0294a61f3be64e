#include "support/ShownMessageBox.h"

#include "support/DesktopTools.h"
#include "support/GuiWait.h"

#include <gtest/gtest.h>
#include <wx/timer.h>

#include <gdk/gdkx.h>
#include <gtk/gtk.h>

namespace {

GtkMessageDialog* MappedMessageBox()
{
    GtkMessageDialog* found = nullptr;
    GList* windows = gtk_window_list_toplevels();
    for (GList* w = windows; w; w = w->next)
        if (GTK_IS_MESSAGE_DIALOG(w->data) && gtk_widget_get_mapped(GTK_WIDGET(w->data)))
            found = GTK_MESSAGE_DIALOG(w->data);
    g_list_free(windows);
    return found;
}

GtkWidget* PictureBesideText(GtkMessageDialog* box)
{
    GtkWidget* picture = nullptr;
    GtkWidget* row = gtk_widget_get_parent(gtk_message_dialog_get_message_area(box));
    GList* children = gtk_container_get_children(GTK_CONTAINER(row));
    for (GList* c = children; c && !picture; c = c->next)
        if (GTK_IS_IMAGE(c->data) && gtk_widget_get_mapped(GTK_WIDGET(c->data)))
            picture = GTK_WIDGET(c->data);
    g_list_free(children);
    return picture;
}

wxRect ScreenRect(GtkWidget* widget)
{
    GtkWidget* top = gtk_widget_get_toplevel(widget);
    int x = 0, y = 0, originX = 0, originY = 0;
    gtk_widget_translate_coordinates(widget, top, 0, 0, &x, &y);
    gdk_window_get_origin(gtk_widget_get_window(top), &originX, &originY);
    return wxRect(originX + x, originY + y, gtk_widget_get_allocated_width(widget),
                  gtk_widget_get_allocated_height(widget));
}

void Inspect(GtkMessageDialog* box, ShownMessageBox& shown)
{
    shown.seen = true;
    GtkWidget* window = GTK_WIDGET(box);
    // Settled once active (the window manager placed it) and painted alike twice.
    wxImage last;
    GtkWidget* picture = PictureBesideText(box);
    const bool settled = WaitFor([&] {
        if (!gtk_window_is_active(GTK_WINDOW(box)))
            return false;
        const wxImage now = ScreenPixels(ScreenRect(window));
        const bool same = last.IsOk() && SamePixels(now, last, 0);
        last = now;
        return same;
    });
    EXPECT_TRUE(settled) << "the message box active and painted";
    shown.title = WindowTitle(GDK_WINDOW_XID(gtk_widget_get_window(window)));
    if (picture) {
        const gchar* name = nullptr;
        gtk_image_get_icon_name(GTK_IMAGE(picture), &name, nullptr);
        shown.icon = name ? name : "";
        shown.iconPixels = ScreenPixels(ScreenRect(picture));
    }
    gtk_dialog_response(GTK_DIALOG(box), GTK_RESPONSE_OK);
}

} // namespace

ShownMessageBox ObserveMessageBox(const std::function<void()>& action)
{
    ShownMessageBox shown;
    wxTimer look;
    look.Bind(wxEVT_TIMER, [&](wxTimerEvent&) {
        if (GtkMessageDialog* box = MappedMessageBox()) {
            look.Stop();
            Inspect(box, shown);
        }
    });
    look.Start(50);
    action();
    WaitFor([&] { return shown.seen; });
    return shown;
}
