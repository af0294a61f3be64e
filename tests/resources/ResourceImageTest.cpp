// The resource reader over the real executable and over damaged images.
#include "platform/ResourceImage.h"
#include "platform/IconResource.h"
#include "resources/ResourceTestKit.h"

#include <gtest/gtest.h>

#include <cstring>

namespace {

const char* const catalogueNames[] = {"DE/VELTRO.MO", "EN/VELTRO.MO", "ES/VELTRO.MO",
                                      "FR/VELTRO.MO", "IT/VELTRO.MO", "JA/VELTRO.MO",
                                      "NL/VELTRO.MO", "PT/VELTRO.MO", "ZH_CN/VELTRO.MO"};

std::vector<unsigned char> ExecutableSection()
{
    std::vector<unsigned char> bytes;
    EXPECT_TRUE(ReadElfSectionOfFile("/proc/self/exe", ".rsrc", bytes));
    return bytes;
}

bool Contains(const ResourceEntry& e, const std::u16string& text)
{
    const std::size_t bytes = text.size() * 2;
    for (std::size_t i = 0; i + bytes <= e.size; i += 2)
        if (std::memcmp(e.data + i, text.data(), bytes) == 0)
            return true;
    return false;
}

} // namespace

TEST(ResourceImage, ExecutableCarriesCataloguesIconGroupAndVersion)
{
    const ResourceImage& image = ResourceImage::OfExecutable();
    EXPECT_EQ(image.Names(ResourceTypeRcData),
              std::vector<std::string>(std::begin(catalogueNames), std::end(catalogueNames)));
    ASSERT_NE(image.Find(ResourceTypeRcData, "zh_cn/veltro.mo"), nullptr) << "names ignore case";

    const ResourceEntry* group = image.Find(ResourceTypeGroupIcon, "IDI_ICON1");
    ASSERT_NE(group, nullptr);
    const std::vector<IconGroupEntry> icons = ParseIconGroup(group->data, group->size);
    const int sizes[] = {48, 32, 16, 256, 128, 96, 80, 72, 64, 48, 32, 16};
    ASSERT_EQ(icons.size(), 12u);
    for (std::size_t i = 0; i < icons.size(); ++i) {
        SCOPED_TRACE(i);
        EXPECT_EQ(icons[i].width == 0 ? 256 : icons[i].width, sizes[i]);
        EXPECT_EQ(icons[i].bitCount, i < 3 ? 8 : 32);
        const ResourceEntry* icon = image.Find(ResourceTypeIcon, icons[i].id);
        ASSERT_NE(icon, nullptr);
        const IconImage decoded = DecodeIconImage(icon->data, icon->size);
        ASSERT_NE(decoded.kind, IconImage::Kind::Invalid);
        if (decoded.kind == IconImage::Kind::Pixels) {
            EXPECT_EQ(decoded.width, sizes[i]);
        }
    }

    const ResourceEntry* version = image.Find(ResourceTypeVersion, 1);
    ASSERT_NE(version, nullptr);
    for (const char16_t* text : {u"FileVersion", u"3.1.2.01", u"ProductVersion", u"Veltrona.exe",
                                 u"OriginalFilename", u"InternalName", u"FileDescription"})
        EXPECT_TRUE(Contains(*version, text)) << std::string(text, text + 3);
}

TEST(ResourceImage, TruncatedOrCorruptImagesKeepOnlyWholeEntries)
{
    const std::vector<unsigned char> full = ExecutableSection();
    const std::size_t fullCount = ResourceImage(full).Entries().size();
    ASSERT_GT(fullCount, 20u);
    for (std::size_t length = 0; length < full.size(); length += 1 + length / 7) {
        const std::vector<unsigned char> cut(full.begin(), full.begin() + long(length));
        const ResourceImage image(cut);
        EXPECT_LT(image.Entries().size(), fullCount);
    }
    // A header that claims more data than there is ends the image at that entry.
    ResBuilder res;
    res.Add(ResourceTypeRcData, "GOOD", {1, 2, 3}).Add(ResourceTypeRcData, "LOST", {4, 5});
    std::vector<unsigned char> bytes = res.Bytes();
    const std::size_t second =
        ResBuilder().Add(ResourceTypeRcData, "GOOD", {1, 2, 3}).Bytes().size();
    bytes[second + 3] = 0x7F;
    const ResourceImage damaged(bytes);
    ASSERT_EQ(damaged.Entries().size(), 1u);
    EXPECT_EQ(damaged.Entries()[0].name.text, "GOOD");
    EXPECT_EQ(damaged.Entries()[0].size, 3u);
    // A name without its terminator.
    std::vector<unsigned char> unterminated = ResBuilder().Add(10, "AB", {}).Bytes();
    std::fill(unterminated.begin() + 32 + 12, unterminated.end(), 'X');
    EXPECT_TRUE(ResourceImage(unterminated).Entries().empty());
}

TEST(ResourceImage, ElfSectionLookupRejectsDamagedFiles)
{
    std::vector<unsigned char> exe = ReadWholeFile("/proc/self/exe");
    std::vector<unsigned char> section;
    ASSERT_TRUE(ReadElfSection(MemoryByteSource(exe.data(), exe.size()), ".rsrc", section));
    EXPECT_EQ(section, ExecutableSection());
    EXPECT_FALSE(ReadElfSection(MemoryByteSource(exe.data(), exe.size()), ".rsrc2", section));
    EXPECT_FALSE(ReadElfSection(MemoryByteSource(exe.data(), exe.size()), ".rsr", section));
    // Cut before the section's data, and with the section headers pointing past the end.
    EXPECT_FALSE(ReadElfSection(MemoryByteSource(exe.data(), 4096), ".rsrc", section));
    std::vector<unsigned char> moved = exe;
    moved[0x28 + 7] = 0x40;
    EXPECT_FALSE(ReadElfSection(MemoryByteSource(moved.data(), moved.size()), ".rsrc", section));
    const unsigned char text[] = "not an executable at all, just text";
    EXPECT_FALSE(ReadElfSection(MemoryByteSource(text, sizeof text), ".rsrc", section));
    EXPECT_FALSE(ReadElfSectionOfFile("/nonexistent/Veltrona.exe", ".rsrc", section));
    EXPECT_TRUE(ResourceImage::FromElfFile("/nonexistent/Veltrona.exe").Entries().empty());
}

TEST(IconResource, DecodesPaletteAndAlphaBitmapsAndRejectsShortOnes)
{
    // 2 x 2 at 8 bits: palette of two colours, bottom row first, the mask hides one pixel.
    std::vector<unsigned char> dib(40, 0);
    dib[0] = 40, dib[4] = 2, dib[8] = 4, dib[12] = 1, dib[14] = 8, dib[32] = 2;
    const unsigned char palette[] = {0, 0, 255, 0, 255, 0, 0, 0}; // red, blue (BGRx)
    dib.insert(dib.end(), palette, palette + 8);
    const unsigned char colours[] = {1, 0, 0, 0, 0, 1, 0, 0}; // bottom: blue red, top: red blue
    dib.insert(dib.end(), colours, colours + 8);
    const unsigned char mask[] = {0x00, 0, 0, 0, 0x40, 0, 0, 0}; // top row, right pixel clear
    dib.insert(dib.end(), mask, mask + 8);

    const IconImage image = DecodeIconImage(dib.data(), dib.size());
    ASSERT_EQ(image.kind, IconImage::Kind::Pixels);
    ASSERT_EQ(image.width, 2);
    ASSERT_EQ(image.height, 2);
    const std::vector<unsigned char> expected = {255, 0, 0,   255, 0,   0, 255, 0,
                                                 0,   0, 255, 255, 255, 0, 0,   255};
    EXPECT_EQ(image.rgba, expected);

    for (std::size_t length = 0; length < dib.size(); ++length)
        EXPECT_EQ(DecodeIconImage(dib.data(), length).kind, IconImage::Kind::Invalid) << length;
    std::vector<unsigned char> huge = dib;
    huge[5] = 0x7F; // width far beyond any icon
    EXPECT_EQ(DecodeIconImage(huge.data(), huge.size()).kind, IconImage::Kind::Invalid);

    // 1 x 1 at 32 bits keeps its own alpha even without a mask.
    std::vector<unsigned char> rgba(40, 0);
    rgba[0] = 40, rgba[4] = 1, rgba[8] = 2, rgba[12] = 1, rgba[14] = 32;
    const unsigned char pixel[] = {10, 20, 30, 128};
    rgba.insert(rgba.end(), pixel, pixel + 4);
    const IconImage alpha = DecodeIconImage(rgba.data(), rgba.size());
    ASSERT_EQ(alpha.kind, IconImage::Kind::Pixels);
    EXPECT_EQ(alpha.rgba, (std::vector<unsigned char>{30, 20, 10, 128}));

    const unsigned char png[] = {0x89, 'P', 'N', 'G', '\r', '\n', 0x1A, '\n', 0, 0};
    EXPECT_EQ(DecodeIconImage(png, sizeof png).kind, IconImage::Kind::Png);
}

TEST(IconResource, GroupDirectoryDropsEntriesPastItsEnd)
{
    std::vector<unsigned char> group = {0, 0, 1, 0, 3, 0};
    for (int i = 0; i < 3; ++i) {
        const unsigned char entry[14] = {
            16, 16, 0, 0, 1, 0, 32, 0, 100, 0, 0, 0, static_cast<unsigned char>(i + 1), 0};
        group.insert(group.end(), entry, entry + 14);
    }
    EXPECT_EQ(ParseIconGroup(group.data(), group.size()).size(), 3u);
    const std::vector<IconGroupEntry> cut = ParseIconGroup(group.data(), group.size() - 1);
    ASSERT_EQ(cut.size(), 2u);
    EXPECT_EQ(cut[1].id, 2);
    EXPECT_EQ(cut[1].bitCount, 32);
    group[2] = 2; // a cursor group, not an icon group
    EXPECT_TRUE(ParseIconGroup(group.data(), group.size()).empty());
}
