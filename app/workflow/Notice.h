#pragma once

#include "Finding.h"

#include <cstddef>
#include <string>

namespace gw {

/// A message that is not one of the fixed ones: why an operation failed, or what the user should know
/// although it succeeded.
struct Notice
{
    ESeverity severity = ESeverity::Error;
    std::string path;  ///< the file concerned, or empty
    size_t where = 0;  ///< line of a text, starting at 1, or byte of a container; 0 if unknown
    std::string code;  ///< fixed short code for programs: "blank-line"
    std::string name;  ///< bone, keyword, class or text concerned, as written in the file
    std::string words; ///< sentence for the user, with the remedy if there is one; safe to print

    bool IsWarning() const { return severity != ESeverity::Error; }
};

/// Returns whether places in a file are bytes instead of lines.
bool IsBinary(const std::string& path);

/// Returns a notice about a whole file.
Notice MakeNotice(const std::string& path, const char* code, const std::string& words,
                  ESeverity severity = ESeverity::Error);

/// Returns the notice as one line: "walk.bvh:12: an empty line ...".
std::string NoticeLine(const Notice& notice);

} // namespace gw
