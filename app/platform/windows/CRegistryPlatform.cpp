// Settings and host keys in the registry. Texts there are UTF-16; invalid ones are replaced, not refused.

#include "CRegistryPlatform.h"

#include "Paths.h"
#include "WindowsCalls.h"

#include <utility>

#include <shlobj.h>

namespace gw {

namespace {

constexpr const wchar_t* kSettings = L"Software\\Tessarine\\Gaitwright\\Settings";

// A program of 32 bits, such as the host product, has keys of its own on a system of 64 bits.
constexpr DWORD kViews[] = {RRF_SUBKEY_WOW6464KEY, RRF_SUBKEY_WOW6432KEY};

// Returns a text value with its variables expanded; empty if it is missing or not a text. Another program may
// change it while it is read. Texts with variables become plain ones before their kind is checked.
std::string ReadText(HKEY root, const std::wstring& key, const std::wstring& name, DWORD view)
{
    std::wstring text;
    DWORD byteCount = 0;
    LSTATUS status =
        RegGetValueW(root, key.c_str(), name.c_str(), RRF_RT_REG_SZ | view, nullptr, nullptr, &byteCount);
    while (status == ERROR_SUCCESS || status == ERROR_MORE_DATA)
    {
        text.resize(byteCount / sizeof(wchar_t) + 1);
        byteCount = static_cast<DWORD>(text.size() * sizeof(wchar_t));
        status = RegGetValueW(root, key.c_str(), name.c_str(), RRF_RT_REG_SZ | view, nullptr, text.data(),
                              &byteCount);
        if (status == ERROR_SUCCESS)
            return NarrowText(text.c_str()); // up to the zero that ends it
    }
    return {};
}

} // namespace

CRegistryPlatform::CRegistryPlatform(EPlatformWriting writing, std::string dataFolder)
    : m_bWriting(writing == EPlatformWriting::Yes),
      m_kDataFolder(WithSeparator(dataFolder.empty() ? InstalledDataFolder() : std::move(dataFolder)))
{
}

std::string CRegistryPlatform::ReadSetting(const std::string& key) const
{
    const std::wstring name = WideText(key);
    const std::string own = ReadText(HKEY_CURRENT_USER, kSettings, name, 0);
    return own.empty() ? ReadText(HKEY_LOCAL_MACHINE, kSettings, name, 0) : own;
}

bool CRegistryPlatform::WriteSetting(const std::string& key, const std::string& value)
{
    const std::wstring text = WideText(value);
    const auto byteCount = static_cast<DWORD>((text.size() + 1) * sizeof(wchar_t));
    return m_bWriting && RegSetKeyValueW(HKEY_CURRENT_USER, kSettings, WideText(key).c_str(), REG_SZ,
                                         text.c_str(), byteCount) == ERROR_SUCCESS;
}

std::string CRegistryPlatform::ReadHostKey(const std::string& keyPath, const std::string& valueName) const
{
    for (const DWORD view : kViews)
    {
        std::string text = ReadText(HKEY_LOCAL_MACHINE, WideText(keyPath), WideText(valueName), view);
        if (!text.empty())
            return text;
    }
    return {};
}

std::string CRegistryPlatform::DocumentsFolder() const
{
    PWSTR path = nullptr;
    const HRESULT result = SHGetKnownFolderPath(FOLDERID_Documents, KF_FLAG_DEFAULT, nullptr, &path);
    std::string folder = SUCCEEDED(result) ? NarrowText(path) : std::string();
    CoTaskMemFree(path);
    return folder;
}

bool CRegistryPlatform::MakeFolder(const std::string& path)
{
    return m_bWriting && CreateFolder(path);
}

uint32_t CRegistryPlatform::ThreadLocale() const
{
    return GetThreadLocale();
}

} // namespace gw
