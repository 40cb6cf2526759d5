// Conversions: options as keywords, the result, and its figures.

#include "Values.h"

#include <pybind11/stl.h>

namespace gaitwright::python {

namespace {

const char* const kFramesHelp =
    "frames must be a pair (first, last) of numbers, both ends included; None in it "
    "is the start or the end";

int64_t FrameOf(const py::object& frame, int64_t missing)
{
    if (frame.is_none())
        return missing;
    const py::object number = py::reinterpret_steal<py::object>(PyNumber_Index(frame.ptr()));
    if (!number)
    {
        PyErr_Clear();
        throw py::type_error(kFramesHelp);
    }
    const long long value = PyLong_AsLongLong(number.ptr());
    if (value == -1 && PyErr_Occurred())
        throw py::error_already_set();
    return value;
}

FrameRange RangeOf(const py::object& frames)
{
    if (frames.is_none())
        return {};
    if ((!py::isinstance<py::tuple>(frames) && !py::isinstance<py::list>(frames)) || py::len(frames) != 2)
        throw py::type_error(kFramesHelp);
    const FrameRange range{FrameOf(frames[py::int_(0)], 0), FrameOf(frames[py::int_(1)], INT64_MAX)};
    if (range.first < 0 || range.last < range.first)
        throw py::value_error("frames must start at 0 or later, and must not end before they start");
    return range;
}

Conversion ConvertMotion(const Motion& motion, const py::object& map, bool draft, bool align, bool faithful,
                         bool hands, bool legs, const py::object& frames, bool inPlace, bool mirror,
                         const py::object& dataFolder)
{
    ConvertOptions options{.draft = draft,
                           .align = align,
                           .faithful = faithful,
                           .hands = hands,
                           .legs = legs,
                           .frames = RangeOf(frames),
                           .inPlace = inPlace,
                           .mirror = mirror,
                           .dataFolder = FolderOf(dataFolder)};
    if (py::isinstance<BoneMap>(map))
        options.map = map.cast<BoneMap>();
    else if (py::isinstance<MapChoice>(map) || py::isinstance<Suggestion>(map))
        throw py::type_error("map must be a BoneMap, a name or a path; pass the choice's .map");
    else
        options.mapName = FolderOf(map);
    return Unwrap(Released([&] { return Convert(motion, options); }));
}

void SaveConversion(const Conversion& conversion, const py::object& path, bool overwrite)
{
    const std::string file = PathOf(path);
    Unwrap(Released([&] { return conversion.Save(file, overwrite ? Existing::Replace : Existing::Keep); }));
}

py::bytes ConversionBytes(const Conversion& conversion, const std::string& format)
{
    return ToPython(Unwrap(Released([&] { return conversion.Bytes(format); })));
}

py::dict Check(const Conversion& conversion)
{
    return DictOf(Unwrap(Released([&] { return conversion.Check(); })));
}

} // namespace

void AddConversions(py::module_& module)
{
    py::class_<Conversion>(module, "Conversion", "A finished conversion; see convert().")
        .def_property_readonly(
            "result", [](const Conversion& self) { return self.Result(); },
            "The Motion of the target skeleton, in millimeters with Y up, with one frame per frame of the "
            "source")
        .def_property_readonly(
            "map", [](const Conversion& self) { return self.Map(); },
            "The MapChoice that was used, and how well it fits")
        .def_property_readonly("is_drafted", &Conversion::IsDrafted, "The map was drafted for this motion")
        .def_property_readonly(
            "warnings", [](const Conversion& self) { return TupleOf(self.Warnings()); },
            "Warnings of the conversion, without those of the source's reader, as a tuple of Message")
        .def_property_readonly(
            "corrections", [](const Conversion& self) { return ToPython(self.Corrections()); },
            "What align corrected: \"4 bones off their axes at rest\"; may be empty")
        .def("check", &Check,
             "check($self)\n--\n\n"
             "Measure how faithful the conversion is, before frames, in_place and mirror. Returns a dict.\n\n"
             "Names and values are those of \"check\" in `gaitwright convert --check --json`; in addition, "
             "each\n"
             "foot lists its kneePopFrames, and keyFigures has the figures that summarize the quality. "
             "Angles\n"
             "are in degrees, lengths in mm of the result; None is a figure that the motion does not have. "
             "The\n"
             "first call computes the figures.")
        .def(
            "save", &SaveConversion, py::arg("path"), py::kw_only(), py::arg("overwrite") = true,
            "save($self, path, *, overwrite=True)\n--\n\n"
            "Write the result in the format of the path's extension: .Kinetra or .htr with 120 frames per\n"
            "second if the map's rate is that of the source, .bvh or .glb with the source's frames.\n\n"
            "The file is complete or not written at all. With overwrite=False, an existing file is kept and\n"
            "Error is raised with the reason \"exists\".")
        .def("bytes", &ConversionBytes, py::arg("format"),
             "bytes($self, format)\n--\n\n"
             "Return the bytes of such a file. format is its extension, with or without the dot.")
        .def("__repr__", [](const Conversion& self) {
            return py::str("<gaitwright.Conversion by {!r}: {} frames>")
                .format(ToPython(self.Map().map.Name()), self.Result().FrameCount());
        });

    module.def(
        "convert", &ConvertMotion, py::arg("motion"), py::kw_only(), py::arg("map") = py::none(),
        py::arg("draft") = false, py::arg("align") = false, py::arg("faithful") = false,
        py::arg("hands") = true, py::arg("legs") = true, py::arg("frames") = py::none(),
        py::arg("in_place") = false, py::arg("mirror") = false, py::arg("data_folder") = py::none(),
        "convert(motion, *, map=None, draft=False, align=False, faithful=False, hands=True, legs=True, "
        "frames=None, in_place=False, mirror=False, data_folder=None)\n--\n\n"
        "Convert a motion to the target skeleton. The motion does not change. Returns a Conversion.\n\n"
        "map: BoneMap, or the name of an installed one, or a path; None for the one that fits\n"
        "draft: if no installed map fits, draft one, and use it if its main rows are sure\n"
        "align: re-express the source relative to a T-pose first\n"
        "faithful: keep trunk, hips, knees and feet close to the source; pin planted feet\n"
        "hands: with faithful, keep hands where they touch\n"
        "legs: plant the feet where the source's feet are planted\n"
        "frames: pair (first, last) of frames to keep, both ends included\n"
        "in_place: cancel the horizontal travel; heights are kept\n"
        "mirror: exchange left and right\n"
        "data_folder: see load_map()");
}

} // namespace gaitwright::python
