// Finds a string in the resources of a Windows library.

#include "CStringLibrary.h"

#include "CPlatform.h"
#include "Utf8.h"

#include <algorithm>
#include <optional>
#include <utility>

// Strings are stored below three levels of directories: type, block of sixteen ids, language. Each directory
// entry points either to another directory or to the block's bytes. The levels are descended one by one, so
// directories that point back at themselves cannot cause an endless loop.

namespace gw {

namespace {

constexpr uint32_t kStringType = 6;
constexpr uint32_t kStringsPerBlock = 16;
constexpr uint32_t kHighBit = 0x80000000;

constexpr uint32_t kDosMagic = 0x5a4d;
constexpr uint32_t kImageMagic = 0x4550;
constexpr uint32_t kOptional32 = 0x10b;
constexpr uint32_t kOptional64 = 0x20b;

// Little-endian reads at any offset. Reading past the end yields 0 and sets a flag.
class CImage
{
public:
    explicit CImage(std::span<const std::byte> bytes) : m_kBytes(bytes) {}

    uint32_t U16(uint64_t offset) { return Read(offset, 2); }
    uint32_t U32(uint64_t offset) { return Read(offset, 4); }
    bool IsSound() const { return m_bSound; }
    uint64_t Size() const { return m_kBytes.size(); }

private:
    uint32_t Read(uint64_t offset, unsigned byteCount)
    {
        if (offset > m_kBytes.size() || m_kBytes.size() - offset < byteCount)
        {
            m_bSound = false;
            return 0;
        }
        uint32_t value = 0;
        for (unsigned i = 0; i < byteCount; ++i)
            value |= std::to_integer<uint32_t>(m_kBytes[offset + i]) << (8 * i);
        return value;
    }

    std::span<const std::byte> m_kBytes;
    bool m_bSound = true;
};

struct Headers
{
    uint64_t m_uiSections = 0; // file offset of the section table
    uint32_t m_uiSectionCount = 0;
    uint32_t m_uiResources = 0; // relative address, as if loaded in memory
};

bool ReadHeaders(CImage& image, Headers& headers)
{
    const uint64_t start = image.U32(0x3c);
    if (image.U16(0) != kDosMagic || image.U32(start) != kImageMagic)
        return false;
    const uint64_t optional = start + 24;
    const uint32_t magic = image.U16(optional);
    if (magic != kOptional32 && magic != kOptional64)
        return false;
    const uint64_t directories = optional + (magic == kOptional32 ? 96 : 112);
    constexpr uint64_t kResourceDirectory = 2;
    if (image.U32(directories - 4) <= kResourceDirectory)
        return false;
    headers.m_uiSectionCount = image.U16(start + 6);
    headers.m_uiSections = optional + image.U16(start + 20);
    headers.m_uiResources = image.U32(directories + 8 * kResourceDirectory);
    return image.IsSound() && headers.m_uiResources != 0;
}

// Converts a memory address to a file offset.
std::optional<uint64_t> FileOffset(CImage& image, const Headers& headers, uint32_t address)
{
    for (uint32_t i = 0; i < headers.m_uiSectionCount && image.IsSound(); ++i)
    {
        const uint64_t section = headers.m_uiSections + 40ull * i;
        const uint32_t begin = image.U32(section + 12);
        const uint32_t byteCount = image.U32(section + 16);
        if (address >= begin && address - begin < byteCount)
            return uint64_t{image.U32(section + 20)} + (address - begin);
    }
    return std::nullopt;
}

// Returns the target of the entry with the highest `rank`; an id that does not fit has rank 0. Named entries,
// which come first and have the high bit set, never fit.
template <class Rank>
std::optional<uint32_t> FindEntry(CImage& image, uint64_t directory, Rank rank)
{
    std::optional<uint32_t> best;
    int bestRank = 0;
    const uint32_t count = image.U16(directory + 12) + image.U16(directory + 14);
    for (uint32_t i = 0; i < count && image.IsSound(); ++i)
    {
        const uint64_t entry = directory + 16 + 8ull * i;
        const uint32_t id = image.U32(entry);
        const int idRank = id & kHighBit ? 0 : rank(id);
        if (idRank > bestRank)
        {
            bestRank = idRank;
            best = image.U32(entry + 4);
        }
    }
    return best;
}

int LanguageRank(uint32_t language, uint32_t locale)
{
    if (language == locale)
        return 4;
    if (language != 0 && PrimaryLanguage(language) == PrimaryLanguage(locale))
        return 3;
    return language == 0 ? 2 : 1;
}

// Descends one level, to the directory with an id.
std::optional<uint64_t> Descend(CImage& image, uint64_t root, uint64_t directory, uint32_t wanted)
{
    const auto entry = FindEntry(image, directory, [=](uint32_t id) { return id == wanted ? 1 : 0; });
    if (!entry || !(*entry & kHighBit))
        return std::nullopt;
    return root + (*entry & ~kHighBit);
}

struct Block
{
    uint64_t m_uiBegin;
    uint64_t m_uiEnd;
};

std::optional<Block> FindBlock(CImage& image, uint32_t number, uint32_t locale)
{
    Headers headers;
    if (!ReadHeaders(image, headers))
        return std::nullopt;
    const auto root = FileOffset(image, headers, headers.m_uiResources);
    const auto type = root ? Descend(image, *root, *root, kStringType) : root;
    const auto languages = type ? Descend(image, *root, *type, number) : type;
    if (!languages)
        return std::nullopt;
    const auto place =
        FindEntry(image, *languages, [=](uint32_t language) { return LanguageRank(language, locale); });
    if (!place || (*place & kHighBit))
        return std::nullopt;
    const auto begin = FileOffset(image, headers, image.U32(*root + *place));
    if (!begin)
        return std::nullopt;
    return Block{*begin, *begin + image.U32(*root + *place + 4)};
}

bool IsHighHalf(uint32_t unit)
{
    return unit >= 0xd800 && unit < 0xdc00;
}

bool IsLowHalf(uint32_t unit)
{
    return unit >= 0xdc00 && unit < 0xe000;
}

std::string ReadUtf16(CImage& image, uint64_t offset, uint32_t unitCount)
{
    std::string text;
    for (uint32_t i = 0; i < unitCount; ++i)
    {
        const uint32_t unit = image.U16(offset + 2ull * i);
        const uint32_t next = i + 1 < unitCount ? image.U16(offset + 2ull * (i + 1)) : 0;
        const bool isPair = IsHighHalf(unit) && IsLowHalf(next);
        if (isPair)
            ++i;
        AppendUtf8(text, isPair ? 0x10000 + ((unit - 0xd800) << 10) + (next - 0xdc00) : unit);
    }
    return text;
}

// Reads a string of a block: sixteen texts, each preceded by its length in 16-bit units.
std::optional<std::string> ReadString(CImage& image, const Block& block, uint32_t index)
{
    uint64_t offset = block.m_uiBegin;
    for (uint32_t i = 0; i < index; ++i)
        offset += 2 + 2ull * image.U16(offset);
    const uint32_t unitCount = image.U16(offset);
    if (!image.IsSound() || offset + 2 + 2ull * unitCount > std::min(block.m_uiEnd, image.Size()))
        return std::nullopt;
    return ReadUtf16(image, offset + 2, unitCount);
}

} // namespace

bool FindResourceString(std::span<const std::byte> file, uint32_t id, uint32_t locale, std::string& text)
{
    CImage image(file);
    const auto block = FindBlock(image, id / kStringsPerBlock + 1, locale);
    if (!block || !image.IsSound())
        return false;
    auto found = ReadString(image, *block, id % kStringsPerBlock);
    if (!found || found->empty())
        return false;
    text = std::move(*found);
    return true;
}

bool CStringLibrary::Open(const std::string& path)
{
    return m_kFile.Open(path) == EFailure::None;
}

bool CStringLibrary::LoadString(uint32_t id, uint32_t locale, std::string& text) const
{
    return FindResourceString(m_kFile.Bytes(), id, locale, text);
}

} // namespace gw
