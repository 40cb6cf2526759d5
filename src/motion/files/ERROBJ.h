#pragma once

#include <cstdint>

namespace gw {

/// Thrown only by the reader of CHB files, and caught by CMotionFile.
struct ERROBJ
{
    int32_t code;   ///< always 2
    char where[80]; ///< source line that failed
    char what[256]; ///< number of keywords read, if a keyword or frame number is wrong; otherwise empty
};

} // namespace gw
