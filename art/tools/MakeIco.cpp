// Build tool: writes a Windows icon file from rendered PNG images, each stored as
// an uncompressed DIB at the depth asked for (8 bits with a palette, or 32 bits BGRA).
// Usage: MakeIco <out.ico> <bits>:<image.png>...

#include <wx/image.h>
#include <wx/init.h>

#include <algorithm>
#include <array>
#include <cstdint>
#include <cstdio>
#include <map>
#include <string>
#include <vector>

namespace {

using Bytes = std::vector<uint8_t>;
using Rgb = std::array<uint8_t, 3>;

void Put16(Bytes& out, unsigned v)
{
    out.push_back(v & 0xff);
    out.push_back((v >> 8) & 0xff);
}

void Put32(Bytes& out, uint32_t v)
{
    Put16(out, v & 0xffff);
    Put16(out, v >> 16);
}

// An 8-bit image has no alpha: pixels at least half covered are drawn, the rest masked.
bool Visible(const wxImage& img, int x, int y, int bits)
{
    const int a = img.HasAlpha() ? img.GetAlpha(x, y) : 255;
    return bits == 32 ? a > 0 : a >= 128;
}

void PutHeader(Bytes& out, int size, int bits, uint32_t imageBytes)
{
    Put32(out, 40);
    Put32(out, size);
    Put32(out, 2 * size); // colour rows plus mask rows
    Put16(out, 1);
    Put16(out, bits);
    Put32(out, 0); // BI_RGB
    Put32(out, imageBytes);
    Put32(out, 0);
    Put32(out, 0);
    Put32(out, 0);
    Put32(out, 0);
}

int MaskStride(int size)
{
    return ((size + 31) / 32) * 4;
}

// Rows run bottom-up; a set bit lets the screen show through.
void PutMask(Bytes& out, const wxImage& img, int bits)
{
    const int size = img.GetWidth();
    for (int y = size - 1; y >= 0; --y) {
        Bytes row(MaskStride(size), 0);
        for (int x = 0; x < size; ++x)
            if (!Visible(img, x, y, bits))
                row[x / 8] |= 0x80 >> (x % 8);
        out.insert(out.end(), row.begin(), row.end());
    }
}

struct Tally
{
    Rgb rgb;
    uint32_t count;
};

// Median cut: split the box with the widest channel range at its weighted median
// until the palette is full or no box holds more than one colour.
std::vector<Rgb> MedianCut(std::vector<Tally> colours, size_t maxColours)
{
    struct Box
    {
        size_t begin, end;
    };
    auto widest = [&](const Box& b, int& channel) {
        int best = -1;
        for (int c = 0; c < 3; ++c) {
            uint8_t lo = 255, hi = 0;
            for (size_t i = b.begin; i < b.end; ++i) {
                lo = std::min(lo, colours[i].rgb[c]);
                hi = std::max(hi, colours[i].rgb[c]);
            }
            if (hi - lo > best) {
                best = hi - lo;
                channel = c;
            }
        }
        return best;
    };
    std::vector<Box> boxes;
    if (!colours.empty())
        boxes.push_back({0, colours.size()});
    while (boxes.size() < maxColours) {
        int bestRange = 0, channel = 0;
        size_t pick = boxes.size();
        for (size_t i = 0; i < boxes.size(); ++i) {
            int c = 0;
            const int range = boxes[i].end - boxes[i].begin > 1 ? widest(boxes[i], c) : 0;
            if (range > bestRange) {
                bestRange = range;
                channel = c;
                pick = i;
            }
        }
        if (pick == boxes.size())
            break;
        Box& box = boxes[pick];
        std::sort(colours.begin() + box.begin, colours.begin() + box.end,
                  [channel](const Tally& a, const Tally& b) {
                      if (a.rgb[channel] != b.rgb[channel])
                          return a.rgb[channel] < b.rgb[channel];
                      return a.rgb < b.rgb;
                  });
        uint64_t total = 0, run = 0;
        for (size_t i = box.begin; i < box.end; ++i)
            total += colours[i].count;
        size_t split = box.begin + 1;
        for (size_t i = box.begin; i < box.end - 1; ++i) {
            run += colours[i].count;
            split = i + 1;
            if (2 * run >= total)
                break;
        }
        boxes.push_back({split, box.end});
        boxes[pick].end = split;
    }
    std::vector<Rgb> palette;
    for (const Box& b : boxes) {
        uint64_t sum[3] = {0, 0, 0}, n = 0;
        for (size_t i = b.begin; i < b.end; ++i) {
            for (int c = 0; c < 3; ++c)
                sum[c] += uint64_t(colours[i].rgb[c]) * colours[i].count;
            n += colours[i].count;
        }
        palette.push_back({uint8_t((sum[0] + n / 2) / n), uint8_t((sum[1] + n / 2) / n),
                           uint8_t((sum[2] + n / 2) / n)});
    }
    return palette;
}

size_t Nearest(const std::vector<Rgb>& palette, size_t first, const Rgb& rgb)
{
    size_t best = first;
    int bestDist = 1 << 30;
    for (size_t i = first; i < palette.size(); ++i) {
        int d = 0;
        for (int c = 0; c < 3; ++c)
            d += (palette[i][c] - rgb[c]) * (palette[i][c] - rgb[c]);
        if (d < bestDist) {
            bestDist = d;
            best = i;
        }
    }
    return best;
}

Rgb PixelOf(const wxImage& img, int x, int y)
{
    return {img.GetRed(x, y), img.GetGreen(x, y), img.GetBlue(x, y)};
}

// Entry 0 is black: masked pixels must be black so that AND/XOR drawing leaves the screen.
Bytes Encode8(const wxImage& img)
{
    const int size = img.GetWidth();
    std::map<Rgb, uint32_t> counts;
    for (int y = 0; y < size; ++y)
        for (int x = 0; x < size; ++x)
            if (Visible(img, x, y, 8))
                ++counts[PixelOf(img, x, y)];
    std::vector<Tally> colours;
    for (const auto& [rgb, n] : counts)
        colours.push_back({rgb, n});
    std::vector<Rgb> palette{{0, 0, 0}};
    for (const Rgb& rgb : MedianCut(colours, 255))
        palette.push_back(rgb);

    const int stride = (size + 3) & ~3;
    Bytes out;
    PutHeader(out, size, 8, (stride + MaskStride(size)) * size);
    for (int i = 0; i < 256; ++i) {
        const Rgb rgb = i < int(palette.size()) ? palette[i] : Rgb{0, 0, 0};
        out.insert(out.end(), {rgb[2], rgb[1], rgb[0], 0});
    }
    for (int y = size - 1; y >= 0; --y) {
        Bytes row(stride, 0);
        for (int x = 0; x < size; ++x)
            if (Visible(img, x, y, 8))
                row[x] = Nearest(palette, 1, PixelOf(img, x, y));
        out.insert(out.end(), row.begin(), row.end());
    }
    PutMask(out, img, 8);
    return out;
}

Bytes Encode32(const wxImage& img)
{
    const int size = img.GetWidth();
    Bytes out;
    PutHeader(out, size, 32, (4 * size + MaskStride(size)) * size);
    for (int y = size - 1; y >= 0; --y)
        for (int x = 0; x < size; ++x) {
            const uint8_t a = img.HasAlpha() ? img.GetAlpha(x, y) : 255;
            if (a == 0)
                out.insert(out.end(), {0, 0, 0, 0});
            else
                out.insert(out.end(), {img.GetBlue(x, y), img.GetGreen(x, y), img.GetRed(x, y), a});
        }
    PutMask(out, img, 32);
    return out;
}

} // namespace

int main(int argc, char** argv)
{
    wxInitializer init;
    if (!init.IsOk() || argc < 3) {
        std::fprintf(stderr, "usage: MakeIco <out.ico> <bits>:<image.png>...\n");
        return 2;
    }
    wxImage::AddHandler(new wxPNGHandler);

    std::vector<int> sizes, depths;
    std::vector<Bytes> images;
    for (int i = 2; i < argc; ++i) {
        const std::string arg = argv[i];
        const size_t colon = arg.find(':');
        const std::string bits = arg.substr(0, colon);
        if (colon == std::string::npos || (bits != "8" && bits != "32")) {
            std::fprintf(stderr, "MakeIco: expected 8:<png> or 32:<png>, got %s\n", argv[i]);
            return 2;
        }
        wxImage img;
        const std::string path = arg.substr(colon + 1);
        if (!img.LoadFile(wxString::FromUTF8(path), wxBITMAP_TYPE_PNG) ||
            img.GetWidth() != img.GetHeight() || img.GetWidth() > 256) {
            std::fprintf(stderr, "MakeIco: %s is not a square PNG of at most 256 pixels\n",
                         path.c_str());
            return 1;
        }
        depths.push_back(std::stoi(bits));
        sizes.push_back(img.GetWidth());
        images.push_back(depths.back() == 8 ? Encode8(img) : Encode32(img));
    }

    Bytes ico;
    Put16(ico, 0);
    Put16(ico, 1); // icon, not cursor
    Put16(ico, images.size());
    uint32_t offset = 6 + 16 * images.size();
    for (size_t i = 0; i < images.size(); ++i) {
        ico.push_back(sizes[i] & 0xff); // 256 is stored as 0
        ico.push_back(sizes[i] & 0xff);
        ico.push_back(0); // 0: 256 colours or more
        ico.push_back(0);
        Put16(ico, 1);
        Put16(ico, depths[i]);
        Put32(ico, images[i].size());
        Put32(ico, offset);
        offset += images[i].size();
    }
    for (const Bytes& img : images)
        ico.insert(ico.end(), img.begin(), img.end());

    FILE* file = std::fopen(argv[1], "wb");
    const bool written = file && std::fwrite(ico.data(), 1, ico.size(), file) == ico.size();
    if (!file || std::fclose(file) != 0 || !written) {
        std::fprintf(stderr, "MakeIco: cannot write %s\n", argv[1]);
        std::remove(argv[1]);
        return 1;
    }
    return 0;
}
