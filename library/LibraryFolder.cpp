// The engine looks for its data and its modules from the folder of its programs. In a foreign program, that
// is the folder next to this library: "gaitwright" in an installation, its own folder in a build.

#include "Paths.h"

#include <filesystem>

#include <dlfcn.h>

namespace gaitwright {

namespace {

std::string ProgramFolder()
{
    static const char here = 0;
    Dl_info library = {};
    std::error_code error;
    if (dladdr(&here, &library) == 0)
        return {};
    const std::string folder =
        gw::SplitPath(std::filesystem::canonical(library.dli_fname, error).string()).folder;
    const std::string programs = folder + "gaitwright";
    return gw::FolderExists(programs) ? programs : folder;
}

// When the library is loaded, before any of its functions can be called.
[[maybe_unused]] const bool kIsFolderSet = [] {
    try
    {
        gw::SetExecutableFolder(ProgramFolder());
        return true;
    } catch (const std::exception&)
    {
        return false; // data are then looked for next to the program
    }
}();

} // namespace

} // namespace gaitwright
