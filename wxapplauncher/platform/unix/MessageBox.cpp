#include "platform/MessageBox.h"

#include <wx/msgdlg.h>

#include <gtk/gtk.h>

#include <string>

namespace {

struct BoxLook
{
    std::string title;
    bool applied = false;
};

// The themed icons that GTK 2 showed for the message types.
const char* IconName(GtkMessageType type)
{
    switch (type) {
    case GTK_MESSAGE_INFO:
        return "dialog-information";
    case GTK_MESSAGE_WARNING:
        return "dialog-warning";
    case GTK_MESSAGE_QUESTION:
        return "dialog-question";
    case GTK_MESSAGE_ERROR:
        return "dialog-error";
    default:
        return nullptr;
    }
}

// Runs for every widget shown while the box is up; the toolkit makes the box inside
// ShowModal and shows it right before its modal loop, so this is the moment to dress it.
gboolean DressMessageBox(GSignalInvocationHint*, guint, const GValue* params, gpointer data)
{
    auto* look = static_cast<BoxLook*>(data);
    GObject* widget = static_cast<GObject*>(g_value_get_object(&params[0]));
    if (look->applied || !GTK_IS_MESSAGE_DIALOG(widget))
        return TRUE;
    look->applied = true;
    GtkMessageDialog* box = GTK_MESSAGE_DIALOG(widget);
    gtk_window_set_title(GTK_WINDOW(box), look->title.c_str());
    GtkMessageType type = GTK_MESSAGE_OTHER;
    g_object_get(box, "message-type", &type, nullptr);
    if (const char* name = IconName(type)) {
        // Where GTK's own (deprecated) image slot puts it: before the text, at its top.
        GtkWidget* row = gtk_widget_get_parent(gtk_message_dialog_get_message_area(box));
        GtkWidget* image = gtk_image_new_from_icon_name(name, GTK_ICON_SIZE_DIALOG);
        gtk_widget_set_valign(image, GTK_ALIGN_START);
        gtk_box_pack_start(GTK_BOX(row), image, FALSE, FALSE, 0);
        gtk_box_reorder_child(GTK_BOX(row), image, 0);
        gtk_widget_show(image);
    }
    return TRUE;
}

} // namespace

int ShowMessageBox(const wxString& message, const wxString& caption, long style)
{
    // Its signals exist once the class does, also before the program's first window.
    gpointer boxClass = g_type_class_ref(GTK_TYPE_MESSAGE_DIALOG);
    const guint shown = g_signal_lookup("show", GTK_TYPE_WIDGET);
    BoxLook look{caption.utf8_string()};
    const gulong hook = g_signal_add_emission_hook(shown, 0, DressMessageBox, &look, nullptr);
    const int answer = wxMessageBox(message, caption, style, nullptr);
    g_signal_remove_emission_hook(shown, hook);
    g_type_class_unref(boxClass);
    return answer;
}
