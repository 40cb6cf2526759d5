#pragma once

#include <cstddef>
#include <string>

namespace gw {

class CJsonWriter;
class COrrinStream;

/// Prints a line of a tree. Very deep levels are not indented further.
void PrintIndented(size_t depth, const std::string& line);

/// Prints version, roots and objects of a container, and the two data blocks of a Kinetra file.
void PrintContainer(COrrinStream& scene);
/// Prints its objects as a tree, each at its first place.
void PrintObjects(COrrinStream& scene);
/// Writes the same as members of a JSON object: every object with class, name, links and fields.
void WriteContainer(CJsonWriter& json, COrrinStream& scene);

} // namespace gw
