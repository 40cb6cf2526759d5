#include "Values.h"

PYBIND11_MODULE(gaitwright, module)
{
    using namespace gaitwright::python;

    py::options options;
    options.disable_function_signatures(); // docstrings begin with the ones that help() shows
    module.doc() =
        "Reads motions, converts them to the target skeleton, measures and writes the results.\n\n"
        "Arrays are numpy arrays of 32-bit floats over the library's memory, read-only and not\n"
        "copied; a motion lives as long as its arrays. Matrices are for row vectors: a point p of a\n"
        "bone is at p @ M in world space, and M[3, :3] is the bone's position. Lengths are in the\n"
        "unit of the motion's file, and in millimeters with Y up for results. Angles are in degrees.\n"
        "Frames start at 0.\n\n"
        "Failures raise gaitwright.Error. All functions can be called by several threads, and let\n"
        "other threads run meanwhile.";
    module.attr("__version__") = gaitwright::LibraryVersion();
    AddErrors(module);
    AddMotions(module);
    AddMaps(module);
    AddConversions(module);
    AddDoctor(module);
}
