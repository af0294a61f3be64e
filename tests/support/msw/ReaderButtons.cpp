#include "support/msw/ReaderButtons.h"

#include <wx/string.h>

std::vector<ReaderButton> ReaderButtons(HWND frame)
{
    std::vector<HWND> children;
    EnumChildWindows(
        frame,
        [](HWND child, LPARAM list) -> BOOL {
            reinterpret_cast<std::vector<HWND>*>(list)->push_back(child);
            return TRUE;
        },
        reinterpret_cast<LPARAM>(&children));
    std::vector<ReaderButton> buttons;
    VARIANT self;
    self.vt = VT_I4;
    self.lVal = CHILDID_SELF;
    for (const HWND child : children) {
        IAccessible* accessible = nullptr;
        if (FAILED(AccessibleObjectFromWindow(child, DWORD(OBJID_CLIENT), __uuidof(IAccessible),
                                              reinterpret_cast<void**>(&accessible))))
            continue;
        VARIANT role;
        VariantInit(&role);
        BSTR name = nullptr, action = nullptr;
        if (accessible->get_accRole(self, &role) == S_OK && role.vt == VT_I4 &&
            role.lVal == ROLE_SYSTEM_PUSHBUTTON && accessible->get_accName(self, &name) == S_OK &&
            accessible->get_accDefaultAction(self, &action) == S_OK) {
            buttons.push_back(
                {wxString(name).utf8_string(), wxString(action).utf8_string(), accessible});
            accessible = nullptr;
        }
        SysFreeString(name);
        SysFreeString(action);
        VariantClear(&role);
        if (accessible)
            accessible->Release();
    }
    return buttons;
}
