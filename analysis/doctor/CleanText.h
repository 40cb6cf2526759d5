#pragma once

#include <string>
#include <string_view>

namespace gw {

class CFindings;

/// Returns whether a file is a Git LFS pointer, present because the actual file was not fetched.
bool IsLfsPointer(std::string_view text);

/// Removes everything that is not allowed in a motion file: byte order mark, control characters, typographic
/// blanks and signs, carriage returns without a line feed. Each is a finding. Returns the text itself if it
/// is clean, otherwise `clean`, which receives the result; empty if the bytes are not text at all.
std::string_view CleanText(std::string_view text, std::string& clean, CFindings& findings);

} // namespace gw
