#include "resources/ImageSets.h"

#include "resources/EmbeddedFiles.h"

#include <wx/filesys.h>
#include <wx/fs_mem.h>
#include <wx/image.h>
#include <wx/xrc/xh_bmp.h>
#include <wx/xrc/xmlres.h>

namespace {

void AddImageHandlers()
{
    wxImage::AddHandler(new wxPNGHandler);
    wxXmlResource::Get()->AddHandler(new wxBitmapXmlHandler);
    wxImage::AddHandler(new wxICOHandler);
    wxXmlResource::Get()->AddHandler(new wxIconXmlHandler);
}

// Makes sure the memory file system answers, adding its handler when it does not.
void EnsureMemoryFileSystem()
{
    const wxString probe = "XRC_resource/dummy_file";
    wxMemoryFSHandler::AddFile(probe, wxString("dummy one"));
    wxFileSystem fs;
    wxFSFile* file = fs.OpenFile("memory:" + probe);
    wxMemoryFSHandler::RemoveFile(probe);
    if (file)
        delete file;
    else
        wxFileSystem::AddHandler(new wxMemoryFSHandler);
}

void EnsureSet(bool& registered, void (*registerSet)())
{
    if (registered)
        return;
    AddImageHandlers();
    registerSet();
    registered = true;
}

bool launcherImagesRegistered = false;
bool helpImagesRegistered = false;
bool commonImagesRegistered = false;

} // namespace

void RegisterImageSet(const EmbeddedImageSet& set)
{
    EnsureMemoryFileSystem();
    const wxString prefix = wxString("XRC_resource/") + set.stem + "$";
    for (size_t i = 0; i < set.count; ++i)
        wxMemoryFSHandler::AddFile(prefix + set.files[i].name, set.files[i].data,
                                   set.files[i].size);
    if (set.count > 0)
        wxXmlResource::Get()->Load("memory:" + prefix + set.files[set.count - 1].name);
}

void RegisterLauncherImages()
{
    RegisterImageSet(Veltro3AppFrameImages());
}
void RegisterHelpImages()
{
    RegisterImageSet(Veltro2AppFrameHelpImages());
}
void RegisterCommonImages()
{
    RegisterImageSet(CommonImages());
}

void EnsureLauncherImages()
{
    EnsureSet(launcherImagesRegistered, RegisterLauncherImages);
}
void EnsureHelpImages()
{
    EnsureSet(helpImagesRegistered, RegisterHelpImages);
}
void EnsureCommonImages()
{
    EnsureSet(commonImagesRegistered, RegisterCommonImages);
}
