#include "controls/TextBitmap.h"

#include "platform/DisplayScale.h"

#include <wx/dcmemory.h>
#include <wx/image.h>

#include <algorithm>
#include <cmath>

namespace {

// Luminance weights, single precision as the artwork's tools use them.
const double kRed = 0.30f;
const double kGreen = 0.59f;
const double kBlue = 0.11f;
const int kSmallestFittedSize = 7;
const int kWidthReserve = 2;

struct Measured
{
    int widest = 0;
    int totalHeight = 0;
};

// An empty line keeps the height of a line but has no width.
wxSize LineExtent(wxDC& dc, const wxString& line)
{
    if (line.empty())
        return wxSize(0, dc.GetTextExtent("i").GetHeight());
    return dc.GetTextExtent(line);
}

Measured Measure(wxDC& dc, const wxArrayString& lines, int lineSpacing)
{
    Measured m;
    for (const wxString& line : lines) {
        const wxSize extent = LineExtent(dc, line);
        m.widest = std::max(m.widest, extent.GetWidth());
        m.totalHeight += extent.GetHeight() + lineSpacing;
    }
    return m;
}

int AnchorX(int x, int width, int alignment)
{
    if (x != -1)
        return x;
    if (alignment & wxALIGN_CENTER_HORIZONTAL)
        return width / 2;
    if (alignment & wxALIGN_RIGHT)
        return width;
    return 0;
}

// The room a line has beside its anchor: a label that starts right of an
// icon must fit between its anchor and the right edge.
int RoomForLines(int anchorX, int width, int alignment)
{
    if (alignment & wxALIGN_CENTER_HORIZONTAL)
        return 2 * std::min(anchorX, width - anchorX);
    if (alignment & wxALIGN_RIGHT)
        return anchorX;
    return width - anchorX;
}

// Shrinks `font` one point at a time, never below 7 points, until the widest line
// fits `room` with the reserve to spare (no room: no fitting); measures it at its size.
Measured Fit(wxDC& dc, wxFont& font, const wxArrayString& lines, int lineSpacing, int room)
{
    Measured m;
    for (int points = font.GetPointSize();; --points) {
        font.SetPointSize(points);
        dc.SetFont(font);
        m = Measure(dc, lines, lineSpacing);
        if (room < 0 || m.widest <= room - kWidthReserve || points - 1 < kSmallestFittedSize)
            return m;
    }
}

// A bitmap of `scale` whose memory DC has `units` (drawing units) of room.
wxBitmap NewBitmap(const wxSize& units, double scale)
{
    const double perDip = DrawingUnitsPerDip(scale);
    wxBitmap bitmap;
    bitmap.CreateWithDIPSize(wxSize(static_cast<int>(std::ceil(units.x / perDip)),
                                    static_cast<int>(std::ceil(units.y / perDip))),
                             scale);
    return bitmap;
}

int ToUnits(int dips, double perDip)
{
    return dips == -1 ? -1 : wxRound(dips * perDip);
}

} // namespace

wxFont FitFontToWidth(const wxFont& font, const wxArrayString& lines, int room, double scale)
{
    wxFont fitted(font);
    wxBitmap scratch(1, 1);
    wxMemoryDC dc(scratch);
    Fit(dc, fitted, lines, 0, ToUnits(room, DrawingUnitsPerDip(scale)));
    return fitted;
}

wxImage DrawTextLinesToImage(const wxSize& dipSize, const wxPoint& dipPosition, const wxFont& font,
                             const wxArrayString& lines, const wxColour& colour, int alignment,
                             int dipLineSpacing, double scale)
{
    // Measured and drawn in the memory DC's own units.
    const double perDip = DrawingUnitsPerDip(scale);
    const wxSize size(ToUnits(dipSize.x, perDip), ToUnits(dipSize.y, perDip));
    const wxPoint position(ToUnits(dipPosition.x, perDip), ToUnits(dipPosition.y, perDip));
    const int lineSpacing = ToUnits(dipLineSpacing, perDip);
    const double luminance = kGreen * colour.Green() + kRed * colour.Red() + kBlue * colour.Blue();
    const bool light = luminance >= 127.5;
    const wxColour textColour = light ? *wxWHITE : *wxBLACK;
    const wxColour backColour = light ? *wxBLACK : *wxWHITE;

    wxFont fitted(font);
    Measured m;
    {
        // Measured at the scale it is drawn at: glyphs are hinted per pixel.
        wxBitmap scratch = NewBitmap(wxSize(1, 1), scale);
        wxMemoryDC dc(scratch);
        const int room = size.GetWidth() == -1
                             ? -1
                             : RoomForLines(AnchorX(position.x, size.GetWidth(), alignment),
                                            size.GetWidth(), alignment);
        m = Fit(dc, fitted, lines, lineSpacing, room);
    }

    const int width = size.GetWidth() == -1 ? m.widest : size.GetWidth();
    const int height = size.GetHeight() == -1 ? m.totalHeight : size.GetHeight();
    if (width <= 0 || height <= 0)
        return wxImage();
    wxBitmap bitmap = NewBitmap(wxSize(width, height), scale);
    if (!bitmap.IsOk())
        return wxImage();

    {
        wxMemoryDC dc(bitmap);
        dc.SetBackground(wxBrush(backColour, wxBRUSHSTYLE_SOLID));
        dc.Clear();
        if (!lines.empty()) {
            dc.SetBackgroundMode(wxBRUSHSTYLE_TRANSPARENT);
            dc.SetTextForeground(textColour);
            dc.SetFont(fitted);
            const int x = AnchorX(position.x, width, alignment);
            int y = position.y;
            if (y == -1)
                y = (alignment & wxALIGN_CENTER_VERTICAL) ? height / 2
                    : (alignment & wxALIGN_BOTTOM)        ? height
                                                          : 0;
            if (alignment & wxALIGN_CENTER_VERTICAL)
                y -= m.totalHeight / 2;
            else if (alignment & wxALIGN_BOTTOM)
                y -= m.totalHeight;
            for (const wxString& line : lines) {
                const wxSize extent = LineExtent(dc, line);
                int lineX = x;
                if (alignment & wxALIGN_CENTER_HORIZONTAL)
                    lineX -= extent.GetWidth() / 2;
                else if (alignment & wxALIGN_RIGHT)
                    lineX -= extent.GetWidth();
                dc.DrawText(line, lineX, y);
                y += extent.GetHeight() + lineSpacing;
            }
        }
    }

    wxImage image = bitmap.ConvertToImage();
    // Released at once: a long text would otherwise be held three times over.
    bitmap = wxBitmap();
    if (!image.IsOk())
        return wxImage();
    if (!image.HasAlpha())
        image.InitAlpha();
    unsigned char* rgb = image.GetData();
    unsigned char* alpha = image.GetAlpha();
    const long pixels = static_cast<long>(image.GetWidth()) * image.GetHeight();
    for (long i = 0; i < pixels; ++i, rgb += 3) {
        const int v = static_cast<int>(kRed * rgb[0] + kGreen * rgb[1] + kBlue * rgb[2] + 0.5);
        alpha[i] = static_cast<unsigned char>(light ? v : 255 - v);
        rgb[0] = colour.Red();
        rgb[1] = colour.Green();
        rgb[2] = colour.Blue();
    }
    return image;
}

wxBitmap DrawTextLinesToBitmap(const wxSize& size, const wxPoint& position, const wxFont& font,
                               const wxArrayString& lines, const wxColour& colour, int alignment,
                               int lineSpacing, double scale)
{
    const wxImage image =
        DrawTextLinesToImage(size, position, font, lines, colour, alignment, lineSpacing, scale);
    return image.IsOk() ? ScaledBitmap(image, scale) : wxBitmap();
}

wxBitmap DrawTextToBitmap(const wxSize& size, const wxPoint& position, const wxFont& font,
                          const wxString& text, const wxColour& colour, int alignment,
                          int lineSpacing, double scale)
{
    wxArrayString lines;
    for (wxString rest = text; !rest.empty(); rest = rest.AfterFirst('\n'))
        lines.Add(rest.BeforeFirst('\n'));
    return DrawTextLinesToBitmap(size, position, font, lines, colour, alignment, lineSpacing,
                                 scale);
}

wxBitmap CompositeBitmap(const wxBitmap& base, const wxBitmap& overlay, const wxPoint& position)
{
    if (!base.IsOk() || !overlay.IsOk())
        return wxBitmap();
    // Physical pixels from here on.
    const double scale = base.GetScaleFactor();
    const wxPoint pos = position == wxDefaultPosition ? wxPoint(0, 0) : position * scale;
    const double overScale = scale / overlay.GetScaleFactor();
    const wxSize overSize(wxRound(overlay.GetWidth() * overScale),
                          wxRound(overlay.GetHeight() * overScale));
    const int left = std::max(pos.x, 0);
    const int top = std::max(pos.y, 0);
    const int right = std::min(base.GetWidth(), overSize.x + pos.x);
    const int bottom = std::min(base.GetHeight(), overSize.y + pos.y);
    const int fromX = std::max(-pos.x, 0);
    const int fromY = std::max(-pos.y, 0);
    if (right <= left || bottom <= top)
        return base;

    wxImage result = base.ConvertToImage();
    wxImage over = overlay.ConvertToImage();
    if (!result.IsOk() || !over.IsOk() || !result.GetData() || !over.GetData())
        return base;
    if (over.GetSize() != overSize)
        over.Rescale(overSize.x, overSize.y, wxIMAGE_QUALITY_HIGH);
    // A picture whose alpha is only 0 or 255 may come with a mask instead.
    if (!result.HasAlpha())
        result.InitAlpha();
    if (!over.HasAlpha())
        over.InitAlpha();

    const int baseWidth = result.GetWidth();
    const int overWidth = over.GetWidth();
    for (int y = top; y < bottom; ++y) {
        const long baseRow = static_cast<long>(y) * baseWidth;
        const long overRow = static_cast<long>(y - top + fromY) * overWidth;
        for (int x = left; x < right; ++x) {
            const long b = baseRow + x;
            const long o = overRow + x - left + fromX;
            unsigned char* bc = result.GetData() + 3 * b;
            const unsigned char* oc = over.GetData() + 3 * o;
            const float ao = over.GetAlpha()[o] / 255.0f;
            const float ab = result.GetAlpha()[b] / 255.0f;
            const float a = ao + ab * (1.0f - ao);
            if (a <= 0.0f) {
                bc[0] = bc[1] = bc[2] = 0;
                result.GetAlpha()[b] = 0;
                continue;
            }
            for (int c = 0; c < 3; ++c)
                bc[c] =
                    static_cast<unsigned char>((oc[c] * ao + bc[c] * ab * (1.0f - ao)) / a + 0.5f);
            result.GetAlpha()[b] = static_cast<unsigned char>(a * 255.0f + 0.5f);
        }
    }
    return ScaledBitmap(result, scale);
}

wxFont GetUIFont(int pointSize, int weight)
{
    int points = pointSize;
    int numericWeight = wxFONTWEIGHT_NORMAL;
    if (pointSize == -1 || weight == -1) {
        points = 12;
    } else if (weight == wxBOLD) {
        numericWeight = wxFONTWEIGHT_BOLD;
    } else if (weight == wxLIGHT) {
        numericWeight = wxFONTWEIGHT_LIGHT;
    } else if (weight != wxNORMAL && weight > 0 && weight <= 1000) {
        numericWeight = weight;
    }
    return wxFont(wxFontInfo(points)
                      .Family(wxFONTFAMILY_DEFAULT)
                      .Style(wxFONTSTYLE_NORMAL)
                      .FaceName("Tahoma")
                      .Underlined(false)
                      .Encoding(wxFONTENCODING_DEFAULT)
                      .Weight(numericWeight));
}

wxColour DarkOnPicture(const wxColour& colour)
{
    const double luminance = 0.30 * colour.Red() + 0.59 * colour.Green() + 0.11 * colour.Blue();
    return luminance < 127.5 ? colour : *wxBLACK;
}
