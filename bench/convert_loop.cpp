// Converts all motions of a folder one after the other in this process, as the reference for worker
// processes.
//
//   convert_loop FOLDER PROFILE OUTPUT_FOLDER
#include "ConvertMotionFile.h"
#include "Paths.h"

#include <cstdio>

int main(int argc, char** argv)
{
    if (argc != 4)
        return 2;
    const std::string folder = gw::WithSeparator(argv[1]);
    const std::string output = gw::WithSeparator(argv[3]);
    gw::CreateFolder(output);
    size_t failed = 0;
    for (const std::string& name : gw::FilesInFolder(folder, ".bvh"))
        failed +=
            !gw::ConvertMotionFile({folder + name, argv[2], output + name + ".Kinetra", {}, {}}).written;
    std::printf("%zu failed\n", failed);
    return 0;
}
