#pragma once

#include "CConversion.h"
#include "CMapFits.h"
#include "Notice.h"
#include "Remedy.h"
#include "SourceTiming.h"

#include <span>
#include <string>
#include <vector>

namespace gw {

class CFailureRecord;
class CMapRowTable;
class CNode;

/// The state of the window that decides what comes next. It refers to the source, the target and the rows.
struct StepState
{
    CNode* source = nullptr;            ///< null if nothing is open
    CNode* target = nullptr;            ///< null if the target skeleton is missing
    bool hasFrames = false;             ///< of the source
    const CFailureRecord& readerRecord; ///< of the source's reader
    std::string mapName;                ///< of the selected bone map; empty if none is selected
    const CMapRowTable& rows;           ///< of that map
    ConversionChoices choices;
    bool isConverted = false; ///< a result is on display
};

/// What the window suggests: facts about the file opened last, which are measured once, and the next step
/// with its buttons.
class CNextSteps
{
public:
    /// Measures how well the bone maps of some folders fit; see CMapFits.
    void MeasureFits(std::span<const std::string> folders, CNode* source, CNode* target);
    /// Finds the up axis of a motion. Leaves it in the pose of time 0.
    void FindUp(CNode* root, const SourceTiming& timing);
    /// Sets whether drafting a bone map for the source has failed; it is not offered again then.
    void SetUndraftable(bool undraftable) { m_bUndraftable = undraftable; }
    /// Sets the file that OpenMendedCopy repairs; empty if there is nothing to repair.
    void SetMendable(const std::string& path) { m_kMendable = path; }

    const CMapFits& Fits() const { return m_kFits; }
    /// Returns "Z", "-Z" and so on; empty if Y is up.
    const std::string& UpAxis() const { return m_kUpAxis; }
    const std::string& Mendable() const { return m_kMendable; }

    /// Returns what the empty source view says.
    static Hint SourceHint(const StepState& state);
    /// Returns what the empty result view says.
    Hint ResultHint(const StepState& state) const;
    /// Returns the remedies for the notices of a step.
    std::vector<Offer> OffersFor(std::span<const Notice> notices, const StepState& state) const;

private:
    void OfferMap(Hint& hint) const;
    Hint ReadyHint(const StepState& state) const;
    std::string AlignmentReason(const StepState& state) const;

    CMapFits m_kFits;
    std::string m_kUpAxis;
    std::string m_kMendable;
    bool m_bUndraftable = false;
};

/// Returns the first lines of the first error among the notices of a step; empty without an error.
std::string SummaryOf(std::span<const Notice> notices);

} // namespace gw
