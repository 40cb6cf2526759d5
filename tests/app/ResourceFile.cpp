#include "ResourceFile.h"

#include <array>
#include <functional>
#include <map>

namespace gw {
namespace {

constexpr size_t kSectionAddress = 0x1000; // in memory
constexpr size_t kSectionOffset = 0x200;   // in the file
constexpr size_t kSubdirectory = 0x80000000;

// The bytes of a part of the section, which depend on its offset.
using Part = std::function<std::string(size_t offset)>;
using Block = std::array<std::u16string, 16>;

// Appends numbers of one size.
void Put(std::string& bytes, size_t byteCount, std::initializer_list<size_t> values)
{
    for (const size_t value : values)
    {
        for (size_t i = 0; i < byteCount; ++i)
            bytes += static_cast<char>(value >> (8 * i) & 0xff);
    }
}

// A directory of parts by their ids, followed by the parts.
Part Directory(const std::map<uint32_t, Part>& parts, size_t flag)
{
    return [=](size_t offset) {
        std::string head(12, '\0');
        std::string rest;
        Put(head, 2, {0, parts.size()});
        for (const auto& [id, part] : parts)
        {
            const size_t place = offset + 16 + 8 * parts.size() + rest.size();
            Put(head, 4, {id, flag | place});
            rest += part(place);
        }
        return head + rest;
    };
}

Part Strings(const Block& block)
{
    std::string bytes;
    for (const std::u16string& text : block)
    {
        Put(bytes, 2, {text.size()});
        for (const char16_t unit : text)
            Put(bytes, 2, {unit});
    }
    return [bytes](size_t offset) {
        std::string entry;
        Put(entry, 4, {kSectionAddress + offset + 16, bytes.size(), 0, 0});
        return entry + bytes;
    };
}

} // namespace

std::string ResourceFile(const std::vector<ResourceString>& strings)
{
    std::map<uint32_t, std::map<uint32_t, Block>> texts; // by number of the block and language
    for (const ResourceString& string : strings)
        texts[string.id / 16 + 1][string.language][string.id % 16] = string.text;
    std::map<uint32_t, Part> blocks;
    for (const auto& [number, languages] : texts)
    {
        std::map<uint32_t, Part> parts;
        for (const auto& [language, block] : languages)
            parts[language] = Strings(block);
        blocks[number] = Directory(parts, 0);
    }
    const std::string section =
        Directory({{6, Directory(blocks, kSubdirectory)}}, kSubdirectory)(0); // 6: string tables

    std::string bytes = "MZ";
    bytes.resize(60);
    Put(bytes, 4, {64, 0x4550});
    Put(bytes, 2, {0, 1}); // one section
    bytes.resize(84);
    Put(bytes, 2, {240, 0, 0x20b}); // size of the optional header, and its kind
    bytes.resize(88 + 108);
    Put(bytes, 4, {16, 0, 0, 0, 0, kSectionAddress, section.size()});
    bytes.resize(88 + 240 + 8);
    Put(bytes, 4, {section.size(), kSectionAddress, section.size(), kSectionOffset});
    bytes.resize(kSectionOffset);
    return bytes + section;
}

} // namespace gw
