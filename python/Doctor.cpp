// Examining and mending motion files.

#include "Values.h"

namespace gaitwright::python {

namespace {

Examination Examine(const py::object& path)
{
    const std::string file = PathOf(path);
    return Unwrap(Released([&] { return Doctor(file); }));
}

Examination MendFile(const py::object& path, const py::object& output, bool overwrite)
{
    const std::string from = PathOf(path);
    const std::string to = PathOf(output);
    return Unwrap(Released([&] { return Mend(from, to, overwrite ? Existing::Replace : Existing::Keep); }));
}

} // namespace

void AddDoctor(py::module_& module)
{
    Record<Finding>(module, "Finding", "Something that is wrong with a motion file.")
        .Field("severity", &Finding::severity, "\"error\", \"warning\" or \"note\"")
        .Field("reason", &Finding::reason, "Fixed short code for programs")
        .Field("line", &Finding::line, "Line, or byte of a binary file, starting at 1; 0 for the whole file")
        .Field("name", &Finding::name, "Joint, keyword or text concerned; may be empty")
        .Field("words", &Finding::words, "What is wrong")
        .Field("remedy", &Finding::remedy, "What to do about it; may be empty")
        .Field("more", &Finding::more, "Further places with the same fault")
        .Field("fixable", &Finding::fixable, "mend() repairs it");

    Record<MotionFacts>(module, "MotionFacts", "Facts about a valid motion.")
        .Field("joint_count", &MotionFacts::jointCount, "Number of joints")
        .Field("frame_count", &MotionFacts::frameCount, "Number of frames")
        .Field("frame_seconds", &MotionFacts::frameSeconds, "Time between frames in seconds")
        .Field("leg", &MotionFacts::leg, "Length of thigh and shin in the file's unit; 0 if unknown")
        .Field("unit", &MotionFacts::unit, "Unit of the file, or the one that the leg suggests; may be empty")
        .Field("up", &MotionFacts::up, "\"Y\", \"-Z\", ...; empty if unknown")
        .Field("rest_pose", &MotionFacts::restPose,
               "\"T-pose\", \"A-pose\", \"arms down\", \"other\", \"none\" or \"unknown\"")
        .Field("body", &MotionFacts::body, "How the body was found: \"names\", \"shape\" or \"none\"");

    Record<Examination>(module, "Examination", "The examination of a motion file.")
        .Field("healthy", &Examination::healthy, "No errors and no warnings")
        .Field("findings", &Examination::findings,
               "Tuple of Finding, by line; those about the whole file first")
        .Field("facts", &Examination::facts, "The MotionFacts; None if no motion could be read");

    module.def(
        "doctor", &Examine, py::arg("path"),
        "doctor(path)\n--\n\n"
        "Examine a motion file. Returns an Examination, also of a file that cannot be read as a motion.\n\n"
        "Raises Error only if the file cannot be examined at all.");
    module.def(
        "mend", &MendFile, py::arg("path"), py::arg("output"), py::kw_only(), py::arg("overwrite") = false,
        "mend(path, output, *, overwrite=False)\n--\n\n"
        "Write a copy of a BVH file without the faults that can be repaired without changing the motion.\n\n"
        "Returns the Examination of the copy. Raises Error with the reason \"not-fixable\" if there are\n"
        "only other faults, and \"exists\" if there is such a file and overwrite is False.");
}

} // namespace gaitwright::python
