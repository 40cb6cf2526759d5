// convert SOURCE.bvh PROFILE.prf OUTPUT.Kinetra
#include <ConvertMotionFile.h>
#include <Notice.h>
#include <cstdio>

int main(int argc, char** argv)
{
    if (argc != 4)
        return 2;
    const gw::MotionFileResult result = gw::ConvertMotionFile({argv[1], argv[2], argv[3], DATA_FOLDER, {}});
    for (const gw::Notice& notice : result.notices)
        std::fprintf(stderr, "%s\n", gw::NoticeLine(notice).c_str());
    return result.written ? 0 : 1;
}
