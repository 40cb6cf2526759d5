#include "DraftedProfile.h"

#include "CNode.h"
#include "ProfileFile.h"
#include "SourceTiming.h"
#include "Text.h"
#include "Vec3.h"

namespace gw {

namespace {

constexpr const char* kJointWords[] = {"hip",     "spine joint", "neck",  "head", "clavicle", "upper arm",
                                       "forearm", "hand",        "thigh", "shin", "foot",     "toe"};

constexpr const char* kRowSurenessNames[] = {"sure", "likely", "unsure"};
constexpr const char* kEvidenceCodes[] = {"none", "shape", "shape-against-name", "name", "name-and-shape"};
constexpr const char* kKindCodes[] = {"turned", "neutral", "fixed", "no-source", "no-name"};

void Append(std::string& list, const std::string& word)
{
    list.append(list.empty() ? "" : ", ").append(word);
}

} // namespace

std::string PlaceWords(BodyPlace place)
{
    const char* const joint = kJointWords[static_cast<size_t>(place.joint)];
    if (!HasSides(place.joint))
        return joint;
    return std::string(place.side == EBodySide::Left ? "left " : "right ") + joint;
}

const char* RowKindCode(ESuggestedRow kind)
{
    return kKindCodes[static_cast<size_t>(kind)];
}

const char* RowSurenessName(ERowSureness sureness)
{
    return kRowSurenessNames[static_cast<size_t>(sureness)];
}

const char* EvidenceCode(EBodyEvidence evidence)
{
    return kEvidenceCodes[static_cast<size_t>(evidence)];
}

std::string DraftText(const SuggestedProfile& draft, const std::string& stem, CNode* sourceRoot)
{
    return ProfileText(SuggestedName(stem), ProfileRateOf(sourceRoot), kVec3Zero, draft.Table());
}

std::string WhyNotSure(const SuggestedProfile& draft)
{
    std::string missing;
    std::string unsure;
    for (const BodyPlace& place : draft.missing)
        Append(missing, PlaceWords(place));
    if (!missing.empty())
        return "no complete body was found by names or shape; missing: " + missing;
    for (const SuggestedRow& row : draft.rows)
    {
        if (row.IsMapping() && IsNeeded(row.place.joint) && row.sureness != ERowSureness::Sure)
            Append(unsure, PlaceWords(row.place));
    }
    return unsure.empty() ? unsure : "these joints of a drafted profile are not sure: " + unsure;
}

std::optional<Notice> RateWarning(const std::string& path, CNode* sourceRoot)
{
    const int sourceRate = SourceRateOf(sourceRoot);
    const int profileRate = ProfileRateOf(sourceRoot);
    if (sourceRate == profileRate)
        return std::nullopt;
    const std::string words = "the source has " + std::to_string(sourceRate) +
                              " frames per second, but the nearest rate that a profile can have is " +
                              std::to_string(profileRate) + ", so results will play " +
                              (sourceRate < profileRate ? "faster" : "slower");
    return MakeNotice(path, "rate", words, ESeverity::Warning);
}

} // namespace gw
