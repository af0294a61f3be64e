// Version information of the installed modules (Help > About Modules).
#pragma once

// Shows the information window for the About Modules command id (1025-1030).
void ShowModuleInfo(int commandId);
