// Files compiled into the program by the build (see EmbedFiles.cmake): the pictures of
// one image set followed by its XRC document, and the pictures' 2x renderings.
#pragma once

#include <cstddef>

struct EmbeddedFile
{
    const char* name;
    const unsigned char* data;
    std::size_t size;
};

struct EmbeddedImageSet
{
    const char* stem;
    const EmbeddedFile* files; // pictures in table order, the XRC document last
    std::size_t count;
    const EmbeddedFile* scaled; // "<picture>@2x.png" for each picture
    std::size_t scaledCount;
};

// The generated units, one per set.
EmbeddedImageSet Veltro3AppFrameImages();
EmbeddedImageSet Veltro2AppFrameHelpImages();
EmbeddedImageSet CommonImages();
