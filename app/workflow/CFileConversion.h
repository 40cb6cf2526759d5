#pragma once

#include "CConversion.h"
#include "CMotionFile.h"
#include "CRetargeter.h"
#include "CSourceMotion.h"
#include "CSystemPlatform.h"
#include "EditMotion.h"
#include "FindBone.h"
#include "ProfileRows.h"

#include <memory>
#include <optional>
#include <string>

namespace gw {

/// The code of a notice with one of the program's fixed messages: "Invalid BVH file format."
inline constexpr const char* kFixedMessage = "message";

/// Converts files without a window. The steps are LoadSource and LoadTarget, UseProfile, Convert, and one of
/// the writing functions; each requires that the previous one returned true. A function that fails sends a
/// notice first. Leaves no settings or folders behind.
class CFileConversion
{
public:
    /// An empty data folder means the program's own folder.
    CFileConversion(const std::string& dataFolder, const ConversionChoices& choices, NoticeListener listener);

    /// Reads a source. `copy`, unless empty, is the file to read in its place.
    bool LoadSource(const std::string& path, const std::string& copy = {});
    /// Selects what LoadSource reads: the clip of a file with several, and the rate, in frames per second, in
    /// place of the file's own; 0 for that.
    void SelectSource(const std::string& clip, float rate) { source_->Select(clip, rate); }
    /// Uses a source that has been read already, in place of LoadSource. Nothing else may use it until the
    /// conversion is finished.
    void UseSource(const std::string& path, std::shared_ptr<CSourceMotion> source);
    /// Reads the base skeleton. Each conversion needs a new one.
    bool LoadTarget();
    bool UseProfile(const std::string& path);
    /// Uses a profile that has already been read or derived.
    void UseProfile(const std::string& path, const ProfileRows& profile);
    /// Reads the current profile's file again; if it is gone, the profile is unchanged.
    void RereadProfile() { ReadProfileRows(profilePath_, profile_); }
    /// Returns whether the source, or after Convert the result, has frames.
    bool HasFrames() const;
    bool Convert(bool useLegs);

    /// Both replace an existing file. WriteResult writes a package if the extension is .Kinetra,
    /// WriteBatchResult an HTR with as many frames as a batch run. A file that must not be replaced, and
    /// exists by now, is a failure, or sets `taken` instead if that is given.
    bool WriteResult(const std::string& path, bool* taken = nullptr);
    /// Writes the result, with all frames at the source's rate, as .bvh or .glb, by the extension. `taken` as
    /// for WriteResult.
    bool WriteExchange(const std::string& path, bool* taken = nullptr);
    bool WriteBatchResult(const std::string& path);
    /// Writes the source as a BVH file, re-expressed relative to a T-pose. Call it instead of Convert, with
    /// the option `align`.
    bool WriteAligned(const std::string& path);

    CNode* SourceRoot() const { return source_->Root(); }
    /// Returns the names of the source's and the target's bones, listed when first needed.
    const CBoneNames& SourceNames();
    const CBoneNames& TargetNames();
    SourceTiming Timing() const { return source_->Timing(); }
    /// Returns what drove the last conversion: the source, or its aligned copy.
    CNode* DrivingRoot() const;
    /// Returns the target, or the result after Convert.
    const CMotionFile& Result() const { return result_; }
    const ProfileRows& Profile() const { return profile_; }
    /// Returns the file of the current profile; empty without one.
    const std::string& ProfilePath() const { return profilePath_; }
    /// Returns what the last alignment corrected.
    Corrections Corrected() const { return conversion_ ? conversion_->Corrected() : Corrections(); }
    /// Returns the full path of a name in the data folder.
    std::string DataFile(const std::string& name) const { return platform_.DataFolder() + name; }
    /// Returns the text of a message.
    std::string Message(int id) const;
    void Notify(const std::string& path, const CFailureRecord& record) const
    {
        NotifyOfRecord(path, record, choices_, notify_);
    }

protected:
    void Notify(const Notice& notice) const { notify_(notice); }
    const CPlatform& Platform() const { return platform_; }
    const std::string& SourcePath() const { return sourcePath_; }

private:
    bool Prepare(EAlignedJoints joints);
    bool TellWritten(const std::string& path, const CFailureRecord& record, bool* taken) const;
    void WarnOfNumbers() const;
    void TellMessage(int id) const;

    CSystemPlatform platform_;
    ConversionChoices choices_;
    NoticeListener notify_;
    std::string sourcePath_;
    std::shared_ptr<CSourceMotion> source_ = std::make_shared<CSourceMotion>();
    CMotionFile result_;
    ProfileRows profile_;
    std::string profilePath_;
    std::optional<CBoneNames> sourceNames_;
    std::optional<CBoneNames> targetNames_;
    std::optional<CRetargeter> retargeter_; // new for each conversion, like the next member
    std::optional<CConversion> conversion_;
};

} // namespace gw
