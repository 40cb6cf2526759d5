#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <string>
#include <vector>

namespace gw {

/// What a program may take before it is killed.
struct ChildLimits
{
    double seconds = 0.0;
    size_t outputBytes = 0;
};

enum class EChildEnd : uint8_t
{
    Finished, ///< it exited by itself, with any exit code
    Missing,  ///< it could not be started
    Died,     ///< a signal ended it
    TimedOut,
    TooMuch, ///< it wrote more than allowed
};

/// Runs a program and collects what it writes to its standard output. Its standard input is empty, and what
/// it writes to its standard error is discarded. The program gets none of this one's open files. `wait` is
/// called several times a second until it ends; if that throws, the program is killed.
EChildEnd RunChild(const std::string& program, const std::vector<std::string>& arguments,
                   const ChildLimits& limits, std::vector<std::byte>& output,
                   const std::function<void()>& wait = {});

} // namespace gw
