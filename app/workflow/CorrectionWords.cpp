#include "CorrectionWords.h"

#include "Corrections.h"

#include <algorithm>

namespace gw {

namespace {

struct KindWords
{
    ECorrection kind;
    const char* code;
    const char* one; // singular: "1 joint ..."
    const char* many;
};

constexpr KindWords Row(ECorrection kind, const char* code, const char* one, const char* many)
{
    return {kind, code, one, many};
}

constexpr KindWords kKinds[] = {
    Row(ECorrection::RestPose, "rest-pose", "bone off its axis at rest", "bones off their axes at rest"),
    Row(ECorrection::UpAxis, "up-axis", "up axis that is not Y", "up axes that are not Y"),
    Row(ECorrection::BoneFrames, "bone-frame", "rotated frame of a slanted bone",
        "rotated frames of slanted bones"),
    Row(ECorrection::DoubledPositions, "doubled-offset", "doubled bone", "doubled bones"),
};

} // namespace

const char* CorrectionCode(ECorrection kind)
{
    return std::ranges::find(kKinds, kind, &KindWords::kind)->code;
}

std::string CorrectionWords(const Corrections& corrections)
{
    std::string text;
    for (const KindWords& words : kKinds)
    {
        const auto count = std::ranges::count(corrections.list, words.kind, &Correction::kind);
        if (count == 0)
            continue;
        text += text.empty() ? "" : ", ";
        text += std::to_string(count) + ' ' + (count == 1 ? words.one : words.many);
    }
    return text.empty() ? "nothing to align" : text;
}

} // namespace gw
