#include "platform/KeyboardFocus.h"

#include <wx/window.h>

#include <gtk/gtk.h>

void DropInputMethod(wxWindow* window)
{
    if (window->m_imContext) {
        g_signal_handlers_disconnect_matched(window->m_imContext, G_SIGNAL_MATCH_DATA, 0, 0,
                                             nullptr, nullptr, window);
        g_object_unref(window->m_imContext);
        window->m_imContext = nullptr;
    }
}

bool IsFocusShown(const wxWindow* window)
{
    GtkWidget* top = gtk_widget_get_toplevel(window->GetHandle());
    return GTK_IS_WINDOW(top) && gtk_window_get_focus_visible(GTK_WINDOW(top));
}
