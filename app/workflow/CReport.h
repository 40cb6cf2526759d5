#pragma once

#include <cstddef>
#include <string>

namespace gw {

/// One thing that the fixed messages do not say: why an operation failed, or what a user should know although
/// it did not.
struct CReport
{
    bool warning = false;
    std::string path;  ///< the file concerned, or empty
    size_t where = 0;  ///< line from 1 on of a text, byte of a container; 0 where there is none
    std::string code;  ///< a short fixed word for programs: "blank-line"
    std::string name;  ///< bone, keyword, class or text concerned, as it stands in the file
    std::string words; ///< a sentence for people, with the remedy where there is one; safe to print
};

} // namespace gw
