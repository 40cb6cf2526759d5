#include "FuzzTarget.h"

#include "CMemoryBudget.h"
#include "Paths.h"

#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <system_error>

namespace gw {

namespace {

// A separate folder per process, so that several can run at the same time.
class CScratchFolder
{
public:
    CScratchFolder()
    {
        std::string name = (std::filesystem::temp_directory_path() / "gaitwright-fuzz-XXXXXX").string();
        Require(mkdtemp(name.data()) != nullptr, "there is a temporary folder");
        m_kPath = WithSeparator(name);
    }
    ~CScratchFolder()
    {
        std::error_code error;
        std::filesystem::remove_all(m_kPath, error);
    }
    CScratchFolder(const CScratchFolder&) = delete;
    CScratchFolder& operator=(const CScratchFolder&) = delete;

    const std::string& Path() const { return m_kPath; }

private:
    std::string m_kPath;
};

} // namespace

void Require(bool holds, const char* promise)
{
    if (holds)
        return;
    std::fprintf(stderr, "broken: %s\n", promise);
    std::abort();
}

std::string_view TextOf(std::span<const std::byte> input)
{
    return {reinterpret_cast<const char*>(input.data()), input.size()};
}

std::string ScratchPath(std::string_view name)
{
    static const CScratchFolder folder;
    return folder.Path() + std::string(name);
}

std::string ScratchFile(std::string_view name, std::span<const std::byte> bytes)
{
    std::string path = ScratchPath(name);
    std::FILE* const file = std::fopen(path.c_str(), "wb");
    Require(file != nullptr, "the scratch folder takes files");
    const bool written = std::fwrite(bytes.data(), 1, bytes.size(), file) == bytes.size();
    Require(std::fclose(file) == 0 && written, "the scratch folder takes files");
    return path;
}

} // namespace gw

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    const gw::CMemoryBudget budget(size);
    gw::FuzzOne(std::as_bytes(std::span(data, size)));
    return 0;
}
