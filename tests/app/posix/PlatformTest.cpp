// Settings files, folders, languages and window placements.

#include "TempFolder.h"

#include "CFilePlatform.h"
#include "IniText.h"
#include "LanguageCode.h"
#include "Paths.h"
#include "WindowPlacement.h"

#include <cstdlib>
#include <gtest/gtest.h>
#include <map>
#include <tuple>

namespace gw {

TEST(IniText, Values)
{
    // held: value of Settings/Window Pos; null if missing
    const std::tuple<const char*, const char*, const char*> rows[] = {
        {"plain", "[Settings]\nWindow%20Pos=a b\n", "a b"},
        {"no file", "", nullptr},
        {"another section", "[Other]\nWindow%20Pos=a\n", nullptr},
        {"key without a section", "Settings\\Window%20Pos=a\n", nullptr},
        {"the section comes twice", "[Settings]\nx=1\n[A]\nx=2\n[Settings]\nWindow%20Pos=a\n", "a"},
        {"the last one counts", "[Settings]\nWindow%20Pos=a\nWindow%20Pos=b\n", "b"},
        {"CR LF and a mark", "\xef\xbb\xbf[Settings]\r\nWindow%20Pos=a\r\n", "a"},
        {"blanks around all", " [ Settings ] \n  Window%20Pos  =  a  \n", "a"},
        {"quotes", "[Settings]\nWindow%20Pos=\"a; b=c, d \"\n", "a; b=c, d "},
        {"escapes", "[Settings]\nWindow%20Pos=C:\\\\x\\ty\\x41;z\n", "C:\\x\tyA"},
        {"unquoted list", "[Settings]\nWindow%20Pos=0, 1,-1 ,\n", "0,1,-1,"},
        {"comment", "[Settings]\n;Window%20Pos=a\nWindow%20Pos=b ; c\n", "b"},
        {"over a line end", "[Settings]\nWindow%20Pos=\"a\\\nb\"\n", "ab"},
        {"marks", "[Settings]\nWindow%20Pos=@@a\n", "@a"},
        {"bytes", "[Settings]\nWindow%20Pos=@ByteArray(a)\n", "a"},
        {"a wide key", "[Settings]\nWindow%U0020Pos=\xc3\xa4\n", "\xc3\xa4"},
        {"no value", "[Settings]\nWindow%20Pos=\n", ""},
        {"cut short", "[Settings]\nWindow%20Pos=\"a\\", "a"},
    };
    for (const auto& [what, text, held] : rows)
    {
        const auto value = FindIniValue(text, "Settings", "Window Pos");
        EXPECT_EQ(value.has_value(), held != nullptr) << what;
        EXPECT_EQ(value.value_or(""), held ? held : "") << what;
    }
}

TEST(IniText, SettingKeepsEveryOtherLine)
{
    const std::tuple<const char*, const char*, const char*, const char*> rows[] = {
        {"an empty file", "", "v", "[Settings]\nK=v\n"},
        {"replaced", "[Settings]\nJ=1\nK=old\nL=2\n", "v", "[Settings]\nJ=1\nK=v\nL=2\n"},
        {"appended", "[Settings]\nJ=1 ; c\n\n[B]\nK=2", "v", "[Settings]\nJ=1 ; c\nK=v\n\n[B]\nK=2"},
        {"a new section", "[B]\nK=2", "v", "[B]\nK=2\n\n[Settings]\nK=v\n"},
        {"quoted", "", "0,1;=", "[Settings]\nK=\"0,1;=\"\n"},
        {"open quotes", "[B]\nK=\"2", "v", "[B]\nK=\"2\"\n\n[Settings]\nK=v\n"},
        {"a backslash", "[Settings]\n\\", "v", "[Settings]\n\\\n\nK=v"},
        {"escaped", "", "@C:\\\"", "[Settings]\nK=@@C:\\\\\\\"\n"},
    };
    for (const auto& [what, before, value, after] : rows)
    {
        const std::string text = SetIniValue(before, "Settings", "K", value);
        EXPECT_EQ(text, after) << what;
        EXPECT_EQ(FindIniValue(text, "Settings", "K"), value) << what;
    }
}

class FilePlatform : public testing::Test
{
protected:
    FilePlatform()
    {
        Set("HOME", m_kFolder.Path("home"));
        Set("XDG_CONFIG_HOME", "");
        Set("XDG_CONFIG_DIRS", m_kFolder.Path("near") + ":relative:" + m_kFolder.Path("far"));
        Set("LC_ALL", "");
        Set("LC_MESSAGES", "");
        Set("LANG", "");
    }
    ~FilePlatform() override
    {
        for (const auto& [name, value] : m_kOld)
            value ? setenv(name.c_str(), value->c_str(), 1) : unsetenv(name.c_str());
    }

    void Set(const char* name, const std::string& value)
    {
        const char* const old = std::getenv(name);
        m_kOld.try_emplace(name, old ? std::optional<std::string>(old) : std::nullopt);
        setenv(name, value.c_str(), 1);
    }
    void Write(const std::string& name, const std::string& text)
    {
        CreateFolder(SplitPath(m_kFolder.Path(name)).folder);
        WriteBytes(m_kFolder.Path(name), text);
    }

    CTempFolder m_kFolder;
    std::map<std::string, std::optional<std::string>> m_kOld;
};

TEST_F(FilePlatform, SettingsOutliveTheProgram)
{
    CFilePlatform(EPlatformWriting::Yes).WriteSetting("MotionSource", "/motions, old/");
    EXPECT_EQ(CFilePlatform(EPlatformWriting::No).ReadSetting("MotionSource"), "/motions, old/");
    EXPECT_EQ(ReadBytes(m_kFolder.Path("home/.config/Tessarine/Gaitwright.conf")),
              "[Settings]\nMotionSource=\"/motions, old/\"\n");
}

TEST_F(FilePlatform, AReadOnlyPlatformLeavesNothing)
{
    CFilePlatform platform(EPlatformWriting::No, m_kFolder.Path("elsewhere"));
    EXPECT_FALSE(platform.WriteSetting("MotionSource", "x"));
    EXPECT_FALSE(platform.MakeFolder(m_kFolder.Path("home/made")));
    EXPECT_FALSE(FolderExists(m_kFolder.Path("home")));
    EXPECT_EQ(platform.DataFolder(), m_kFolder.Path("elsewhere/"));
}

TEST_F(FilePlatform, TheNearerFileCounts)
{
    Write("far/Tessarine/Kestro.conf", "[2.0]\nMain%20Program=/far/Kestro\nCustom%20Data=/far\n");
    Write("near/Tessarine/Kestro.conf", "[2.0]\nMain%20Program=/near/Kestro\n[1.0]\nCustom%20Data=/old\n");
    Write("near/Tessarine.conf", "[Settings]\nMotionSource=/near/\n");
    const CFilePlatform platform(EPlatformWriting::No);
    const std::string key = "SOFTWARE\\Tessarine\\Kestro\\2.0";
    EXPECT_EQ(platform.ReadHostKey(key, "Main Program"), "/near/Kestro");
    EXPECT_EQ(platform.ReadHostKey(key, "Custom Data"), "/far");
    EXPECT_EQ(platform.ReadHostKey(key, "Nothing"), "");
    EXPECT_EQ(platform.ReadHostKey("nonsense", "Custom Data"), "");
    EXPECT_EQ(platform.ReadSetting("MotionSource"), "/near/");
}

TEST_F(FilePlatform, Documents)
{
    const std::string home = m_kFolder.Path("home");
    const std::tuple<const char*, std::string, std::string> rows[] = {
        {"none named", "XDG_MUSIC_DIR=\"$HOME/Music\"\n", home + "/Documents"},
        {"below the home", "XDG_DOCUMENTS_DIR=\"$HOME/Papiere\"\n", home + "/Papiere"},
        {"somewhere else", " XDG_DOCUMENTS_DIR=\"/srv/docs\"\n", "/srv/docs"},
        {"a relative path", "XDG_DOCUMENTS_DIR=\"docs\"\n", home + "/Documents"},
        {"commented out", "#XDG_DOCUMENTS_DIR=\"/srv\"\n", home + "/Documents"},
    };
    for (const auto& [what, line, folder] : rows)
    {
        Write("home/.config/user-dirs.dirs", line);
        EXPECT_EQ(CFilePlatform(EPlatformWriting::No).DocumentsFolder(), folder) << what;
    }
}

TEST_F(FilePlatform, LanguageOfTheEnvironment)
{
    const std::tuple<const char*, const char*> rows[] = {
        {"de_AT.UTF-8", "deu"}, {"es", "esn"},    {"fr_CA", "fra"}, {"it_IT@euro", "ita"}, {"ja_JP", "jpn"},
        {"ko_KR", "kor"},       {"pt_BR", "ptg"}, {"zh_CN", "chs"}, {"zh_TW", "cht"},      {"en_US", "enu"},
        {"nl_NL", "enu"},       {"C", "enu"},     {"deu", "enu"},   {"", "enu"},
    };
    Set("LANG", "fr_FR");
    for (const auto& [name, code] : rows)
    {
        Set("LC_ALL", *name ? name : "C");
        EXPECT_EQ(LanguageCode(CFilePlatform(EPlatformWriting::No).ThreadLocale()), code) << name;
    }
}

TEST(WindowPlacement, Texts)
{
    const WindowPlacement placement{0, 1, -1, -1, -1, -1, 100, -50, 740, 480};
    EXPECT_EQ(PlacementText(placement), "0,1,-1,-1,-1,-1,100,-50,740,480");
    const std::tuple<const char*, bool> rows[] = {
        {"0,1,-1,-1,-1,-1,100,-50,740,480", true},  {"0, 1, -1,-1,-1,-1,100,-50,740,480", true},
        {"2,1,-1,-1,-1,-1,100,-50,740", false},     {"0junk,1,-1,-1,-1,-1,0,0,740,480", false},
        {"0.5,1,-1,-1,-1,-1,0,0,740,480", false},   {"0,1,-1,-1,-1,-1,0,0,740,480.5", false},
        {"0,1,-1,-1,-1,-1,0,0,740,480,9", false},   {"9999999999,1,-1,-1,-1,-1,0,0,7,4", false},
        {"0,1,-1,-1,-1,-1,100,-50,740,", false},    {"0,1,-1,,-1,-1,100,-50,740,480", false},
        {"0 1 -1 -1 -1 -1 100 -50 740 480", false}, {"", false},
    };
    for (const auto& [text, scans] : rows)
    {
        WindowPlacement scanned;
        EXPECT_EQ(ScanPlacement(text, scanned), scans) << text;
        EXPECT_EQ(scanned, scans ? placement : WindowPlacement()) << text;
    }
}

} // namespace gw
