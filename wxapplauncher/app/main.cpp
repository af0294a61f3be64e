// Entry point of the launcher: the toolkit creates the application object.
#include "app/Veltro3App.h"

wxIMPLEMENT_APP(Veltro3App);
