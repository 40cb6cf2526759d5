// Runs a target on files and folders of files, in builds without a fuzzer. Succeeds only if every input does.

#include <algorithm>
#include <cstdint>
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>
#include <vector>

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size);

namespace fs = std::filesystem;

namespace {

std::vector<fs::path> InputsOf(int argc, char** argv)
{
    std::vector<fs::path> paths;
    for (int i = 1; i < argc; ++i)
    {
        if (!fs::is_directory(argv[i]))
            paths.emplace_back(argv[i]);
        else
            std::ranges::copy(fs::directory_iterator(argv[i]), std::back_inserter(paths));
    }
    std::ranges::sort(paths);
    return paths;
}

void Replay(const fs::path& path)
{
    std::ifstream file(path, std::ios::binary);
    const std::vector<char> bytes(std::istreambuf_iterator<char>(file), {});
    std::fprintf(stderr, "%s (%zu bytes)\n", path.c_str(), bytes.size());
    LLVMFuzzerTestOneInput(reinterpret_cast<const uint8_t*>(bytes.data()), bytes.size());
}

} // namespace

int main(int argc, char** argv)
{
    const std::vector<fs::path> paths = InputsOf(argc, argv);
    std::ranges::for_each(paths, Replay);
    return paths.empty() ? 1 : 0; // replaying nothing must not count as success
}
