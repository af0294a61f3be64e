// The executable's Windows resources: enumerate, find and read them. On Linux
// they are a .res image from windres that the build stores in the ELF section
// ".rsrc"; every read of such an image is bounds-checked, and a malformed image
// yields the entries before the fault, never a crash.
#pragma once

#include <cstddef>
#include <cstdint>
#include <fstream>
#include <memory>
#include <string>
#include <vector>

// Standard resource types.
enum : std::uint16_t
{
    ResourceTypeIcon = 3,
    ResourceTypeRcData = 10,
    ResourceTypeGroupIcon = 14,
    ResourceTypeVersion = 16,
};

// A resource type or name: a number, or a string (UTF-8 here, UTF-16 in the image).
struct ResourceName
{
    bool numeric = true;
    std::uint16_t id = 0;
    std::string text;
};

struct ResourceEntry
{
    ResourceName type;
    ResourceName name;
    std::uint16_t language = 0;
    const unsigned char* data = nullptr;
    std::size_t size = 0;
};

// Random access to bytes of a file or a buffer; Read fails rather than reading short.
class ByteSource
{
public:
    virtual ~ByteSource() = default;
    virtual std::uint64_t Size() const = 0;
    virtual bool Read(std::uint64_t offset, void* out, std::size_t count) const = 0;
};

class MemoryByteSource : public ByteSource
{
public:
    MemoryByteSource(const unsigned char* data, std::size_t size) : m_data(data), m_size(size) {}
    std::uint64_t Size() const override { return m_size; }
    bool Read(std::uint64_t offset, void* out, std::size_t count) const override;

private:
    const unsigned char* m_data;
    std::size_t m_size;
};

// A file read in place; a file that cannot be opened has size 0.
class FileByteSource : public ByteSource
{
public:
    explicit FileByteSource(const std::string& path);
    std::uint64_t Size() const override { return m_size; }
    bool Read(std::uint64_t offset, void* out, std::size_t count) const override;

private:
    mutable std::ifstream m_file;
    std::uint64_t m_size = 0;
};

// A set of resources: a parsed .res image, or resources the system keeps loaded.
// An image owns its bytes, so entries stay valid as long as the image: finding a
// resource also loads and locks it, and nothing has to be freed.
class ResourceImage
{
public:
    ResourceImage() = default;
    explicit ResourceImage(std::vector<unsigned char> bytes);
    // Entries whose data the system keeps for the whole run, such as a loaded
    // module's own resources.
    explicit ResourceImage(std::vector<ResourceEntry> entries);
    // A .res image over bytes that `keeper` holds in place, such as a mapped section.
    ResourceImage(std::shared_ptr<const void> keeper, const unsigned char* data, std::size_t size);
    ResourceImage(const ResourceImage&) = delete;
    ResourceImage& operator=(const ResourceImage&) = delete;
    // Moving keeps the byte buffer, so entries stay valid.
    ResourceImage(ResourceImage&&) = default;
    ResourceImage& operator=(ResourceImage&&) = default;

    // The running executable's resources, read once per process; empty when
    // there are none.
    static const ResourceImage& OfExecutable();

    const std::vector<ResourceEntry>& Entries() const { return m_entries; }
    // String names of the resources of a numeric type, in image order.
    std::vector<std::string> Names(std::uint16_t type) const;
    // Names compare without regard to ASCII case, as on Windows.
    const ResourceEntry* Find(std::uint16_t type, const std::string& name) const;
    const ResourceEntry* Find(std::uint16_t type, std::uint16_t id) const;

private:
    void Parse();

    std::vector<unsigned char> m_bytes;
    std::shared_ptr<const void> m_keeper;
    const unsigned char* m_data = nullptr;
    std::size_t m_size = 0;
    std::vector<ResourceEntry> m_entries;
};
