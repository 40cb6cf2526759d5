#pragma once

#include <cstddef>
#include <string>

namespace gw {

class CJsonWriter;
class COrrinStream;

/// A line of a tree on standard output. Very deep levels stand below each other.
void PrintIndented(size_t depth, const std::string& line);

/// Version, roots and objects of a container, and the two data blocks of a Kinetra file, on standard output.
void PrintContainer(COrrinStream& scene);
/// Its objects as a tree, each at the first of its places.
void PrintObjects(COrrinStream& scene);
/// The same as members of a JSON object: every object with class, name, links and fields.
void WriteContainer(CJsonWriter& json, COrrinStream& scene);

} // namespace gw
