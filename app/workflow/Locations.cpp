// The locations of the program's own files, the users' profiles, the host product and its help.

#include "CContentWindow.h"
#include "CGaitConvertContent.h"
#include "CStringLibrary.h"
#include "LanguageCode.h"
#include "Paths.h"
#include "ProfileNames.h"
#include "StringTable.h"

namespace gw {

namespace {

constexpr const char* kHelpLibrary = "Kbel.dll";
constexpr uint32_t kHelpFileString = 32824;
constexpr size_t kHelpNameLimit = 260; // in characters

} // namespace

std::string CGaitConvertContent::ExeFile(const std::string& name)
{
    return platform_.DataFolder() + name;
}

std::string CGaitConvertContent::ProfileFile(const std::string& name)
{
    const std::string folder = CustomProfileFolder(platform_, Message(kCustomFolderKeyMessage));
    platform_.MakeFolder(folder);
    return folder + name;
}

bool CGaitConvertContent::LocateHost(std::string& path)
{
    path = platform_.ReadHostKey(Message(kHostKeyMessage), Message(kHostProgramMessage));
    if (path.empty())
        ShowMessage(kNoHostMessage, EButtons::OK);
    return !path.empty();
}

bool CGaitConvertContent::LocateHelp(std::string& path)
{
    std::string host;
    if (!LocateHost(host))
        return false;
    const std::string folder = SplitPath(host).folder;
    CStringLibrary library;
    if (!library.Open(folder + kHelpLibrary))
        return false;
    std::string name;
    path.clear();
    if (!library.LoadString(kHelpFileString, platform_.ThreadLocale(), name))
        return true;
    path = folder + std::string(FirstCharacters(name, kHelpNameLimit));
    return FileExists(path);
}

void CGaitConvertContent::ShowHelp()
{
    std::string path;
    if (LocateHelp(path))
    {
        window_.OpenHelpFile(path + Message(kHelpTopicMessage));
        return;
    }
    const std::string language[] = {std::string(LanguageCode(platform_.ThreadLocale()))};
    window_.OpenWebPage(FormatText(Message(kWebPageMessage), language));
}

} // namespace gw
