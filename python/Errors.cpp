// Failures: gaitwright.Error, and messages about what succeeded.

#include "Values.h"

namespace gaitwright::python {

namespace {

const char* const kErrorDoc = "An operation failed. str() is one line for people: \"walk.bvh:12: an empty "
                              "line where it is not allowed\".\n\n"
                              "reason: fixed short code for programs, such as \"not-found\"\n"
                              "path: file concerned; may be empty\n"
                              "line: line of a text file, starting at 1; 0 if unknown\n"
                              "byte: same for a binary file\n"
                              "name: bone, keyword, class or text concerned; may be empty\n"
                              "words: sentence for people, with the remedy if there is one";

// Attributes of an instance, so that errors can be pickled and sent to another process.
void SetFields(const py::object& error, const Failure& failure)
{
    error.attr("reason") = ToPython(failure.reason);
    error.attr("path") = ToPython(failure.path);
    error.attr("line") = failure.line;
    error.attr("byte") = failure.byte;
    error.attr("name") = ToPython(failure.name);
    error.attr("words") = ToPython(failure.words);
}

} // namespace

void Raise(const Failure& failure)
{
    const py::object type = py::module_::import("gaitwright").attr("Error");
    const py::object error = type(ToPython(Line(failure)));
    SetFields(error, failure);
    PyErr_SetObject(type.ptr(), error.ptr());
    throw py::error_already_set();
}

void AddErrors(py::module_& module)
{
    const py::object error = py::reinterpret_steal<py::object>(
        PyErr_NewExceptionWithDoc("gaitwright.Error", kErrorDoc, PyExc_Exception, nullptr));
    SetFields(error, {});
    module.attr("Error") = error;

    Record<Failure>(module, "Message", "What the user of a motion should know. str() is one line for people.")
        .Field("severity", &Failure::severity, "\"error\", \"warning\" or \"note\"")
        .Field("reason", &Failure::reason, "Fixed short code for programs")
        .Field("path", &Failure::path, "File concerned; may be empty")
        .Field("line", &Failure::line, "Line of a text file, starting at 1; 0 if unknown")
        .Field("byte", &Failure::byte, "Same for a binary file")
        .Field("name", &Failure::name, "Bone, keyword, class or text concerned; may be empty")
        .Field("words", &Failure::words, "Sentence for people")
        .def("__str__", [](const Failure& failure) { return ToPython(Line(failure)); });
}

} // namespace gaitwright::python
