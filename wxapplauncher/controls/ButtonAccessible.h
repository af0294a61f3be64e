// What screen readers see of an image button: a push button named by its
// label, with a "click" action. wx 3.2 on GTK has no accessibility layer of
// its own, so this answers through ATK for the button's GTK widget.
#pragma once

class ZelStaticBitmap;

// Makes `button` answer as a push button; `ForgetButton` before it goes.
void ExposeAsButton(ZelStaticBitmap* button);
void ForgetButton(ZelStaticBitmap* button);
