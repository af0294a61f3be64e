#include "platform/ButtonAccessibility.h"

#include <wx/window.h>

#include <gtk/gtk-a11y.h>
#include <gtk/gtk.h>

#include <mutex>
#include <utility>

// The toolkit draws every window into a widget of one class of its own, so the
// accessible type set for that class answers for all of them: as before for
// any widget that is not a labelled image button.
namespace {

const char kButtonKey[] = "veltrona-image-button";
const char kNameKey[] = "veltrona-name";

AtkObjectClass* g_parentClass = nullptr;

struct ExposedButton
{
    wxWindow* window;
    ButtonAccessibility answers;
};

// The image button behind the accessible; none for an unlabelled one, which
// is a picture.
ExposedButton* ButtonOf(gpointer accessible)
{
    GtkWidget* widget = gtk_accessible_get_widget(GTK_ACCESSIBLE(accessible));
    auto* button =
        widget ? static_cast<ExposedButton*>(g_object_get_data(G_OBJECT(widget), kButtonKey))
               : nullptr;
    return button && button->answers.isLabelled() ? button : nullptr;
}

const gchar* GetName(AtkObject* accessible)
{
    ExposedButton* button = ButtonOf(accessible);
    if (!button || accessible->name)
        return g_parentClass->get_name(accessible);
    // ATK hands out the string without a copy: keep it with the accessible.
    gchar* name = g_strdup(button->answers.name().utf8_str());
    g_object_set_data_full(G_OBJECT(accessible), kNameKey, name, g_free);
    return name;
}

AtkRole GetRole(AtkObject* accessible)
{
    return ButtonOf(accessible) ? ATK_ROLE_PUSH_BUTTON : g_parentClass->get_role(accessible);
}

AtkStateSet* RefStateSet(AtkObject* accessible)
{
    AtkStateSet* states = g_parentClass->ref_state_set(accessible);
    if (ButtonOf(accessible))
        atk_state_set_add_state(states, ATK_STATE_FOCUSABLE);
    return states;
}

gint GetActionCount(AtkAction* action)
{
    return ButtonOf(action) ? 1 : 0;
}

const gchar* GetActionName(AtkAction* action, gint i)
{
    return ButtonOf(action) && i == 0 ? "click" : nullptr;
}

gboolean DoAction(AtkAction* action, gint i)
{
    ExposedButton* button = ButtonOf(action);
    if (!button || i != 0 || !button->window->IsEnabled())
        return FALSE;
    // The caller waits for the answer over the accessibility bus: start the
    // module after answering. Pending calls go with the window.
    button->window->CallAfter(button->answers.click);
    return TRUE;
}

void InitAction(gpointer iface, gpointer)
{
    auto* action = static_cast<AtkActionIface*>(iface);
    action->get_n_actions = GetActionCount;
    action->get_name = GetActionName;
    action->do_action = DoAction;
}

void InitClass(gpointer klass, gpointer)
{
    g_parentClass = ATK_OBJECT_CLASS(g_type_class_peek_parent(klass));
    auto* atk = ATK_OBJECT_CLASS(klass);
    atk->get_name = GetName;
    atk->get_role = GetRole;
    atk->ref_state_set = RefStateSet;
}

GType RegisterButtonAccessible()
{
    const GType type = g_type_register_static_simple(
        GTK_TYPE_CONTAINER_ACCESSIBLE, "VeltronaImageButtonAccessible",
        sizeof(GtkContainerAccessibleClass), InitClass, sizeof(GtkContainerAccessible), nullptr,
        GTypeFlags(0));
    const GInterfaceInfo action = {InitAction, nullptr, nullptr};
    g_type_add_interface_static(type, ATK_TYPE_ACTION, &action);
    return type;
}

void DeleteButton(gpointer button)
{
    delete static_cast<ExposedButton*>(button);
}

} // namespace

void ExposeAsButton(wxWindow* window, ButtonAccessibility button)
{
    GtkWidget* widget = window->GetHandle();
    static std::once_flag once;
    std::call_once(once, [widget] {
        gtk_widget_class_set_accessible_type(GTK_WIDGET_GET_CLASS(widget),
                                             RegisterButtonAccessible());
    });
    g_object_set_data_full(G_OBJECT(widget), kButtonKey,
                           new ExposedButton{window, std::move(button)}, DeleteButton);
}

void ForgetButton(wxWindow* window)
{
    g_object_set_data(G_OBJECT(window->GetHandle()), kButtonKey, nullptr);
}
