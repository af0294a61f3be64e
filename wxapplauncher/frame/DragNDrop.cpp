#include "frame/DragNDrop.h"

#include "frame/Veltro3MainAppStandardView.h"

#include <wx/filename.h>

DragNDrop::DragNDrop(Veltro3MainAppStandardView* view, int moduleId)
    : m_view(view), m_moduleId(moduleId)
{
}

DragNDrop::~DragNDrop() = default;

bool DragNDrop::OnDropFiles(wxCoord, wxCoord, const wxArrayString& filenames)
{
    // Only the first file is opened; the drop counts as accepted in any case.
    if (!filenames.empty())
        m_view->LaunchModule(m_moduleId, wxFileName(filenames[0]).GetFullPath());
    return true;
}
