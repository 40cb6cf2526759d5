#pragma once

#include "CFailure.h"
#include "CSafeFile.h"

#include <cstddef>
#include <cstdint>
#include <span>
#include <string>

namespace gw {

/// What stands in the info block of a package.
struct PackageInfo
{
    uint32_t format = 0; ///< of the motion file: FormatCode
    float third = 0.0f;
    float fourth = 0.0f;
};

/// The code of a motion file's format by the end of its name, 0 for an unknown one.
uint32_t FormatCode(const std::string& path);

/// A Kinetra package on its way into a file that is replaced in one step: a container with an empty node and
/// the custom data "MotionInfo" and "MotionFile". The motion comes in pieces and is never in memory as a
/// whole, nor does it lie in a file of its own.
class CPackageFile
{
public:
    /// Starts writing beside a destination, with all that stands before the motion.
    bool Open(const std::string& path, const PackageInfo& info);
    /// The next bytes of the motion. False where the file system does not take them or no container is that
    /// large; Commit will then fail too.
    bool Write(std::span<const std::byte> motion);
    /// Tells the motion's size and puts the file in its place. False leaves the destination untouched.
    bool Commit();
    /// Why it failed: TooLarge or WriteError.
    EFailure Failure() const { return m_eFailure; }

private:
    bool Keep(bool written);

    CSafeFile m_kFile;
    size_t m_uiHeadBytes = 0;
    uint64_t m_uiMotionBytes = 0;
    EFailure m_eFailure = EFailure::None;
};

} // namespace gw
