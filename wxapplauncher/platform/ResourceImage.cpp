#include "platform/ResourceImage.h"

#include "platform/LittleEndian.h"

#include <cstring>
#include <fstream>

namespace {

// Appends one code point as UTF-8.
void AppendUtf8(std::string& out, std::uint32_t cp)
{
    if (cp < 0x80) {
        out += char(cp);
    } else if (cp < 0x800) {
        out += char(0xC0 | cp >> 6);
        out += char(0x80 | (cp & 0x3F));
    } else if (cp < 0x10000) {
        out += char(0xE0 | cp >> 12);
        out += char(0x80 | (cp >> 6 & 0x3F));
        out += char(0x80 | (cp & 0x3F));
    } else {
        out += char(0xF0 | cp >> 18);
        out += char(0x80 | (cp >> 12 & 0x3F));
        out += char(0x80 | (cp >> 6 & 0x3F));
        out += char(0x80 | (cp & 0x3F));
    }
}

// Reads a type or name field of a resource header at pos (before end); advances pos.
bool ReadNameField(const unsigned char* base, std::size_t& pos, std::size_t end, ResourceName& name)
{
    if (end - pos < 2)
        return false;
    if (Le16(base + pos) == 0xFFFF) {
        if (end - pos < 4)
            return false;
        name.numeric = true;
        name.id = Le16(base + pos + 2);
        pos += 4;
        return true;
    }
    name.numeric = false;
    name.text.clear();
    for (;;) {
        if (end - pos < 2)
            return false;
        std::uint32_t unit = Le16(base + pos);
        pos += 2;
        if (unit == 0)
            return true;
        if (unit >= 0xD800 && unit < 0xDC00 && end - pos >= 2) {
            const std::uint32_t low = Le16(base + pos);
            if (low >= 0xDC00 && low < 0xE000) {
                pos += 2;
                unit = 0x10000 + ((unit - 0xD800) << 10) + (low - 0xDC00);
            }
        }
        if (unit >= 0xD800 && unit < 0xE000)
            unit = 0xFFFD;
        AppendUtf8(name.text, unit);
    }
}

bool SameNameIgnoringAsciiCase(const std::string& a, const std::string& b)
{
    if (a.size() != b.size())
        return false;
    for (std::size_t i = 0; i < a.size(); ++i) {
        unsigned char x = a[i], y = b[i];
        if (x >= 'a' && x <= 'z')
            x -= 'a' - 'A';
        if (y >= 'a' && y <= 'z')
            y -= 'a' - 'A';
        if (x != y)
            return false;
    }
    return true;
}

} // namespace

FileByteSource::FileByteSource(const std::string& path) : m_file(path, std::ios::binary)
{
    if (m_file) {
        m_file.seekg(0, std::ios::end);
        const std::streamoff end = m_file.tellg();
        m_size = end > 0 ? std::uint64_t(end) : 0;
    }
}

bool FileByteSource::Read(std::uint64_t offset, void* out, std::size_t count) const
{
    if (offset > m_size || count > m_size - offset)
        return false;
    m_file.clear();
    m_file.seekg(std::streamoff(offset));
    m_file.read(static_cast<char*>(out), std::streamsize(count));
    return m_file.gcount() == std::streamsize(count);
}

bool MemoryByteSource::Read(std::uint64_t offset, void* out, std::size_t count) const
{
    if (offset > m_size || count > m_size - offset)
        return false;
    if (count)
        std::memcpy(out, m_data + offset, count);
    return true;
}

ResourceImage::ResourceImage(std::vector<unsigned char> bytes)
    : m_bytes(std::move(bytes)), m_data(m_bytes.data()), m_size(m_bytes.size())
{
    Parse();
}

ResourceImage::ResourceImage(std::shared_ptr<const void> keeper, const unsigned char* data,
                             std::size_t size)
    : m_keeper(std::move(keeper)), m_data(data), m_size(size)
{
    Parse();
}

ResourceImage::ResourceImage(std::vector<ResourceEntry> entries) : m_entries(std::move(entries)) {}

// Each entry: data size, header size, type, name (each 0xFFFF + number or a
// NUL-terminated UTF-16 string), padding to 4, then data version, memory flags,
// language, version and characteristics; the data follows, padded to 4.
void ResourceImage::Parse()
{
    const unsigned char* base = m_data;
    const std::size_t size = m_size;
    std::size_t pos = 0;
    while (size - pos >= 8) {
        const std::uint32_t dataSize = Le32(base + pos);
        const std::uint32_t headerSize = Le32(base + pos + 4);
        if (headerSize < 32 || headerSize > size - pos || dataSize > size - pos - headerSize)
            return;
        const std::size_t headerEnd = pos + headerSize;
        std::size_t field = pos + 8;
        ResourceEntry entry;
        if (!ReadNameField(base, field, headerEnd, entry.type) ||
            !ReadNameField(base, field, headerEnd, entry.name))
            return;
        field = (field - pos + 3) / 4 * 4 + pos;
        if (field > headerEnd || headerEnd - field < 16)
            return;
        entry.language = Le16(base + field + 6);
        entry.data = base + headerEnd;
        entry.size = dataSize;
        // The image starts with an empty entry that only marks the format.
        if (!(dataSize == 0 && entry.type.numeric && entry.type.id == 0))
            m_entries.push_back(entry);
        const std::size_t next = headerEnd + dataSize;
        const std::size_t padded = (next - pos + 3) / 4 * 4 + pos;
        pos = padded < size ? padded : size;
    }
}

std::vector<std::string> ResourceImage::Names(std::uint16_t type) const
{
    std::vector<std::string> names;
    for (const ResourceEntry& e : m_entries)
        if (e.type.numeric && e.type.id == type && !e.name.numeric)
            names.push_back(e.name.text);
    return names;
}

const ResourceEntry* ResourceImage::Find(std::uint16_t type, const std::string& name) const
{
    for (const ResourceEntry& e : m_entries)
        if (e.type.numeric && e.type.id == type && !e.name.numeric &&
            SameNameIgnoringAsciiCase(e.name.text, name))
            return &e;
    return nullptr;
}

const ResourceEntry* ResourceImage::Find(std::uint16_t type, std::uint16_t id) const
{
    for (const ResourceEntry& e : m_entries)
        if (e.type.numeric && e.type.id == type && e.name.numeric && e.name.id == id)
            return &e;
    return nullptr;
}
