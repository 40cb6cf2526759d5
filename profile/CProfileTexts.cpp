#include "CProfileTexts.h"

#include "CFolderFiles.h"
#include "Numbers.h"
#include "Paths.h"
#include "ProfileFile.h"
#include "Text.h"

#include <algorithm>
#include <unordered_map>

namespace gw {

namespace {

// A thousand profiles. A file of this size is read, not mapped, so it can be replaced while its texts are
// used.
constexpr uint64_t kPackByteLimit = uint64_t{1} << 20;

using PackedTexts = std::unordered_map<std::string_view, std::string_view>;

// If a pack is damaged, the entries before the damage are still valid, because sizes and dates are compared
// as well.
PackedTexts ReadPack(std::string_view rest)
{
    PackedTexts texts;
    for (std::string_view line; NextLine(rest, line);)
    {
        const size_t blank = line.rfind(' ');
        int32_t size = 0;
        if (blank == line.npos || !ScanInt(line.substr(blank + 1), size) || size < 0 ||
            static_cast<size_t>(size) > std::min(rest.size(), kProfileByteLimit))
            break;
        texts.emplace(line.substr(0, blank), rest.substr(0, static_cast<size_t>(size)));
        rest.remove_prefix(static_cast<size_t>(size));
    }
    return texts;
}

} // namespace

CProfileTexts::CProfileTexts(const std::string& folder, EPack pack)
{
    // The time is read before the content: a pack that is replaced in between then counts as old.
    const CFolderFiles files(folder);
    FileStatus packStatus;
    PackedTexts packed;
    if (pack == EPack::Used && files.StatusOf(std::string(kProfilePack).c_str(), packStatus) &&
        packStatus.byteCount <= kPackByteLimit &&
        m_kPack.Open(folder + std::string(kProfilePack)) == EFailure::None)
        packed = ReadPack(m_kPack.Text());
    const std::vector<std::string> names = FilesInFolder(folder, ".prf");
    m_kEntries.reserve(names.size());
    for (const std::string& file : names)
    {
        const auto found = packed.find(file);
        FileStatus status;
        // A copied installation can have times truncated to seconds, equally for all its files.
        const bool isPacked = found != packed.end() && files.StatusOf(file.c_str(), status) &&
                              status.byteCount == found->second.size() &&
                              status.modified <= packStatus.modified;
        Add(folder, file, isPacked ? std::optional(found->second) : std::nullopt);
    }
}

void CProfileTexts::Add(const std::string& folder, const std::string& file,
                        std::optional<std::string_view> packed)
{
    std::optional<std::string_view> text = packed;
    if (std::string own; !text && ReadProfileText(folder + file, own))
        text = m_kOwn.emplace_back(std::move(own));
    std::string name = text ? CProfileReader(*text).Name() : ReadProfileName(folder + file);
    m_kEntries.push_back({file, std::move(name), text});
}

} // namespace gw
