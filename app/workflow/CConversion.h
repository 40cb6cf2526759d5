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

/// Where the target's root stands in the rest pose and in the first frame, in the target skeleton's own unit.
inline constexpr Vec3 kRootPosition{0.0f, 923.0f, 13.0f};

/// What a conversion does beside the rules; all off unless chosen.
struct ConversionChoices
{
    bool align = false;    ///< the source is told from a rest pose that suits the rules
    bool faithful = false; ///< trunk, hips, knees and feet keep to the source
    bool holdHands = true; ///< and, where that is chosen, hands to what they touch
};

/// What a conversion is made from. Nodes and rows are looked at and must outlive the conversion.
struct ConversionInput
{
    std::string sourcePath;
    CNode* source = nullptr; ///< null where nothing is open
    SourceTiming timing;
    const CFailureRecord& sourceRecord; ///< of the source's reader, which may have warned of the rest pose
    std::string profilePath;            ///< empty where no profile is selected
    std::string profileName;
    const CMapRowTable& rows;
    bool areRowsEdited = false; ///< they differ from the profile's file
    ConversionChoices choices;
};

/// Receives notices as they come.
using NoticeListener = std::function<void(const Notice&)>;

/// Notifies of what a reader, a writer or a run failed on and warned of, except for warnings of what a chosen
/// alignment corrects.
void NotifyOfRecord(const std::string& path, const CFailureRecord& record, const ConversionChoices& choices,
                    const NoticeListener& listener);

/// One conversion of one source onto one target. The steps: the rows fill the retargeter's tables, then
/// Prepare, then Run.
class CConversion
{
public:
    /// Changes the target in place, which is the base skeleton as its file has it. The retargeter is a new
    /// one: its tables are keyed by the target's bones, and a bone of a target that is gone may have lain
    /// where one of the present target lies. Both must outlive the conversion.
    CConversion(ConversionInput input, CMotionFile& target, CRetargeter& retargeter, NoticeListener listener)
        : input_(std::move(input)), target_(target), retargeter_(retargeter), notify_(std::move(listener))
    {
    }

    /// Aligns the source for the rows where that is chosen, and lets an aligned copy drive the target: the
    /// source stays as it is. False, after a notice of the reason, when the tables cannot drive a conversion:
    /// not all rows fit, or none drives the root, or they make no body that could be aligned.
    bool Prepare(bool doRowsFit, EAlignedJoints joints);
    /// Writes the motion onto the target. `progress` is told now and then the frames done and their number.
    void Run(bool useLegs, const std::function<void(size_t, size_t)>& progress = {});

    /// The aligned copy of the source; null where the source itself drives the target.
    CNode* Aligned() const { return aligned_.Get(); }
    /// What the alignment corrected.
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
