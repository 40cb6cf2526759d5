// Loads a motion with libassimp and does nothing else: the reference of the whole-process benchmark.

#include <assimp/Importer.hpp>
#include <assimp/scene.h>

#include <cstdio>

int main(int argc, char** argv)
{
    Assimp::Importer importer;
    const aiScene* scene = argc > 1 ? importer.ReadFile(argv[1], 0) : nullptr;
    if (!scene)
    {
        std::fprintf(stderr, "cannot load: %s\n", importer.GetErrorString());
        return 1;
    }
    return 0;
}
