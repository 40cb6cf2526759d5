#pragma once

#include <deque>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

/// The texts of all profiles in a folder, in name order, read once. An installation packs its profiles into
/// one more file when it is built. A profile is taken from there as long as its own file has the packed size
/// and is not newer than the pack; any other one is read from its own file.
class CProfileTexts
{
public:
    struct Entry
    {
        std::string file;                     ///< in the folder
        std::string name;                     ///< display name; empty if the file cannot be read
        std::optional<std::string_view> text; ///< empty if the file cannot be read or is too long
    };

    /// The folder ends in a separator.
    explicit CProfileTexts(const std::string& folder);
    CProfileTexts(const CProfileTexts&) = delete;
    CProfileTexts& operator=(const CProfileTexts&) = delete;

    std::span<const Entry> Entries() const { return m_kEntries; }

private:
    void Add(const std::string& folder, const std::string& file, std::optional<std::string_view> packed);

    std::string m_kPack;            // its bytes
    std::deque<std::string> m_kOwn; // texts that are not from the pack
    std::vector<Entry> m_kEntries;
};

/// The file of an installation that holds the texts of its profiles. For each, a line with its file name and
/// its size in bytes, and then its bytes.
inline constexpr std::string_view kProfilePack = "profiles.pack";

} // namespace gw
