// Saves what the desktop program saves, with the same code: a profile from the editor, a setting, the lines
// of a map. Exit codes are the command line's.

#include "CFilePlatform.h"
#include "CProfileEditorDialog.h"
#include "MapLines.h"
#include "Paths.h"

#include <csignal>
#include <cstdio>
#include <new>
#include <string_view>

namespace gw {
namespace {

// An owner for the editor with a single given profile, which answers yes to everything.
class COwnerOfOne : public CProfileOwner
{
public:
    explicit COwnerOfOne(std::string path) : m_kPath(std::move(path)) {}

    EAnswer ShowMessage(int, EButtons, std::span<const int>) override { return EAnswer::OK; }
    void ProfileStateChanged() override {}
    void ProfileSetChanged() override {}
    std::string FindProfilePath(const std::string&) override { return m_kPath; }
    std::string ProfileFile(const std::string& name) override { return FolderOf(m_kPath) + name; }
    std::string ExeFile(const std::string& name) override { return FolderOf(m_kPath) + name; }

private:
    std::string m_kPath;
};

bool SaveProfile(const std::string& path)
{
    COwnerOfOne owner(path);
    CProfileEditorDialog editor(owner);
    int total = 0;
    editor.ReadProfile(path, nullptr, &total, EProfileRead::Load); // false if bones are missing
    if (total == 0)
        return false;
    editor.AddMapRow("Skull", "Head", {});
    return editor.WriteProfile(EProfileWrite::Ask);
}

bool SaveSetting(const std::string&)
{
    return CFilePlatform(EPlatformWriting::Yes).WriteSetting("LastFolder", "/takes");
}

bool SaveMap(const std::string& path)
{
    std::vector<MapLine> lines;
    if (!ReadMapLines(path, lines))
        return false;
    lines.push_back(ParseMapLine(MappingLine("Skull", "Head")));
    return WriteMapLines(path, lines);
}

constexpr struct
{
    std::string_view name;
    bool (*save)(const std::string& path);
} kSaves[] = {
    {"profile", SaveProfile},
    {"setting", SaveSetting},
    {"map", SaveMap},
};

bool Save(std::string_view kind, const std::string& path)
{
    for (const auto& row : kSaves)
    {
        if (row.name == kind)
            return row.save(path);
    }
    return false;
}

} // namespace
} // namespace gw

int main(int argc, char** argv)
try
{
    std::signal(SIGXFSZ, SIG_IGN);
    const std::string path = argc > 2 ? argv[2] : "";
    if (gw::Save(argc > 1 ? argv[1] : "", path))
        return 0;
    std::fprintf(stderr, "%s: not saved\n", path.c_str());
    return 1;
} catch (const std::bad_alloc&)
{
    std::fputs("there is not enough memory\n", stderr);
    return 1;
}
