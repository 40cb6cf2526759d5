// Settings and keys of the registry, and the counter of instances, as this system keeps them.

#include "TempFolder.h"

#include "CInstanceCounter.h"
#include "CRegistryPlatform.h"
#include "Paths.h"
#include "WindowsCalls.h"

#include <gtest/gtest.h>

namespace gw {
namespace {

constexpr const wchar_t* kSettings = L"Software\\Tessarine\\Gaitwright\\Settings";

// Uses a setting of its own, and removes it before and afterwards.
class RegistryPlatform : public testing::Test
{
protected:
    RegistryPlatform() { Forget(); }
    ~RegistryPlatform() override { Forget(); }

    void Forget() const { RegDeleteKeyValueW(HKEY_CURRENT_USER, kSettings, WideText(m_kSetting).c_str()); }

    std::string m_kSetting = "Test of process " + std::to_string(GetCurrentProcessId());
};

TEST_F(RegistryPlatform, SettingsOutliveTheProgram)
{
    const std::string value = "C:\\B\xc3\xa4ume\\\xf0\x9f\x8c\xb2, %TEMP% \"0,1\"";
    EXPECT_EQ(CRegistryPlatform(EPlatformWriting::No).ReadSetting(m_kSetting), "");
    EXPECT_TRUE(CRegistryPlatform(EPlatformWriting::Yes).WriteSetting(m_kSetting, value));
    EXPECT_EQ(CRegistryPlatform(EPlatformWriting::No).ReadSetting(m_kSetting), value);
    EXPECT_TRUE(CRegistryPlatform(EPlatformWriting::Yes).WriteSetting(m_kSetting, ""));
    EXPECT_EQ(CRegistryPlatform(EPlatformWriting::No).ReadSetting(m_kSetting), "");
}

TEST_F(RegistryPlatform, AReadOnlyPlatformLeavesNothing)
{
    const CTempFolder folder;
    CRegistryPlatform platform(EPlatformWriting::No, folder.Path("elsewhere"));
    EXPECT_FALSE(platform.WriteSetting(m_kSetting, "x"));
    EXPECT_EQ(platform.ReadSetting(m_kSetting), "");
    EXPECT_FALSE(platform.MakeFolder(folder.Path("made")));
    EXPECT_FALSE(FolderExists(folder.Path("made")));
}

// Of keys that every system has, since a user may not write those of the machine.
TEST_F(RegistryPlatform, HostKeysAreTheMachines)
{
    const CRegistryPlatform platform(EPlatformWriting::No);
    const std::string key = "SOFTWARE\\Microsoft\\Windows NT\\CurrentVersion";
    EXPECT_TRUE(FolderExists(platform.ReadHostKey(key, "SystemRoot")));
    EXPECT_EQ(platform.ReadHostKey(key, "Nothing"), "");
    EXPECT_EQ(platform.ReadHostKey("SOFTWARE\\No\\Such\\Key", "SystemRoot"), "");
    EXPECT_EQ(
        platform.ReadHostKey("SYSTEM\\CurrentControlSet\\Control\\Session Manager\\Environment", "windir"),
        platform.ReadHostKey(key, "SystemRoot")); // there it is the name of a variable
    EXPECT_TRUE(FolderExists(platform.DocumentsFolder()));
}

TEST(InstanceCounter, IsForgottenWithTheLastInstance)
{
    const std::string name = "gaitwright-test-" + std::to_string(GetCurrentProcessId());
    for (int run = 0; run < 2; ++run)
    {
        CInstanceCounter first(name);
        EXPECT_EQ(first.Value(), -1);
        EXPECT_EQ(first.Enter(), 0);
        CInstanceCounter second(name);
        EXPECT_EQ(second.Enter(), 1);
        EXPECT_EQ(first.Value(), 1);
    }
}

} // namespace
} // namespace gw
