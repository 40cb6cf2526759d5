#include "Values.h"

namespace gaitwright::python {

namespace {

py::object Steal(PyObject* object)
{
    if (!object)
        throw py::error_already_set();
    return py::reinterpret_steal<py::object>(object);
}

} // namespace

std::string PathOf(const py::object& path)
{
    PyObject* bytes = nullptr;
    if (!PyUnicode_FSConverter(path.ptr(), &bytes))
        throw py::error_already_set();
    return py::reinterpret_steal<py::bytes>(bytes);
}

std::string FolderOf(const py::object& path)
{
    return path.is_none() ? std::string() : PathOf(path);
}

std::string BytesOf(const py::object& text, const char* what)
{
    if (py::isinstance<py::bytes>(text))
        return py::reinterpret_borrow<py::bytes>(text);
    if (!py::isinstance<py::str>(text))
        throw py::type_error(std::string(what) + " must be str or bytes, not " +
                             Py_TYPE(text.ptr())->tp_name);
    const py::object bytes = Steal(PyUnicode_AsEncodedString(text.ptr(), "utf-8", "surrogateescape"));
    return py::reinterpret_borrow<py::bytes>(bytes);
}

py::str ToPython(const std::string& text)
{
    return Steal(PyUnicode_DecodeUTF8(text.data(), static_cast<py::ssize_t>(text.size()), "surrogateescape"));
}

py::bytes ToPython(const std::vector<std::byte>& bytes)
{
    return {reinterpret_cast<const char*>(bytes.data()), bytes.size()};
}

py::str ToPython(Severity severity)
{
    return SeverityName(severity);
}

py::str ToPython(Sureness sureness)
{
    return SurenessName(sureness);
}

py::str Describe(const py::object& record)
{
    const py::object type = py::type::of(record);
    py::list parts;
    for (const py::handle name : type.attr("_fields"))
        parts.append(py::str("{}={!r}").format(name, py::getattr(record, name)));
    return py::str("{}({})").format(type.attr("__name__"), py::str(", ").attr("join")(parts));
}

} // namespace gaitwright::python
