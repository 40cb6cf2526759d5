#pragma once

#include "CFailureRecord.h"
#include "CNode.h"
#include "Corrections.h"
#include "Notice.h"
#include "SourceTiming.h"
#include "Vec3.h"

#include <cstddef>
#include <cstdint>
#include <functional>
#include <string>
#include <utility>

namespace gw {

class CMapRowTable;
class CMotionFile;
class CRetargeter;
enum class EAlignedJoints : uint8_t;

/// Position of the target's root in the rest pose and in the first frame, in the target skeleton's own unit.
inline constexpr Vec3 kRootPosition{0.0f, 923.0f, 13.0f};

/// Conversion options; all are off in a default conversion.
struct ConversionChoices
{
    bool align = false;    ///< re-expresses the source relative to a T-pose that suits the bone maps
    bool faithful = false; ///< trunk, hips, knees and feet follow the source
    bool holdHands = true; ///< with `faithful`: hands follow what they touch

    bool operator==(const ConversionChoices&) const = default;
};

/// The input of a conversion. Nodes and rows are referenced and must outlive the conversion.
struct ConversionInput
{
    std::string sourcePath;
    CNode* source = nullptr; ///< null if no source is open
    SourceTiming timing;
    const CFailureRecord&
        sourceRecord;        ///< from the source's reader, which may have warned about the rest pose
    std::string profilePath; ///< empty if no profile is selected
    std::string profileName;
    const CMapRowTable& rows;
    bool areRowsEdited = false; ///< the rows differ from the profile's file
    ConversionChoices choices;
};

/// Receives notices as they occur.
using NoticeListener = std::function<void(const Notice&)>;

/// Sends notices about the failure and the warnings of a reader, a writer or a run, except for warnings about
/// problems that a chosen alignment corrects.
void NotifyOfRecord(const std::string& path, const CFailureRecord& record, const ConversionChoices& choices,
                    const NoticeListener& listener);

/// Converts one source to one target, once. The steps are: the rows fill the retargeter's tables, then
/// Prepare, then Run.
class CConversion
{
public:
    /// Changes the target in place; it must be the base skeleton as read from its file. The retargeter must
    /// be new: its tables are keyed by the target's bones, and a deleted target's bone may have had the
    /// address of a bone of this one. Both must outlive the conversion.
    CConversion(ConversionInput input, CMotionFile& target, CRetargeter& retargeter, NoticeListener listener)
        : input_(std::move(input)), target_(target), retargeter_(retargeter), notify_(std::move(listener))
    {
    }

    /// If the alignment option is set, aligns a copy of the source for the rows; the copy then drives the
    /// target, and the source is unchanged. Returns false, after sending a notice of the reason, if the
    /// tables cannot drive a conversion: not all rows fit, none drives the root, or they do not form a body
    /// that can be aligned.
    bool Prepare(bool doRowsFit, EAlignedJoints joints);
    /// Writes the motion to the target. `progress` is called from time to time with the number of finished
    /// frames and the total.
    void Run(bool useLegs, const std::function<void(size_t, size_t)>& progress = {});

    /// Returns the aligned copy of the source; null if the source itself drives the target.
    CNode* Aligned() const { return aligned_.Get(); }
    /// Returns what the alignment corrected.
    const Corrections& Corrected() const { return corrections_; }

private:
    bool Align(EAlignedJoints joints);
    void NotifyOfMisfit();
    bool NotifyOfMissingBones();
    void NotifyOfTurnedBones();
    void NormalizeBasePose();

    ConversionInput input_;
    CMotionFile& target_;
    CRetargeter& retargeter_;
    NoticeListener notify_;
    Ref<CNode> aligned_;
    Corrections corrections_;
};

} // namespace gw
