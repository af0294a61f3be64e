#include "platform/ButtonAccessibility.h"

#include <wx/access.h>
#include <wx/window.h>

#include <utility>

namespace {

// Answers for a labelled image button; an unlabelled one, and every question
// not answered here, gets the system's answers for a plain window.
class ButtonAccessible : public wxAccessible
{
public:
    ButtonAccessible(wxWindow* window, ButtonAccessibility answers)
        : wxAccessible(window), m_answers(std::move(answers))
    {
    }

    wxAccStatus GetName(int childId, wxString* name) override
    {
        if (!IsButton(childId))
            return wxACC_NOT_IMPLEMENTED;
        *name = m_answers.name();
        return wxACC_OK;
    }

    wxAccStatus GetRole(int childId, wxAccRole* role) override
    {
        if (!IsButton(childId))
            return wxACC_NOT_IMPLEMENTED;
        *role = wxROLE_SYSTEM_PUSHBUTTON;
        return wxACC_OK;
    }

    wxAccStatus GetState(int childId, long* state) override
    {
        if (!IsButton(childId))
            return wxACC_NOT_IMPLEMENTED;
        wxWindow* window = GetWindow();
        *state = wxACC_STATE_SYSTEM_FOCUSABLE;
        if (window->HasFocus())
            *state |= wxACC_STATE_SYSTEM_FOCUSED;
        if (!window->IsEnabled())
            *state |= wxACC_STATE_SYSTEM_UNAVAILABLE;
        if (!window->IsShownOnScreen())
            *state |= wxACC_STATE_SYSTEM_INVISIBLE;
        return wxACC_OK;
    }

    wxAccStatus GetDefaultAction(int childId, wxString* actionName) override
    {
        if (!IsButton(childId))
            return wxACC_NOT_IMPLEMENTED;
        *actionName = "click";
        return wxACC_OK;
    }

    wxAccStatus DoDefaultAction(int childId) override
    {
        if (!IsButton(childId))
            return wxACC_NOT_IMPLEMENTED;
        if (!GetWindow()->IsEnabled())
            return wxACC_FAIL;
        // The screen reader waits for this answer: the click runs after it.
        // Pending calls go with the window.
        GetWindow()->CallAfter(m_answers.click);
        return wxACC_OK;
    }

private:
    bool IsButton(int childId) const { return childId == wxACC_SELF && m_answers.isLabelled(); }

    ButtonAccessibility m_answers;
};

} // namespace

// The window owns its accessible and deletes it with itself.
void ExposeAsButton(wxWindow* window, ButtonAccessibility button)
{
    window->SetAccessible(new ButtonAccessible(window, std::move(button)));
}

void ForgetButton(wxWindow* window)
{
    window->SetAccessible(nullptr);
}
