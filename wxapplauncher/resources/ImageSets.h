// The three embedded image sets, registered once per process into the memory file system.
#pragma once

struct EmbeddedImageSet;

void RegisterLauncherImages();
void RegisterHelpImages();
void RegisterCommonImages();

// Guarded forms: add the image handlers and register the set on first use only.
void EnsureLauncherImages();
void EnsureHelpImages();
void EnsureCommonImages();

// Adds a set's files under "XRC_resource/<stem>$<file>" and loads its XRC document.
void RegisterImageSet(const EmbeddedImageSet& set);
