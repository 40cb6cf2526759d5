#pragma once

#include "CFailure.h"

#include <cstdint>
#include <string>
#include <string_view>

namespace gw {

class CMotionFile;

/// Frames per second of a result that a user saves, in terms of the profile's rate.
inline constexpr float kSavedRate = 120.0f;
/// And of one in a batch run: at a profile rate of 30 the frames stay as many as they are.
inline constexpr float kBatchRate = 30.0f;

/// What a batch run makes of the files of a folder.
enum class EBatchJob : uint8_t
{
    ToMotion,    ///< of every source (.bvh) an .htr
    ToContainer, ///< of every .htr an .orn
};

/// How a batch run goes on after a file.
enum class EBatchStep : uint8_t
{
    Done,
    Ended,     ///< the run ends with its summary
    Abandoned, ///< the run ends at once and leaves its title
};

/// The extension of the files that a batch run takes, and that of its results.
std::string_view BatchSource(EBatchJob job);
std::string_view BatchResult(EBatchJob job);

// Each of these replaces what is there, and answers false with the reason recorded where nothing was written.

/// Writes a result as a user saves it: a package where the path ends in .Kinetra, else an .htr of that name.
bool WriteResultFile(CMotionFile& result, const std::string& path, int profileRate, CFailureRecord& record);
/// Writes a result as HTR with as many times more frames as a rate stands above the profile's.
bool WriteMotionFile(CMotionFile& result, const std::string& path, float rate, int profileRate,
                     CFailureRecord& record);
/// Packages an HTR file as a batch run does.
bool PackageMotionFile(const std::string& path, const std::string& output, CFailureRecord& record);

/// The path with another extension, which begins with a dot.
std::string WithExtension(const std::string& path, std::string_view extension);

} // namespace gw
