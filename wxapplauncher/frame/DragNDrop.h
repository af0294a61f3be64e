// Drop target of the Inspect button: a dropped file opens in the Inspect module.
#pragma once

#include <wx/dnd.h>

class Veltro3MainAppStandardView;

class DragNDrop : public wxFileDropTarget
{
public:
    DragNDrop(Veltro3MainAppStandardView* view, int moduleId);
    ~DragNDrop() override;

    bool OnDropFiles(wxCoord x, wxCoord y, const wxArrayString& filenames) override;

private:
    Veltro3MainAppStandardView* m_view;
    int m_moduleId;
};
