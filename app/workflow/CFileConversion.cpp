// The steps of a file-to-file conversion. Each step reports what went wrong before it returns false.

#include "CFileConversion.h"

#include "AlignMotion.h"
#include "CProfileFields.h"
#include "CResourceManager.h"
#include "FindBone.h"
#include "FindingWords.h"
#include "Paths.h"
#include "ProfileFile.h"
#include "ResultFile.h"
#include "StringTable.h"
#include "SystemError.h"
#include "TKBVHStream.h"

#include <algorithm>
#include <array>

namespace gw {

CFileConversion::CFileConversion(const std::string& dataFolder, const ConversionChoices& choices,
                                 NoticeListener listener)
    : platform_(EPlatformWriting::No, dataFolder), choices_(choices), notify_(std::move(listener))
{
    result_.boneMeshes = EBoneMeshes::DrawnInMotion; // its lowest point is put on the floor
}

std::string CFileConversion::Message(int id) const
{
    CResourceManager resources;
    resources.OpenLibrary(DataFile(kResourceLibrary), platform_.ThreadLocale());
    std::string text;
    resources.LoadResString(id, text);
    return text;
}

void CFileConversion::TellMessage(int id) const
{
    Notify(MakeNotice({}, kFixedMessage, Message(id)));
}

bool CFileConversion::LoadSource(const std::string& path, const std::string& copy)
{
    sourcePath_ = path;
    sourceNames_.reset();
    const bool isLoaded = source_->Load(copy.empty() ? path : copy);
    Notify(path, source_->Record());
    if (!isLoaded)
        TellMessage(kInvalidSourceMessage);
    return isLoaded;
}

void CFileConversion::UseSource(const std::string& path, std::shared_ptr<CSourceMotion> source)
{
    sourcePath_ = path;
    sourceNames_.reset();
    source_ = std::move(source);
}

const CBoneNames& CFileConversion::SourceNames()
{
    return sourceNames_ ? *sourceNames_ : sourceNames_.emplace(SourceRoot());
}

const CBoneNames& CFileConversion::TargetNames()
{
    return targetNames_ ? *targetNames_ : targetNames_.emplace(result_.motionRoot.Get());
}

bool CFileConversion::LoadTarget()
{
    const std::string path = DataFile(kTargetFile);
    targetNames_.reset();
    const bool loaded = result_.Load(path);
    Notify(path, result_.Record());
    return loaded;
}

bool CFileConversion::UseProfile(const std::string& path)
{
    ProfileRows profile;
    const bool isRead = ReadProfileRows(path, profile);
    if (isRead)
        UseProfile(path, profile);
    else
        Notify(MakeNotice(path, {.reason = EFailure::BadProfile, .systemError = TakeSystemError()}));
    return isRead;
}

void CFileConversion::UseProfile(const std::string& path, const ProfileRows& profile)
{
    profile_ = profile;
    profilePath_ = path;
}

bool CFileConversion::HasFrames() const
{
    const bool hasFrames = source_->HasFrames() && result_.GetKeyCount() > 0;
    if (!hasFrames)
        Notify(MakeNotice(sourcePath_, {EFailure::NothingToConvert}));
    return hasFrames;
}

// Warns only: a number outside its limits is used anyway.
void CFileConversion::WarnOfNumbers() const
{
    const auto warn = [&](int number, int low, int high, size_t line, const std::string& name) {
        if (number == std::clamp(number, low, high))
            return;
        const std::string limits[] = {std::to_string(low), std::to_string(high)};
        const std::string words = FormatText(Message(kNumberLimitsMessage), limits);
        Notify({ESeverity::Warning, profilePath_, line, "out-of-range", name, '"' + name + "\": " + words});
    };
    const auto& [x, y, z] = profile_.position;
    const std::array place{CutToInteger(x), CutToInteger(y), CutToInteger(z)};
    std::string name = "Position";
    for (const int number : place)
        name += ' ' + std::to_string(number);
    for (const int number : place)
        warn(number, -kOffsetLimit, kOffsetLimit, profile_.positionLine, name);
    warn(profile_.frameRate, kLowestFrameRate, kHighestFrameRate, profile_.frameRateLine,
         "FrameRate " + std::to_string(profile_.frameRate));
}

// Fills the tables of a new retargeter from the profile.
bool CFileConversion::Prepare(EAlignedJoints joints)
{
    CNode* const source = SourceRoot();
    CNode* const target = result_.motionRoot.Get();
    CRetargeter& retargeter = retargeter_.emplace();
    bool fits = source && target;
    if (fits)
    {
        WarnOfNumbers();
        retargeter.SetScenes(source, target);
        const RowMatch match = ApplyRows(profile_.rows, SourceNames(), TargetNames(), &retargeter);
        fits = match.foundCount == match.rowCount;
        retargeter.LoadShares(DataFile(kShareFile));
    }
    conversion_.emplace(ConversionInput{.sourcePath = sourcePath_,
                                        .source = source,
                                        .timing = Timing(),
                                        .sourceRecord = source_->Record(),
                                        .profilePath = profilePath_,
                                        .profileName = profile_.name,
                                        .rows = profile_.rows,
                                        .choices = choices_},
                        result_, retargeter, notify_);
    return conversion_->Prepare(fits, joints);
}

bool CFileConversion::Convert(bool useLegs)
{
    if (!Prepare(EAlignedJoints::Body))
    {
        TellMessage(kCannotConvertMessage);
        return false;
    }
    conversion_->Run(useLegs);
    return true;
}

bool CFileConversion::WriteResult(const std::string& path, bool* taken)
{
    CFailureRecord record;
    WriteResultFile(result_, path, profile_.frameRate, record);
    return TellWritten(path, record, taken);
}

bool CFileConversion::WriteExchange(const std::string& path, bool* taken)
{
    CFailureRecord record;
    WriteExchangeFile(result_, path, record);
    return TellWritten(path, record, taken);
}

// Reports the end of writing.
bool CFileConversion::TellWritten(const std::string& path, const CFailureRecord& record, bool* taken) const
{
    if (taken && record.Failure().reason == EFailure::Exists)
        *taken = true;
    else
        Notify(path, record);
    return !record.Failure();
}

bool CFileConversion::WriteBatchResult(const std::string& path)
{
    CFailureRecord record;
    const bool written = WriteMotionFile(result_, path, kBatchRate, profile_.frameRate, record);
    Notify(sourcePath_, record);
    return written;
}

bool CFileConversion::WriteAligned(const std::string& path)
{
    if (!Prepare(EAlignedJoints::All))
        return false;
    TKBVHStream stream;
    stream.motionRoot = conversion_->Aligned();
    const bool written = stream.WriteExact(path);
    Notify(path, stream.Record());
    return written;
}

CNode* CFileConversion::DrivingRoot() const
{
    return conversion_ && conversion_->Aligned() ? conversion_->Aligned() : SourceRoot();
}

} // namespace gw
