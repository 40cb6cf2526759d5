#pragma once

#include "CFailureRecord.h"
#include "CSafeFile.h"

#include <cstddef>
#include <cstdint>
#include <span>
#include <string>

namespace gw {

/// The info block of a package.
struct PackageInfo
{
    uint32_t format = 0; ///< the motion file's format: FormatCode
    float third = 0.0f;
    float fourth = 0.0f;
};

/// Returns the code of a motion file's format by its extension; 0 if unknown.
uint32_t FormatCode(const std::string& path);

/// Writes a Kinetra package: a container with an empty node and the custom data "MotionInfo" and
/// "MotionFile". The destination is replaced atomically. The motion arrives in pieces, so it needs neither
/// memory nor a temporary file.
class CPackageFile
{
public:
    /// Starts writing next to a destination.
    bool Open(const std::string& path, const PackageInfo& info);
    /// Returns everything that precedes the motion. The caller then puts it at the front of the first Write;
    /// otherwise, it is written separately.
    std::string TakeHead();
    /// Appends bytes of the motion. Returns false if they cannot be written or exceed the container limit;
    /// Commit will then fail too.
    bool Write(std::span<const std::byte> motion);
    /// Writes the motion's size and moves the file into place. If that fails, returns false and leaves the
    /// destination unchanged.
    bool Commit();
    /// Returns the reason of the failure: TooLarge or WriteError.
    EFailure Failure() const { return m_eFailure; }

private:
    bool Keep(bool written);
    bool Append(std::span<const std::byte> bytes);

    CSafeFile m_kFile;
    std::string m_kHead; // until it is taken or written
    size_t m_uiHeadBytes = 0;
    uint64_t m_uiBytes = 0; // with the head
    EFailure m_eFailure = EFailure::None;
};

} // namespace gw
