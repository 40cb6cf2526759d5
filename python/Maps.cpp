// Bone maps: read, chosen, drafted and written.

#include "Values.h"

namespace gaitwright::python {

namespace {

BoneMap ReadMap(const py::object& nameOrPath, const py::object& dataFolder)
{
    const std::string name = PathOf(nameOrPath);
    const std::string folder = FolderOf(dataFolder);
    return Unwrap(Released([&] { return LoadMap(name, folder); }));
}

BoneMap MapOfText(const py::object& text)
{
    const std::string bytes = BytesOf(text, "text");
    return Unwrap(Released([&] { return ParseMap(bytes); }));
}

void SaveMap(const BoneMap& map, const py::object& path, bool overwrite)
{
    const std::string file = PathOf(path);
    Unwrap(Released([&] { return map.Save(file, overwrite ? Existing::Replace : Existing::Keep); }));
}

template <class Function>
auto ForMotion(Function function)
{
    return [function](const Motion& motion, const py::object& dataFolder) {
        const std::string folder = FolderOf(dataFolder);
        return Unwrap(Released([&] { return function(motion, folder); }));
    };
}

void AddRecords(py::module_& module)
{
    Record<MapRow>(module, "MapRow", "A row of a bone map: which source bone drives a target bone.")
        .Field("target", &MapRow::target, "Bone of the target skeleton")
        .Field("source", &MapRow::source, "Bone of the source; empty for a bone that keeps its rest pose")
        .Field("rotation", &MapRow::rotation, "Offset about X, Y and Z in degrees")
        .Field("axes", &MapRow::axes, "Codes of the source axes that drive X, Y and Z");

    Record<MapChoice>(module, "MapChoice", "A bone map as it fits a motion.")
        .Field("map", &MapChoice::map, "The BoneMap")
        .Field("fits", &MapChoice::fits, "All rows name bones of the motion, and one drives the root")
        .Field("row_count", &MapChoice::rowCount, "Rows of the map")
        .Field("found_count", &MapChoice::foundCount, "Rows whose bones exist")
        .Field("adapted", &MapChoice::adapted,
               "The common prefix of the motion's names was added to the rows")
        .Field("sureness", &MapChoice::sureness,
               "\"sure\", \"likely\" or \"doubtful\"; a doubtful map is used only if you pass it")
        .Field("doubts", &MapChoice::doubts, "What speaks against it, one sentence each");

    Record<SuggestedRow>(module, "SuggestedRow", "A row of a drafted map, with its evidence.")
        .Field("row", &SuggestedRow::row, "The MapRow")
        .Field("joint", &SuggestedRow::joint, "What the source bone is in its body: \"left upper arm\"")
        .Field("kind", &SuggestedRow::kind,
               "\"turned\", \"neutral\", \"fixed\"; \"no-source\" and \"no-name\" are not in the map")
        .Field("sureness", &SuggestedRow::sureness,
               "\"sure\", \"likely\" or \"unsure\"; empty for rows without a source")
        .Field("evidence", &SuggestedRow::evidence,
               "\"name-and-shape\", \"name\", \"shape\", \"shape-against-name\" or \"none\"")
        .Field("doubts", &SuggestedRow::doubts, "Codes")
        .Field(
            "rest_error", &SuggestedRow::restError,
            "Angle in degrees between both bones' directions in the source's rest pose; None if one of them\n"
            "has no direction");

    Record<Suggestion>(module, "Suggestion", "A bone map that was drafted for a skeleton.")
        .Field("map", &Suggestion::map, "The BoneMap")
        .Field("rows", &Suggestion::rows, "Its rows with their evidence, also those that are not in the map")
        .Field("sure", &Suggestion::sure,
               "Every main row is sure; convert(draft=True) uses only such a draft")
        .Field("why_not_sure", &Suggestion::whyNotSure, "Sentence; empty if sure")
        .Field("sides_are_sure", &Suggestion::sidesAreSure, "Names or poses show which side is left")
        .Field("rest_is_stance", &Suggestion::restIsStance, "The rest pose is a standing pose");
}

} // namespace

void AddMaps(py::module_& module)
{
    py::class_<BoneMap>(module, "BoneMap", "A bone map, also called profile.")
        .def_property_readonly(
            "name", [](const BoneMap& self) { return ToPython(self.Name()); }, "Display name: \"Poser BVH\"")
        .def_property_readonly(
            "path", [](const BoneMap& self) { return ToPython(self.Path()); },
            "File that it was read from; empty without one")
        .def_property_readonly("frame_rate", &BoneMap::FrameRate,
                               "Rate of its sources in frames per second, by which results are timed")
        .def_property_readonly(
            "rows", [](const BoneMap& self) { return TupleOf(self.Rows()); },
            "Its rows, as a tuple of MapRow")
        .def(
            "text", [](const BoneMap& self) { return ToPython(Unwrap(self.Text())); },
            "text($self)\n--\n\nReturn the text of its .prf file.")
        .def("save", &SaveMap, py::arg("path"), py::kw_only(), py::arg("overwrite") = true,
             "save($self, path, *, overwrite=True)\n--\n\n"
             "Write it as a .prf file. With overwrite=False, an existing file is kept and Error is raised "
             "with\n"
             "the reason \"exists\".")
        .def("__repr__", [](const BoneMap& self) {
            return py::str("<gaitwright.BoneMap {!r}: {} rows>")
                .format(ToPython(self.Name()), self.Rows().size());
        });
    AddRecords(module);

    const auto folder = [] { return py::arg("data_folder") = py::none(); };
    module.def("load_map", &ReadMap, py::arg("name_or_path"), py::kw_only(), folder(),
               "load_map(name_or_path, *, data_folder=None)\n--\n\n"
               "Read a bone map: an installed one by its display name, or a file by its path.\n\n"
               "data_folder: here and in other functions, folder with the target skeleton base.htr and the\n"
               "    installed bone maps; None for the one that was installed with the library");
    module.def("parse_map", &MapOfText, py::arg("text"),
               "parse_map(text)\n--\n\nRead a bone map from the text of a .prf file, str or bytes.");
    module.def(
        "installed_maps",
        [](const py::object& dataFolder) {
            const std::string path = FolderOf(dataFolder);
            return TupleOf(Unwrap(Released([&] { return InstalledMaps(path); })));
        },
        py::kw_only(), folder(),
        "installed_maps(*, data_folder=None)\n--\n\n"
        "Return the installed bone maps and those in the user's own folder, as a tuple of BoneMap.");
    module.def(
        "rank_maps",
        [](const Motion& motion, const py::object& dataFolder) {
            return TupleOf(ForMotion(&RankMaps)(motion, dataFolder));
        },
        py::arg("motion"), py::kw_only(), folder(),
        "rank_maps(motion, *, data_folder=None)\n--\n\n"
        "Return these maps as they fit a motion, best first, as a tuple of MapChoice.");
    module.def("choose_map", ForMotion(&ChooseMap), py::arg("motion"), py::kw_only(), folder(),
               "choose_map(motion, *, data_folder=None)\n--\n\n"
               "Return the map that convert() uses by default, as a MapChoice.\n\n"
               "Raises Error if none fits, or if the best one is doubtful.");
    module.def(
        "suggest", ForMotion(&Suggest), py::arg("motion"), py::kw_only(), folder(),
        "suggest(motion, *, data_folder=None)\n--\n\n"
        "Draft a bone map for the skeleton of a motion, by the names of its joints and their shape.\n\n"
        "Returns a Suggestion. Raises Error with the reason \"no-body\" if no human body is found.");
}

} // namespace gaitwright::python
