// The suite's common dialog base: a toolkit dialog built in two steps.
#pragma once

#include <wx/dialog.h>

class ZelCommonDlg : public wxDialog
{
public:
    ZelCommonDlg() = default;
};
