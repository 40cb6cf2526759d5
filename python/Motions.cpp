// Motions: reading, poses as arrays, and writing.

#include "Values.h"

namespace gaitwright::python {

namespace {

constexpr py::ssize_t kMatrixRows = 4;
constexpr py::ssize_t kAxes = 3;

// The bytes of an object, which cannot be resized meanwhile.
class Buffer
{
public:
    explicit Buffer(const py::object& object)
    {
        if (PyObject_GetBuffer(object.ptr(), &m_view, PyBUF_SIMPLE) != 0)
            throw py::error_already_set();
    }
    Buffer(const Buffer&) = delete;
    Buffer& operator=(const Buffer&) = delete;
    ~Buffer() { PyBuffer_Release(&m_view); }

    std::span<const std::byte> Bytes() const
    {
        return {static_cast<const std::byte*>(m_view.buf), static_cast<size_t>(m_view.len)};
    }

private:
    Py_buffer m_view = {};
};

Motion LoadAny(const py::object& source, const py::object& format, const std::string& clip,
               std::optional<float> rate, bool mend)
{
    const LoadOptions options{.clip = clip, .rate = rate.value_or(0.0f), .mend = mend};
    if (!PyObject_CheckBuffer(source.ptr()))
    {
        if (!format.is_none())
            throw py::type_error("format is only for bytes; the extension of a path selects its format");
        const std::string path = PathOf(source);
        return Unwrap(Released([&] { return Load(path, options); }));
    }
    if (format.is_none())
        throw py::type_error("bytes need a format, as in load(content, \"bvh\")");
    const Buffer buffer(source);
    const std::string extension = BytesOf(format, "format");
    return Unwrap(Released([&] { return LoadBytes(buffer.Bytes(), extension, options); }));
}

// An array over the motion's memory, which keeps the motion alive.
template <class Number>
py::array View(const Motion& motion, std::span<const Number> numbers, std::vector<py::ssize_t> shape)
{
    const py::object owner = py::cast(&motion, py::return_value_policy::reference);
    py::array array(py::dtype::of<Number>(), std::move(shape), numbers.data(), owner);
    array.attr("flags").attr("writeable") = false;
    return array;
}

py::ssize_t BonesOf(const Motion& motion)
{
    return static_cast<py::ssize_t>(motion.BoneCount());
}

py::ssize_t FramesOf(const Motion& motion)
{
    return static_cast<py::ssize_t>(motion.FrameCount());
}

py::array RestPoseOf(const Motion& motion)
{
    const auto numbers = Unwrap(Released([&] { return motion.RestPose(); }));
    return View(motion, numbers, {BonesOf(motion), kMatrixRows, kMatrixRows});
}

py::array PosesOf(const Motion& motion)
{
    const auto numbers = Unwrap(Released([&] { return motion.Poses(); }));
    return View(motion, numbers, {FramesOf(motion), BonesOf(motion), kMatrixRows, kMatrixRows});
}

py::array PositionsOf(const Motion& motion)
{
    const auto numbers = Unwrap(Released([&] { return motion.Positions(); }));
    return View(motion, numbers, {FramesOf(motion), BonesOf(motion), kAxes});
}

void SaveMotion(const Motion& motion, const py::object& path, bool overwrite, float frameScale)
{
    const SaveOptions options{overwrite ? Existing::Replace : Existing::Keep, frameScale};
    const std::string file = PathOf(path);
    Unwrap(Released([&] { return motion.Save(file, options); }));
}

py::bytes MotionBytes(const Motion& motion, const std::string& format, float frameScale)
{
    return ToPython(Unwrap(Released([&] { return motion.Bytes(format, {.frameScale = frameScale}); })));
}

py::str Summary(const Motion& motion)
{
    const std::string& name = motion.Path().empty() ? motion.Format() : motion.Path();
    return py::str("<gaitwright.Motion {!r}: {} bones, {} frames>")
        .format(ToPython(name), motion.BoneCount(), motion.FrameCount());
}

void AddFacts(py::class_<Motion>& motion)
{
    motion
        .def_property_readonly(
            "path", [](const Motion& self) { return ToPython(self.Path()); },
            "Path passed to load(); empty for a motion from bytes, and for a result")
        .def_property_readonly(
            "format", [](const Motion& self) { return ToPython(self.Format()); },
            "Format as a file extension in lower case without the dot: \"bvh\"")
        .def_property_readonly(
            "warnings", [](const Motion& self) { return TupleOf(self.Warnings()); },
            "What the reader warned about and repaired, as a tuple of Message")
        .def_property_readonly(
            "clips", [](const Motion& self) { return TupleOf(self.Clips()); },
            "Names of the clips in the file; empty for formats without clips")
        .def_property_readonly(
            "clip", [](const Motion& self) { return ToPython(self.Clip()); },
            "The clip that was read; empty for formats without clips")
        .def_property_readonly("frame_count", &Motion::FrameCount, "Number of frames")
        .def_property_readonly("frame_seconds", &Motion::FrameSeconds,
                               "Time between two frames in seconds; 0 if the file does not have a usable one")
        .def_property_readonly("unit_meters", &Motion::UnitMeters,
                               "Length of a unit in meters; 0 if the format does not store it")
        .def_property_readonly("bone_count", &Motion::BoneCount, "Number of bones")
        .def_property_readonly(
            "bone_names", [](const Motion& self) { return TupleOf(self.BoneNames()); },
            "Names of the bones, parents before children. All arrays have this order.")
        .def_property_readonly(
            "parents", [](const Motion& self) { return View(self, self.Parents(), {BonesOf(self)}); },
            "Index of each bone's parent, -1 for a root: int32 array of shape (bones,), read-only");
}

} // namespace

void AddMotions(py::module_& module)
{
    py::class_<Motion> motion(module, "Motion",
                              "A skeleton, its rest pose, and its poses at every frame; see load().");
    AddFacts(motion);
    motion.def("__repr__", &Summary)
        .def("rest_pose", &RestPoseOf,
             "rest_pose($self)\n--\n\n"
             "Return the rest pose as world matrices: float32 array of shape (bones, 4, 4), read-only.")
        .def(
            "poses", &PosesOf,
            "poses($self)\n--\n\n"
            "Return all poses as world matrices: float32 array of shape (frames, bones, 4, 4), read-only.\n\n"
            "The first call computes them; all calls return the same memory.")
        .def("positions", &PositionsOf,
             "positions($self)\n--\n\n"
             "Return the positions x, y, z of all joints in world space, in the unit of the file: float32\n"
             "array of shape (frames, bones, 3), read-only.\n\n"
             "The first call computes them; all calls return the same memory.")
        .def(
            "save", &SaveMotion, py::arg("path"), py::kw_only(), py::arg("overwrite") = true,
            py::arg("frame_scale") = 1.0f,
            "save($self, path, *, overwrite=True, frame_scale=1.0)\n--\n\n"
            "Write the motion in the format of the path's extension, .bvh or .glb; a motion of the format\n"
            "HTR, and a result, also as .htr.\n\n"
            "The file is complete or not written at all. With overwrite=False, an existing file is kept and\n"
            "Error is raised with the reason \"exists\". frame_scale is for HTR: factor for the number of\n"
            "frames, over the same time.")
        .def("bytes", &MotionBytes, py::arg("format"), py::kw_only(), py::arg("frame_scale") = 1.0f,
             "bytes($self, format, *, frame_scale=1.0)\n--\n\n"
             "Return the bytes of such a file. format is its extension, with or without the dot.");

    module.def(
        "load", &LoadAny, py::arg("source"), py::arg("format") = py::none(), py::kw_only(),
        py::arg("clip") = "", py::arg("rate") = py::none(), py::arg("mend") = false,
        "load(source, format=None, *, clip='', rate=None, mend=False)\n--\n\n"
        "Read a motion from a path, or from bytes with their format.\n\n"
        "source: path, whose extension selects the format: .bvh, .htr, .cha, .chb, a container with keys\n"
        "    (.orn), the motion in a Kinetra file (.kinetra), or .fbx, .gltf, .glb, .vrm, .dae, which\n"
        "    need the package gaitwright-import; or bytes, bytearray or another contiguous buffer\n"
        "format: such an extension, with or without the dot; required for bytes\n"
        "clip: name of the clip of a file with several, case ignored; empty for the longest\n"
        "rate: frames per second in place of the file's; None for the file's own\n"
        "mend: read a damaged BVH file repaired, as far as that is safe");
}

} // namespace gaitwright::python
