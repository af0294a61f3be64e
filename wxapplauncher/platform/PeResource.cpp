#include "platform/PeResource.h"

#include "platform/LittleEndian.h"

namespace {

struct Section
{
    std::uint32_t virtualAddress, rawSize, rawOffset;
};

// The resource directory lives in one section; offsets inside it are relative to its start.
struct ResourceSection
{
    const ByteSource* source = nullptr;
    std::uint64_t fileOffset = 0;
    std::uint64_t size = 0; // file-backed bytes from the root on
    std::vector<Section> sections;

    bool Read(std::uint64_t offset, unsigned char* out, std::size_t count) const
    {
        return offset <= size && count <= size - offset &&
               source->Read(fileOffset + offset, out, count);
    }
};

// Maps an address of the loaded image to a file offset and the file-backed bytes from there.
bool MapRva(const std::vector<Section>& sections, std::uint32_t rva, std::uint64_t& offset,
            std::uint64_t& available)
{
    for (const Section& s : sections) {
        if (rva >= s.virtualAddress && rva - s.virtualAddress < s.rawSize) {
            offset = std::uint64_t(s.rawOffset) + (rva - s.virtualAddress);
            available = s.rawSize - (rva - s.virtualAddress);
            return true;
        }
    }
    return false;
}

// In the directory at dirOffset, the entry for id (or the first entry when any is true).
// The result is the entry's target offset; wantDirectory says which kind it must be.
bool FindEntry(const ResourceSection& rs, std::uint64_t dirOffset, std::uint16_t id, bool any,
               bool wantDirectory, std::uint32_t& target)
{
    unsigned char header[16];
    if (!rs.Read(dirOffset, header, sizeof header))
        return false;
    const unsigned named = Le16(header + 12), numbered = Le16(header + 14);
    const std::uint64_t count = std::uint64_t(named) + numbered;
    for (std::uint64_t i = any ? 0 : named; i < count; ++i) {
        unsigned char entry[8];
        if (!rs.Read(dirOffset + 16 + i * 8, entry, sizeof entry))
            return false;
        const std::uint32_t key = Le32(entry), value = Le32(entry + 4);
        if (!any && ((key & 0x80000000u) || (key & 0xFFFF) != id))
            continue;
        if (bool(value & 0x80000000u) != wantDirectory)
            return false;
        target = value & 0x7FFFFFFFu;
        return true;
    }
    return false;
}

} // namespace

bool ReadPeResource(const ByteSource& source, std::uint16_t type, std::uint16_t name,
                    std::size_t maxSize, std::vector<unsigned char>& data)
{
    unsigned char dos[64];
    if (!source.Read(0, dos, sizeof dos) || dos[0] != 'M' || dos[1] != 'Z')
        return false;
    const std::uint64_t pe = Le32(dos + 0x3C);
    unsigned char coff[24];
    if (!source.Read(pe, coff, sizeof coff) || Le32(coff) != 0x00004550u)
        return false;
    const unsigned sectionCount = Le16(coff + 6);
    const unsigned optionalSize = Le16(coff + 20);
    unsigned char optional[240] = {};
    if (optionalSize < 2 ||
        !source.Read(pe + 24, optional, optionalSize < 240 ? optionalSize : 240))
        return false;
    const unsigned magic = Le16(optional);
    if (magic != 0x10B && magic != 0x20B)
        return false;
    // The data directories follow the fixed fields; the resource directory is the third.
    const unsigned directories = magic == 0x20B ? 112 : 96;
    if (optionalSize < directories + 24 || Le32(optional + directories - 4) < 3)
        return false;
    const std::uint32_t resourceRva = Le32(optional + directories + 16);
    if (resourceRva == 0)
        return false;

    ResourceSection rs;
    rs.source = &source;
    const std::uint64_t sectionTable = pe + 24 + optionalSize;
    for (unsigned i = 0; i < sectionCount; ++i) {
        unsigned char raw[40];
        if (!source.Read(sectionTable + std::uint64_t(i) * 40, raw, sizeof raw))
            return false;
        // Bytes a section claims past the end of the file fail when they are read.
        rs.sections.push_back(Section{Le32(raw + 12), Le32(raw + 16), Le32(raw + 20)});
    }
    if (!MapRva(rs.sections, resourceRva, rs.fileOffset, rs.size))
        return false;

    // Exactly three levels: type, name, language; a directory can therefore never lead
    // back to itself, however its offsets point.
    std::uint32_t names, languages, dataEntry;
    if (!FindEntry(rs, 0, type, false, true, names) ||
        !FindEntry(rs, names, name, false, true, languages) ||
        !FindEntry(rs, languages, 0, true, false, dataEntry))
        return false;
    unsigned char entry[16];
    if (!rs.Read(dataEntry, entry, sizeof entry))
        return false;
    const std::uint32_t dataRva = Le32(entry);
    std::uint64_t size = Le32(entry + 4), offset, available;
    if (!MapRva(rs.sections, dataRva, offset, available) || size > available)
        return false;
    if (size > maxSize)
        size = maxSize;
    data.resize(std::size_t(size));
    return source.Read(offset, data.data(), data.size());
}
