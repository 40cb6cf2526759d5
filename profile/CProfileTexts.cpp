#include "CProfileTexts.h"

#include "CMappedFile.h"
#include "Numbers.h"
#include "Paths.h"
#include "ProfileFile.h"
#include "Text.h"

#include <algorithm>
#include <tuple>
#include <unordered_map>

#include <sys/stat.h>

namespace gw {

namespace {

constexpr off_t kPackByteLimit = off_t{64} << 20; // thousands of profiles

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

bool StatusOf(const std::string& path, struct stat& status)
{
    return stat(path.c_str(), &status) == 0;
}

// A copied installation can have times truncated to seconds, equally for all its files.
bool IsNewer(const struct stat& a, const struct stat& b)
{
    return std::tuple(a.st_mtim.tv_sec, a.st_mtim.tv_nsec) > std::tuple(b.st_mtim.tv_sec, b.st_mtim.tv_nsec);
}

} // namespace

CProfileTexts::CProfileTexts(const std::string& folder)
{
    // The time is read before the content: a pack that is replaced in between then counts as old.
    const std::string packPath = folder + std::string(kProfilePack);
    struct stat packStatus;
    PackedTexts packed;
    CMappedFile pack;
    if (StatusOf(packPath, packStatus) && packStatus.st_size < kPackByteLimit &&
        pack.Open(packPath) == EFailure::None)
    {
        m_kPack = pack.Text(); // a copy, because the file can be truncated while its texts are in use
        packed = ReadPack(m_kPack);
    }
    for (const std::string& file : FilesInFolder(folder, ".prf"))
    {
        const auto found = packed.find(file);
        struct stat status;
        const bool isPacked = found != packed.end() && StatusOf(folder + file, status) &&
                              static_cast<uint64_t>(status.st_size) == found->second.size() &&
                              !IsNewer(status, packStatus);
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
