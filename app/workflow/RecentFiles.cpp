// The list of recently opened sources.

#include "CGaitConvertContent.h"
#include "Text.h"

namespace gw {

namespace {

constexpr const char* kRecentSetting = "RecentFiles";
constexpr size_t kRecentCount = 9; // one per digit key

} // namespace

std::vector<std::string> CGaitConvertContent::RecentFiles() const
{
    const std::string setting = platform_.ReadSetting(kRecentSetting);
    std::vector<std::string> paths;
    std::string_view rest = setting;
    for (std::string_view line; paths.size() < kRecentCount && NextLine(rest, line);)
    {
        if (!line.empty())
            paths.emplace_back(line);
    }
    return paths;
}

void CGaitConvertContent::ClearRecentFiles()
{
    platform_.WriteSetting(kRecentSetting, {});
}

void CGaitConvertContent::AddRecentFile(const std::string& path)
{
    std::vector<std::string> paths = RecentFiles();
    std::erase(paths, path);
    paths.insert(paths.begin(), path);
    std::string setting;
    for (size_t i = 0; i < paths.size() && i < kRecentCount; ++i)
        setting += paths[i] + '\n';
    platform_.WriteSetting(kRecentSetting, setting);
}

} // namespace gw
