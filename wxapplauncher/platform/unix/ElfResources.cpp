#include "platform/unix/ElfResources.h"

#include "platform/LittleEndian.h"
#include "platform/PeResource.h"
#include "platform/ResourceImage.h"

#include <cstring>
#include <limits>
#include <utility>

#include <fcntl.h>
#include <sys/mman.h>
#include <unistd.h>

bool FindElfSection(const ByteSource& source, const std::string& sectionName, std::uint64_t& offset,
                    std::uint64_t& size)
{
    unsigned char ident[64];
    static const unsigned char magic[4] = {0x7F, 'E', 'L', 'F'};
    if (!source.Read(0, ident, 16) || std::memcmp(ident, magic, 4) != 0)
        return false;
    const bool is64 = ident[4] == 2;
    if ((ident[4] != 1 && !is64) || ident[5] != 1)
        return false;
    const std::size_t headerSize = is64 ? 64 : 52;
    if (!source.Read(0, ident, headerSize))
        return false;
    const std::uint64_t shoff = is64 ? Le64(ident + 0x28) : Le32(ident + 0x20);
    const unsigned entrySize = Le16(ident + (is64 ? 0x3A : 0x2E));
    const unsigned count = Le16(ident + (is64 ? 0x3C : 0x30));
    const unsigned namesIndex = Le16(ident + (is64 ? 0x3E : 0x32));
    const unsigned minEntry = is64 ? 64 : 40;
    if (entrySize < minEntry || count == 0 || namesIndex >= count)
        return false;
    if (shoff > source.Size() || std::uint64_t(entrySize) * count > source.Size() - shoff)
        return false;

    struct Section
    {
        std::uint32_t name, type;
        std::uint64_t offset, size;
    };
    auto readSection = [&](unsigned index, Section& s) {
        unsigned char raw[64];
        if (!source.Read(shoff + std::uint64_t(index) * entrySize, raw, minEntry))
            return false;
        s.name = Le32(raw);
        s.type = Le32(raw + 4);
        s.offset = is64 ? Le64(raw + 0x18) : Le32(raw + 0x10);
        s.size = is64 ? Le64(raw + 0x20) : Le32(raw + 0x14);
        return true;
    };

    Section names;
    if (!readSection(namesIndex, names) || names.offset > source.Size() ||
        names.size > source.Size() - names.offset)
        return false;
    const std::uint32_t noBits = 8;
    for (unsigned i = 0; i < count; ++i) {
        Section s;
        if (!readSection(i, s) || s.name >= names.size)
            continue;
        // Compare the name in place, one byte more to see its terminator.
        const std::uint64_t want = sectionName.size() + 1;
        if (names.size - s.name < want)
            continue;
        std::string candidate(sectionName.size() + 1, '\0');
        if (!source.Read(names.offset + s.name, &candidate[0], candidate.size()) ||
            candidate.compare(0, sectionName.size(), sectionName) != 0 || candidate.back() != '\0')
            continue;
        if (s.type == noBits || s.offset > source.Size() || s.size > source.Size() - s.offset ||
            s.size > std::numeric_limits<std::size_t>::max())
            return false;
        offset = s.offset;
        size = s.size;
        return true;
    }
    return false;
}

bool ReadElfSection(const ByteSource& source, const std::string& sectionName,
                    std::vector<unsigned char>& contents)
{
    std::uint64_t offset = 0, size = 0;
    if (!FindElfSection(source, sectionName, offset, size))
        return false;
    contents.resize(std::size_t(size));
    return source.Read(offset, contents.data(), contents.size());
}

bool ReadElfSectionOfFile(const std::string& path, const std::string& sectionName,
                          std::vector<unsigned char>& contents)
{
    return ReadElfSection(FileByteSource(path), sectionName, contents);
}

ResourceImage MapElfResources(const std::string& path)
{
    std::uint64_t offset = 0, size = 0;
    if (!FindElfSection(FileByteSource(path), ".rsrc", offset, size) || size == 0)
        return ResourceImage();
    // Mapped rather than read: only the pages of the resources in use are ever loaded,
    // and none of them is held twice.
    const int fd = open(path.c_str(), O_RDONLY | O_CLOEXEC);
    if (fd < 0)
        return ResourceImage();
    const std::uint64_t page = std::uint64_t(sysconf(_SC_PAGESIZE));
    const std::uint64_t start = offset / page * page;
    const std::size_t length = std::size_t(size + (offset - start));
    void* mapped = mmap(nullptr, length, PROT_READ, MAP_PRIVATE, fd, off_t(start));
    close(fd);
    if (mapped == MAP_FAILED)
        return ResourceImage();
    std::shared_ptr<const void> keeper(
        mapped, [length](const void* region) { munmap(const_cast<void*>(region), length); });
    return ResourceImage(std::move(keeper),
                         static_cast<const unsigned char*>(mapped) + (offset - start),
                         std::size_t(size));
}

const ResourceImage& ResourceImage::OfExecutable()
{
    static const ResourceImage image = MapElfResources("/proc/self/exe");
    return image;
}

VersionResourceResult ReadVersionResource(const std::string& path,
                                          std::vector<unsigned char>& block,
                                          std::size_t& fixedInfoOffset)
{
    return ReadVersionResource(FileByteSource(path), block, fixedInfoOffset);
}

VersionResourceResult ReadVersionResource(const ByteSource& source,
                                          std::vector<unsigned char>& block,
                                          std::size_t& fixedInfoOffset)
{
    block.clear();
    if (ReadPeResource(source, ResourceTypeVersion, kVersionResourceName, kMaxVersionBlock, block))
        return FindFixedFileInfo(block, fixedInfoOffset) ? VersionResourceResult::Found
                                                         : VersionResourceResult::Malformed;
    std::vector<unsigned char> section;
    if (!ReadElfSection(source, ".rsrc", section))
        return VersionResourceResult::Missing;
    return ReadVersionResource(ResourceImage(std::move(section)), block, fixedInfoOffset);
}
