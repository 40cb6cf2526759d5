#pragma once

#include "CConversion.h"
#include "CFilePlatform.h"
#include "CMotionFile.h"
#include "COrrinStream.h"
#include "CRetargeter.h"
#include "ProfileRows.h"

#include <optional>
#include <string>

namespace gw {

/// The code of a report that is one of the program's fixed messages: "Invalid BVH file format."
inline constexpr const char* kFixedMessage = "message";

/// From files to a file, for programs without a window. The steps: LoadSource and LoadTarget, UseProfile,
/// Convert, and one that writes. Each may follow where the one before answered true; what went wrong is
/// reported first. Leaves no settings and no folders behind.
class CFileConversion
{
public:
    /// An empty data folder stands for the program's own.
    CFileConversion(const std::string& dataFolder, const ConversionChoices& choices, ReportListener listener);

    bool LoadSource(const std::string& path);
    /// Reads the base skeleton, as each conversion needs it.
    bool LoadTarget();
    bool UseProfile(const std::string& path);
    /// Takes a profile that has been read, or made of what was read.
    void UseProfile(const std::string& path, const ProfileRows& profile);
    /// Reads the profile in use again; where its file has gone, it stays as it was.
    void RereadProfile() { ReadProfileRows(profilePath_, profile_); }
    /// Whether the source has frames to be converted, and after Convert, whether the result has.
    bool HasFrames() const;
    bool Convert(bool useLegs);

    /// Each replaces what is there. The first takes the extension .Kinetra for a package, the second writes
    /// an HTR with as many frames as a batch run does.
    bool WriteResult(const std::string& path);
    bool WriteBatchResult(const std::string& path);
    /// Writes the source as a BVH file that is told from a rest pose which suits the rules; in place of
    /// Convert, with the choice `align`.
    bool WriteAligned(const std::string& path);

    CNode* SourceRoot() const;
    SourceTiming Timing() const;
    /// What the last conversion read: the source, or its aligned copy.
    CNode* DrivingRoot() const;
    /// The target, and what came of it.
    const CMotionFile& Result() const { return result_; }
    const ProfileRows& Profile() const { return profile_; }
    /// The file of the profile in use; empty where none is.
    const std::string& ProfilePath() const { return profilePath_; }
    /// What the last alignment found.
    AlignReport AlignedReport() const { return conversion_ ? conversion_->AlignedReport() : AlignReport(); }
    /// The full path of a name in the data folder.
    std::string DataFile(const std::string& name) const { return platform_.DataFolder() + name; }
    /// The text of a message.
    std::string Message(int id) const;
    void Report(const std::string& path, const CFailureRecord& record) const
    {
        ReportRecord(path, record, choices_, report_);
    }

protected:
    void Report(const CReport& report) const { report_(report); }
    const CPlatform& Platform() const { return platform_; }
    const std::string& SourcePath() const { return sourcePath_; }

private:
    bool Prepare(EAlignedJoints joints);
    void WarnOfNumbers() const;
    void TellMessage(int id) const;

    CFilePlatform platform_;
    ConversionChoices choices_;
    ReportListener report_;
    std::string sourcePath_;
    bool isScene_ = false; // which of the next two the source is
    COrrinStream scene_;
    CMotionFile motion_;
    CFailureRecord sourceRecord_;
    CMotionFile result_;
    ProfileRows profile_;
    std::string profilePath_;
    std::optional<CRetargeter> retargeter_; // new for each conversion, like the next
    std::optional<CConversion> conversion_;
};

} // namespace gw
