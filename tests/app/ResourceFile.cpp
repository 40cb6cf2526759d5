#include "ResourceFile.h"

#include <map>

namespace gw {
namespace {

constexpr uint32_t kSectionAddress = 0x1000; // in memory
constexpr uint32_t kSectionOffset = 0x200;   // in the file
constexpr uint32_t kSubdirectory = 0x80000000;

void Put(std::string& bytes, size_t offset, uint64_t value, size_t byteCount)
{
    if (bytes.size() < offset + byteCount)
        bytes.resize(offset + byteCount);
    for (size_t i = 0; i < byteCount; ++i)
        bytes[offset + i] = static_cast<char>(value >> (8 * i) & 0xff);
}

void Append(std::string& bytes, uint64_t value, size_t byteCount)
{
    Put(bytes, bytes.size(), value, byteCount);
}

std::u16string Utf16(const std::string& text)
{
    std::u16string units;
    for (size_t i = 0; i < text.size(); ++i)
    {
        const auto byte = [&](size_t at) {
            return static_cast<uint32_t>(static_cast<unsigned char>(text[at]));
        };
        uint32_t point = byte(i);
        if (point >= 0xe0)
            point = (point & 0xf) << 12 | (byte(i + 1) & 0x3f) << 6 | (byte(i + 2) & 0x3f), i += 2;
        else if (point >= 0xc0)
            point = (point & 0x1f) << 6 | (byte(i + 1) & 0x3f), i += 1;
        units += static_cast<char16_t>(point);
    }
    return units;
}

// Sixteen counted strings.
std::string Block(const std::map<uint32_t, std::string>& strings)
{
    std::string bytes;
    for (uint32_t i = 0; i < 16; ++i)
    {
        const auto found = strings.find(i);
        const std::u16string units = found == strings.end() ? std::u16string() : Utf16(found->second);
        Append(bytes, static_cast<uint32_t>(units.size()), 2);
        for (const char16_t unit : units)
            Append(bytes, unit, 2);
    }
    return bytes;
}

void AppendDirectory(std::string& section, size_t entryCount)
{
    section.append(12, '\0');
    Append(section, 0, 2);
    Append(section, static_cast<uint32_t>(entryCount), 2);
}

using Blocks =
    std::map<uint32_t, std::map<uint32_t, std::map<uint32_t, std::string>>>; // block, language, index

std::string Section(const Blocks& blocks)
{
    std::string section;
    AppendDirectory(section, 1);
    Append(section, 6, 4);
    Append(section, kSubdirectory | 24, 4);
    AppendDirectory(section, blocks.size());
    const size_t table = section.size();
    section.append(8 * blocks.size(), '\0');
    size_t row = 0;
    for (const auto& [number, languages] : blocks)
    {
        Put(section, table + 8 * row, number, 4);
        Put(section, table + 8 * row++ + 4, kSubdirectory | static_cast<uint32_t>(section.size()), 4);
        AppendDirectory(section, languages.size());
        size_t entry = section.size();
        section.append(8 * languages.size(), '\0');
        for (const auto& [language, strings] : languages)
        {
            const std::string block = Block(strings);
            Put(section, entry, language, 4);
            Put(section, entry + 4, static_cast<uint32_t>(section.size()), 4);
            entry += 8;
            Append(section, kSectionAddress + static_cast<uint32_t>(section.size()) + 16, 4);
            Append(section, static_cast<uint32_t>(block.size()), 4);
            Append(section, 0, 8);
            section += block;
        }
    }
    return section;
}

} // namespace

std::string ResourceFile(const std::vector<ResourceString>& strings)
{
    Blocks blocks;
    for (const ResourceString& string : strings)
        blocks[string.id / 16 + 1][string.language][string.id % 16] = string.text;
    const std::string section = Section(blocks);
    std::string bytes = "MZ";
    constexpr size_t kStart = 0x40;
    constexpr size_t kOptional = kStart + 24;
    Put(bytes, 0x3c, kStart, 4);
    Put(bytes, kStart, 0x4550, 4);
    Put(bytes, kStart + 6, 1, 2);     // sections
    Put(bytes, kStart + 20, 0xf0, 2); // bytes of the optional header
    Put(bytes, kOptional, 0x20b, 2);
    Put(bytes, kOptional + 108, 16, 4);
    Put(bytes, kOptional + 128, kSectionAddress, 4);
    Put(bytes, kOptional + 132, static_cast<uint32_t>(section.size()), 4);
    const size_t header = kOptional + 0xf0;
    Put(bytes, header + 8, static_cast<uint32_t>(section.size()), 4);
    Put(bytes, header + 12, kSectionAddress, 4);
    Put(bytes, header + 16, static_cast<uint32_t>(section.size()), 4);
    Put(bytes, header + 20, kSectionOffset, 4);
    bytes.resize(kSectionOffset);
    return bytes + section;
}

} // namespace gw
