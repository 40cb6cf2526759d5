#pragma once

#include "CMappedFile.h"

#include <cstdint>
#include <deque>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

/// The texts of all profiles in a folder, in name order, read once. An installation also contains one file
/// with all its profiles, created when it is built. A profile's text is read from there if its own file has
/// the packed size and is not newer than the pack, otherwise from its own file. Only a file of another time
/// and the same size, such as an older copy, can differ from its packed text.
class CProfileTexts
{
public:
    struct Entry
    {
        std::string file;                     ///< file name
        std::string name;                     ///< display name; empty if the file cannot be read
        std::optional<std::string_view> text; ///< no value if the file cannot be read or is too long
    };

    enum class EPack : uint8_t
    {
        Used,
        Ignored,
    };

    /// `folder` ends in a separator.
    explicit CProfileTexts(const std::string& folder, EPack pack = EPack::Used);
    CProfileTexts(const CProfileTexts&) = delete;
    CProfileTexts& operator=(const CProfileTexts&) = delete;

    std::span<const Entry> Entries() const { return m_kEntries; }

private:
    void Add(const std::string& folder, const std::string& file, std::optional<std::string_view> packed);

    CMappedFile m_kPack;
    std::deque<std::string> m_kOwn; // texts that were read from their own files
    std::vector<Entry> m_kEntries;
};

/// The file in an installation with the texts of its profiles. For each, it has a line with file name and
/// size in bytes, followed by the bytes.
inline constexpr std::string_view kProfilePack = "profiles.pack";

} // namespace gw
