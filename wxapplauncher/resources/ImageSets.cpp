#include "resources/ImageSets.h"

#include "platform/DisplayScale.h"
#include "resources/EmbeddedFiles.h"

#include <wx/filesys.h>
#include <wx/fs_mem.h>
#include <wx/image.h>
#include <wx/mstream.h>
#include <wx/xml/xml.h>
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

// The 2x rendering beside the file a resource name stands for; invalid when there is none.
wxBitmap LoadDoubledRendering(const wxString& name)
{
    const wxXmlNode* node = wxXmlResource::Get()->GetResourceNode(name);
    if (!node)
        return wxBitmap();
    const wxString path = node->GetNodeContent().Strip(wxString::both);
    wxString stem = path.BeforeFirst('$'), base;
    if (!path.AfterFirst('$').EndsWith(".png", &base))
        return wxBitmap();
    const wxString doubled = base + "@2x.png";
    for (const EmbeddedImageSet& set :
         {Veltro3AppFrameImages(), Veltro2AppFrameHelpImages(), CommonImages()}) {
        if (stem != set.stem)
            continue;
        for (size_t i = 0; i < set.scaledCount; ++i) {
            if (doubled != set.scaled[i].name)
                continue;
            wxMemoryInputStream stream(set.scaled[i].data, set.scaled[i].size);
            const wxImage image(stream, wxBITMAP_TYPE_PNG);
            return image.IsOk() ? ScaledBitmap(image, 2.0) : wxBitmap();
        }
    }
    return wxBitmap();
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

wxBitmapBundle LoadPictureBundle(const wxString& name, double scale)
{
    const wxBitmap picture = wxXmlResource::Get()->LoadBitmap(name);
    if (!picture.IsOk())
        return wxBitmapBundle();
    // A 1x display never decodes the larger rendering.
    const wxBitmap doubled = scale > 1 ? LoadDoubledRendering(name) : wxBitmap();
    if (!doubled.IsOk() || doubled.GetSize() != picture.GetSize() * 2)
        return wxBitmapBundle::FromBitmap(picture);
    return wxBitmapBundle::FromBitmaps(picture, doubled);
}

wxBitmap LoadPicture(const wxString& name, double scale)
{
    const wxBitmapBundle bundle = LoadPictureBundle(name, scale);
    const wxSize size = bundle.GetDefaultSize();
    return bundle.GetBitmap(scale > 1 ? size * scale : size);
}
