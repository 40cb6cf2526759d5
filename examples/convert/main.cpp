// convert SOURCE PROFILE OUTPUT
#include <cstdio>
#include <gaitwright/gaitwright.h>

int main(int argc, char** argv)
{
    if (argc != 4)
        return 2;
    const auto motion = gaitwright::Load(argv[1]);
    const auto result = motion ? gaitwright::Convert(*motion, {.mapName = argv[2]}) : motion.Error();
    const auto saved = result ? result->Save(argv[3]) : result.Error();
    if (!saved)
        std::fprintf(stderr, "%s\n", gaitwright::Line(saved.Error()).c_str());
    return saved ? 0 : 1;
}
