#pragma once

#include <cstdint>

namespace gw {

/// What the reader of CHB files throws, and nothing else does. The facade catches it.
struct ERROBJ
{
    int32_t code;   ///< 2, always
    char where[80]; ///< which line of which source gave up
    char what[256]; ///< how many keywords had been read, where one of them or a frame's number is wrong; else
                    ///< empty
};

} // namespace gw
