#pragma once

#include "CFailureRecord.h"

#include <cstdint>
#include <string>
#include <string_view>

namespace gw {

class CMotionFile;

/// Frame rate of a result saved by a user. The number of frames is multiplied by this rate / the profile's
/// rate.
inline constexpr float kSavedRate = 120.0f;
/// Same for a batch run: with a profile rate of 30, the number of frames does not change.
inline constexpr float kBatchRate = 30.0f;

/// What a batch run does with the files of a folder.
enum class EBatchJob : uint8_t
{
    ToMotion,    ///< converts every source (.bvh) to an .htr
    ToContainer, ///< packages every .htr as an .orn
};

/// How a batch run continues after a file.
enum class EBatchStep : uint8_t
{
    Done,
    Ended,     ///< the run ends with its summary
    Abandoned, ///< the run ends immediately, without restoring the title
};

/// Return the extension of the files that a batch run reads, and of those it writes.
std::string_view BatchSource(EBatchJob job);
std::string_view BatchResult(EBatchJob job);

// Each of these replaces an existing file. If nothing was written, it records the reason and returns false.
// A result reports its progress, and if that ends the writing, an existing file stays as it is.

/// Writes a result saved by a user: a package if the path ends in .Kinetra, otherwise an .htr with that name.
bool WriteResultFile(CMotionFile& result, const std::string& path, int profileRate, CFailureRecord& record);
/// Writes a result as HTR with rate / profileRate times as many frames.
bool WriteMotionFile(CMotionFile& result, const std::string& path, float rate, int profileRate,
                     CFailureRecord& record);
/// Writes a result, with all frames at the source's rate, as .glb or, for any other extension, as .bvh.
bool WriteExchangeFile(const CMotionFile& result, const std::string& path, CFailureRecord& record);
/// Packages an HTR file like a batch run.
bool PackageMotionFile(const std::string& path, const std::string& output, CFailureRecord& record);

/// Returns the path with another extension, which starts with a dot.
std::string WithExtension(const std::string& path, std::string_view extension);

} // namespace gw
