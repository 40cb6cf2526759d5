#include "TempFolder.h"

#include "NativePath.h"
#include "Paths.h"
#include "Processes.h"

#include <filesystem>
#include <fstream>
#include <gtest/gtest.h>
#include <iterator>
#include <system_error>

namespace gw {

CTempFolder::CTempFolder()
    : m_kPath(TemporaryFolder() + "gaitwright-test-" + std::to_string(RandomNumber()) + kPathSeparator)
{
    EXPECT_FALSE(FolderExists(m_kPath)) << m_kPath;
    EXPECT_TRUE(CreateFolder(m_kPath)) << m_kPath;
}

CTempFolder::~CTempFolder()
{
    std::error_code error;
    std::filesystem::remove_all(NativePath(m_kPath), error);
}

void WriteBytes(const std::string& path, std::string_view bytes)
{
    std::ofstream file(NativePath(path), std::ios::binary | std::ios::trunc);
    file.write(bytes.data(), static_cast<std::streamsize>(bytes.size()));
    file.close();
    EXPECT_TRUE(file.good()) << path;
}

std::string ReadBytes(const std::string& path)
{
    std::ifstream file(NativePath(path), std::ios::binary);
    EXPECT_TRUE(file.good()) << path;
    return {std::istreambuf_iterator<char>(file), {}};
}

std::string ReadText(const std::string& path)
{
    std::string text = ReadBytes(path);
    for (size_t end = 0; kLineEnd != "\n" && (end = text.find(kLineEnd, end)) != text.npos; ++end)
        text.replace(end, kLineEnd.size(), "\n");
    return text;
}

bool MakeLink(const std::string& target, const std::string& path)
{
    std::error_code error;
    std::filesystem::create_symlink(NativePath(target), NativePath(path), error);
    return !error;
}

std::string SharedDataFolder()
{
    const std::string folder = EnvironmentVariable("GAITWRIGHT_TEST_DATA");
    return FolderExists(folder) ? WithSeparator(folder) : std::string();
}

} // namespace gw
