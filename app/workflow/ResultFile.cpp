// Writes the target's motion to a file: a Kinetra package around an HTR, or the HTR alone.

#include "ResultFile.h"

#include "CByteSink.h"
#include "CMotionFile.h"
#include "CPackageFile.h"
#include "GlbFile.h"
#include "Packaging.h"
#include "Paths.h"
#include "TKBVHStream.h"

#include <functional>

namespace gw {

namespace {

constexpr std::string_view kPackageExtension = ".Kinetra";
constexpr std::string_view kMotionExtension = ".htr";
// The host plays packages at this rate; results are stored in half-steps of it.
constexpr float kHostRate = 60.0f;

// Saves the result with rate / profileRate times as many frames.
bool SaveMotion(const CMotionFile& result, float rate, int profileRate,
                const std::function<bool(float frameScale)>& save, CFailureRecord& record)
{
    if (profileRate <= 0)
        return record.Fail(EFailure::BadNumber, 0, "FrameRate " + std::to_string(profileRate));
    const bool saved = save(rate / static_cast<float>(profileRate));
    return saved || record.Fail(result.Record().Failure());
}

// The HTR text goes directly into the package, so an HTR file next to it is not touched.
bool WritePackage(CMotionFile& result, const std::string& path, int profileRate, CFailureRecord& record)
{
    CPackageFile package;
    const CByteSink append = [&](std::span<const std::byte> bytes) {
        return package.Write(bytes) || record.Fail(package.Failure());
    };
    const auto write = [&](float frameScale) {
        return result.SaveText(append, frameScale, package.TakeHead());
    };
    if (!package.Open(
            path, {FormatCode(std::string(kMotionExtension)), static_cast<float>(profileRate), kHostRate}))
        return record.Fail(package.Failure());
    return SaveMotion(result, kSavedRate, profileRate, write, record) &&
           (package.Commit() || record.Fail(package.Failure()));
}

} // namespace

bool WriteResultFile(CMotionFile& result, const std::string& path, int profileRate, CFailureRecord& record)
{
    if (HasExtension(path, kPackageExtension))
        return WritePackage(result, path, profileRate, record);
    return WriteMotionFile(result, WithExtension(path, kMotionExtension), kSavedRate, profileRate, record);
}

bool WriteMotionFile(CMotionFile& result, const std::string& path, float rate, int profileRate,
                     CFailureRecord& record)
{
    const auto write = [&](float frameScale) { return result.Save(path, frameScale); };
    return SaveMotion(result, rate, profileRate, write, record);
}

bool WriteExchangeFile(const CMotionFile& result, const std::string& path, CFailureRecord& record)
{
    constexpr double kMetersPerUnit = 0.001; // of the host skeleton
    if (HasExtension(path, ".glb"))
        return SaveGlb(result, kMetersPerUnit, path, record);
    TKBVHStream stream(result);
    const bool written = stream.WriteExact(path);
    record = stream.Record();
    return written;
}

bool PackageMotionFile(const std::string& path, const std::string& output, CFailureRecord& record)
{
    return PackageMotion(path, output, kHostRate, kHostRate, record);
}

std::string WithExtension(const std::string& path, std::string_view extension)
{
    const PathParts parts = SplitPath(path);
    return parts.folder + parts.stem + std::string(extension);
}

std::string_view BatchSource(EBatchJob job)
{
    return job == EBatchJob::ToMotion ? ".bvh" : ".htr";
}

std::string_view BatchResult(EBatchJob job)
{
    return job == EBatchJob::ToMotion ? ".htr" : ".orn";
}

} // namespace gw
