// Settings and folders by the freedesktop rules. A value is looked up in the user's folder, then in the
// system's in order; in each, the program's own file comes before the maker's.

#include "CFilePlatform.h"

#include "CMappedFile.h"
#include "CSafeFile.h"
#include "IniText.h"
#include "LanguageCode.h"
#include "Paths.h"
#include "Text.h"

#include <cstdlib>
#include <optional>

namespace gw {

namespace {

constexpr std::string_view kMaker = "Tessarine";
constexpr std::string_view kProgramFile = "Tessarine/Gaitwright.conf";
constexpr std::string_view kMakerFile = "Tessarine.conf"; // shared by all programs of the maker
constexpr std::string_view kSection = "Settings";

std::string Environment(const char* name)
{
    const char* value = std::getenv(name);
    return value ? value : "";
}

// Returns an environment variable that holds an absolute path; relative paths are ignored.
std::string AbsolutePath(const char* name, const std::string& otherwise)
{
    const std::string path = Environment(name);
    return path.starts_with('/') ? path : otherwise;
}

std::vector<std::string> SplitList(std::string_view list)
{
    std::vector<std::string> paths;
    for (std::string_view path = NextToken(list, ":"); !path.empty(); path = NextToken(list, ":"))
    {
        if (path.starts_with('/'))
            paths.push_back(WithSeparator(std::string(path)));
    }
    return paths;
}

// Reads a file into text, empty if it does not exist; false if it exists but cannot be read.
bool ReadText(const std::string& path, std::string& text)
{
    CMappedFile file;
    const EFailure failure = file.Open(path);
    text = file.Text();
    return failure == EFailure::None || !FileExists(path);
}

std::string TextOf(const std::string& path)
{
    std::string text;
    ReadText(path, text);
    return text;
}

// Returns the folder in a line of user-dirs.dirs: XDG_DOCUMENTS_DIR="$HOME/Documents".
std::string NamedFolder(std::string_view line, std::string_view name, const std::string& home)
{
    line = line.substr(std::min(line.find_first_not_of(" \t"), line.size()));
    if (!line.starts_with(name) || line.substr(name.size(), 2) != "=\"")
        return {};
    line.remove_prefix(name.size() + 2);
    const std::string_view path = line.substr(0, line.find('"'));
    if (path.starts_with("$HOME"))
        return home + std::string(path.substr(5));
    return path.starts_with('/') ? std::string(path) : std::string();
}

// Splits off the last two parts of a registry path: product and version.
bool SplitKeyPath(const std::string& keyPath, std::string& product, std::string& version)
{
    const size_t last = keyPath.rfind('\\');
    if (last == keyPath.npos || last == 0)
        return false;
    const size_t before = keyPath.rfind('\\', last - 1);
    version = keyPath.substr(last + 1);
    product = keyPath.substr(before + 1, last - before - 1); // works for npos, because npos + 1 is 0
    return !product.empty();
}

} // namespace

CFilePlatform::CFilePlatform(EPlatformWriting writing, std::string dataFolder)
    : m_bWriting(writing == EPlatformWriting::Yes),
      m_kDataFolder(WithSeparator(dataFolder.empty() ? InstalledDataFolder() : std::move(dataFolder))),
      m_kHome(AbsolutePath("HOME", "/")),
      m_kUserFolder(WithSeparator(AbsolutePath("XDG_CONFIG_HOME", WithSeparator(m_kHome) + ".config"))),
      m_kSystemFolders(SplitList(Environment("XDG_CONFIG_DIRS")))
{
    if (m_kSystemFolders.empty())
        m_kSystemFolders.emplace_back("/etc/xdg/");
}

// The program's own file comes before the maker's, and an earlier folder before a later one.
std::string CFilePlatform::FindValue(const std::vector<std::string>& folders, std::string_view file,
                                     std::string_view section, std::string_view key) const
{
    for (const std::string_view name : {file, kMakerFile})
    {
        for (const std::string& folder : folders)
        {
            if (const auto value = FindIniValue(TextOf(folder + std::string(name)), section, key))
                return *value;
        }
    }
    return {};
}

std::string CFilePlatform::ReadSetting(const std::string& key) const
{
    const std::string own = FindValue({m_kUserFolder}, kProgramFile, kSection, key);
    return own.empty() ? FindValue(m_kSystemFolders, kProgramFile, kSection, key) : own;
}

bool CFilePlatform::WriteSetting(const std::string& key, const std::string& value)
{
    const std::string path = m_kUserFolder + std::string(kProgramFile);
    std::string old;
    if (!m_bWriting || !CreateFolder(SplitPath(path).folder) || !ReadText(path, old))
        return false;
    CSafeFile file;
    return file.Open(path) && file.Write(SetIniValue(old, kSection, key, value)) && file.Commit();
}

std::string CFilePlatform::ReadHostKey(const std::string& keyPath, const std::string& valueName) const
{
    std::string product, version;
    if (!SplitKeyPath(keyPath, product, version))
        return {};
    return FindValue(m_kSystemFolders, std::string(kMaker) + '/' + product + ".conf", version, valueName);
}

std::string CFilePlatform::DocumentsFolder() const
{
    const std::string text = TextOf(m_kUserFolder + "user-dirs.dirs");
    std::string_view rest = text, line;
    std::string folder;
    while (NextLine(rest, line))
    {
        const std::string named = NamedFolder(line, "XDG_DOCUMENTS_DIR", m_kHome);
        if (!named.empty())
            folder = named;
    }
    return folder.empty() ? WithSeparator(m_kHome) + "Documents" : folder;
}

bool CFilePlatform::MakeFolder(const std::string& path)
{
    return m_bWriting && CreateFolder(path);
}

uint32_t CFilePlatform::ThreadLocale() const
{
    for (const char* name : {"LC_ALL", "LC_MESSAGES", "LANG"})
    {
        const std::string value = Environment(name);
        if (!value.empty())
            return LocaleOfName(value);
    }
    return 0;
}

} // namespace gw
