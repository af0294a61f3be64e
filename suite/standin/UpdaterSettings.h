// What the updater stand-in reads from the settings it shares with the
// launcher: the value of "Silent", as the real updater would find it.
#pragma once

#include <optional>
#include <string>

namespace standin {

// "Silent" from the user's settings, else from the system-wide ones, found as
// the launcher finds them (files, or the registry), as text: a number in
// decimal. Empty when neither has it.
std::optional<std::string> FindSilentSetting();

} // namespace standin
