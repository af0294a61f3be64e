#include "resources/IconBundle.h"

#include "platform/IconResource.h"
#include "platform/ResourceIcon.h"
#include "platform/ResourceImage.h"

#include <wx/bitmap.h>
#include <wx/icon.h>
#include <wx/image.h>
#include <wx/log.h>
#include <wx/mstream.h>

#include <cstring>

wxImage DecodeIconResourceImage(const unsigned char* data, std::size_t size)
{
    const IconImage decoded = DecodeIconImage(data, size);
    wxImage image;
    if (decoded.kind == IconImage::Kind::Png) {
        if (!wxImage::FindHandler(wxBITMAP_TYPE_PNG))
            wxImage::AddHandler(new wxPNGHandler);
        wxMemoryInputStream stream(decoded.png, decoded.pngSize);
        wxLogNull quiet;
        image.LoadFile(stream, wxBITMAP_TYPE_PNG);
    } else if (decoded.kind == IconImage::Kind::Pixels) {
        image.Create(decoded.width, decoded.height, false);
        image.InitAlpha();
        unsigned char* rgb = image.GetData();
        unsigned char* alpha = image.GetAlpha();
        const size_t pixels = size_t(decoded.width) * size_t(decoded.height);
        for (size_t i = 0; i < pixels; ++i) {
            std::memcpy(rgb + i * 3, &decoded.rgba[i * 4], 3);
            alpha[i] = decoded.rgba[i * 4 + 3];
        }
    }
    return image;
}

namespace {

// The icon of one image resource at the size its group gives (0 meaning 256),
// or an invalid icon.
wxIcon CreateIconFromResource(const ResourceEntry& resource, const IconGroupEntry& entry)
{
    if (const std::optional<wxIcon> made =
            SystemIconFromResource(resource.data, resource.size, entry.width ? entry.width : 256,
                                   entry.height ? entry.height : 256))
        return *made;
    const wxImage image = DecodeIconResourceImage(resource.data, resource.size);
    wxIcon icon;
    if (image.IsOk())
        icon.CopyFromBitmap(wxBitmap(image));
    return icon;
}

} // namespace

wxIconBundle LoadIconBundle(const wxString& name, int depth)
{
    return LoadIconBundle(ResourceImage::OfExecutable(), name, depth);
}

wxIconBundle LoadIconBundle(const ResourceImage& image, const wxString& name, int depth)
{
    wxIconBundle bundle;
    const ResourceEntry* group = image.Find(ResourceTypeGroupIcon, std::string(name.utf8_str()));
    if (!group)
        return bundle;
    for (const IconGroupEntry& entry : ParseIconGroup(group->data, group->size)) {
        if (depth > 0 && entry.bitCount != depth)
            continue;
        const ResourceEntry* resource = image.Find(ResourceTypeIcon, entry.id);
        if (!resource)
            continue;
        // The group's byte count bounds the image, as it does on Windows.
        ResourceEntry bounded = *resource;
        if (entry.bytes < bounded.size)
            bounded.size = entry.bytes;
        const wxIcon icon = CreateIconFromResource(bounded, entry);
        if (icon.IsOk())
            bundle.AddIcon(icon);
    }
    return bundle;
}
