#include "TemporaryFiles.h"

#include "CreatePrivateFolder.h"
#include "Files.h"
#include "Paths.h"
#include "Processes.h"
#include "SystemError.h"

#include <cstdint>

namespace gw {

namespace {

constexpr int kAttempts = 100; // names are random, so one is nearly always enough

std::string RandomName()
{
    constexpr char kLetters[] = "abcdefghijklmnopqrstuvwxyz012345";
    std::string name;
    uint32_t bits = RandomNumber();
    for (int i = 0; i < 6; ++i, bits >>= 5)
        name += kLetters[bits & 31];
    return name;
}

// Tries names until one is free. `create` returns false, with a system error, if it cannot use a name.
template <class Create>
std::string CreateNamed(const std::string& prefix, std::string_view suffix, Create create)
{
    const std::string folder = TemporaryFolder();
    for (int i = 0; i < kAttempts && !folder.empty(); ++i)
    {
        std::string path = folder + prefix + RandomName() + std::string(suffix);
        if (create(path))
            return path;
        KeepSystemError();
        if (!IsNameTaken(LastSystemError()))
            break;
    }
    return {};
}

} // namespace

std::string CreateTemporaryFile(std::string_view extension)
{
    return CreateNamed("gaitwright-", extension, [](const std::string& path) {
        const int file = OpenFile(path, EOpen::New, 0600);
        return file >= 0 && CloseFile(file);
    });
}

std::string CreateTemporaryFolder(std::string_view purpose)
{
    const std::string prefix = "gaitwright-" + std::string(purpose) + '-';
    std::string folder = CreateNamed(prefix, "", CreatePrivateFolder);
    return WithSeparator(std::move(folder));
}

} // namespace gw
