#pragma once

// How values cross between Python and the library. Text that is not UTF-8, such as a bone's name in an old
// file, becomes text with surrogates, as Python itself does with paths; it converts back to the same bytes.

#include <gaitwright/gaitwright.h>
#include <pybind11/numpy.h>
#include <pybind11/pybind11.h>

namespace gaitwright::python {

namespace py = pybind11;

/// Calls a function of the library while other Python threads run, and returns its result.
template <class Work>
auto Released(const Work& work)
{
    const py::gil_scoped_release released;
    return work();
}

/// Raises a failure as gaitwright.Error.
[[noreturn]] void Raise(const Failure& failure);

/// Returns the value, or raises the failure.
template <class Value>
Value Unwrap(Outcome<Value> outcome)
{
    if (!outcome)
        Raise(outcome.Error());
    if constexpr (!std::is_void_v<Value>)
        return *std::move(outcome);
}

/// Returns the path in a str, bytes or os.PathLike; raises TypeError for anything else.
std::string PathOf(const py::object& path);
/// Same for a path that can be None, which is empty.
std::string FolderOf(const py::object& path);
/// Returns the bytes of a str, or of bytes.
std::string BytesOf(const py::object& text, const char* what);

py::str ToPython(const std::string& text);
py::bytes ToPython(const std::vector<std::byte>& bytes);
py::str ToPython(Severity severity);
py::str ToPython(Sureness sureness);

template <class Value>
py::object ToPython(const Value& value)
{
    return py::cast(value);
}

template <class Value>
py::object ToPython(const std::optional<Value>& value)
{
    return value ? py::object(ToPython(*value)) : py::none();
}

template <class Values>
py::tuple TupleOf(const Values& values)
{
    py::tuple tuple(values.size());
    for (size_t i = 0; i < values.size(); ++i)
        tuple[i] = ToPython(values[i]);
    return tuple;
}

template <class Value>
py::object ToPython(const std::vector<Value>& values)
{
    return TupleOf(values);
}

inline py::object ToPython(const std::array<int, 3>& values)
{
    return TupleOf(values);
}

/// Returns "Name(field=value, ...)" for an object whose class lists its `_fields`.
py::str Describe(const py::object& record);

/// A class of plain values that Python can read.
template <class Type>
class Record : public py::class_<Type>
{
public:
    Record(py::module_& module, const char* name, const char* doc) : py::class_<Type>(module, name, doc)
    {
        this->attr("_fields") = py::tuple();
        this->def("__repr__", &Describe);
    }

    template <class Member>
    Record& Field(const char* name, Member Type::*member, const char* doc)
    {
        this->def_property_readonly(
            name, [member](const Type& record) -> py::object { return ToPython(record.*member); }, doc);
        const py::object fields = this->attr("_fields");
        this->attr("_fields") = fields + py::make_tuple(name);
        return *this;
    }
};

// Each adds the classes and functions of one subject to the module.
void AddErrors(py::module_& module);
void AddMotions(py::module_& module);
void AddMaps(py::module_& module);
void AddConversions(py::module_& module);
void AddDoctor(py::module_& module);

/// Returns figures as a dict, with the names of the shell program's reports.
py::dict DictOf(const Figures& figures);

} // namespace gaitwright::python
