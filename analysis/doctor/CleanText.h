#pragma once

#include <string>
#include <string_view>

namespace gw {

class CFindings;

/// Whether a file is a pointer of Git LFS, which stands where the file itself was not fetched.
bool IsLfsPointer(std::string_view text);

/// The text of a motion file without what belongs into none: byte order mark, control characters, blanks and
/// signs of typesetting, carriage returns without a line feed. Each is a
/// finding. Answers the text itself where it is clean, else `clean`, which then holds it. Where the bytes are
/// no text at all the answer is empty.
std::string_view CleanText(std::string_view text, std::string& clean, CFindings& findings);

} // namespace gw
