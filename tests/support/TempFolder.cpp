#include "TempFolder.h"

#include "Paths.h"

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <gtest/gtest.h>
#include <iterator>
#include <system_error>

namespace gw {

CTempFolder::CTempFolder()
{
    std::string name = (std::filesystem::temp_directory_path() / "gaitwright-test-XXXXXX").string();
    if (mkdtemp(name.data()))
        m_kPath = WithSeparator(name);
    EXPECT_FALSE(m_kPath.empty()) << "no temporary folder";
}

CTempFolder::~CTempFolder()
{
    std::error_code error;
    if (!m_kPath.empty())
        std::filesystem::remove_all(m_kPath, error);
}

void WriteBytes(const std::string& path, std::string_view bytes)
{
    std::ofstream file(path, std::ios::binary | std::ios::trunc);
    file.write(bytes.data(), static_cast<std::streamsize>(bytes.size()));
    file.close();
    EXPECT_TRUE(file.good()) << path;
}

std::string ReadBytes(const std::string& path)
{
    std::ifstream file(path, std::ios::binary);
    EXPECT_TRUE(file.good()) << path;
    return {std::istreambuf_iterator<char>(file), {}};
}

std::string SharedDataFolder()
{
    const char* const folder = std::getenv("GAITWRIGHT_TEST_DATA");
    return folder && FolderExists(folder) ? WithSeparator(folder) : std::string();
}

} // namespace gw
