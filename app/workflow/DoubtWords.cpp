#include "DoubtWords.h"

#include "ChooseProfile.h"
#include "Notice.h"
#include "Text.h"

#include <algorithm>

namespace gw {

namespace {

constexpr const char* kSurenessNames[] = {"sure", "likely", "doubtful"};

// The texts of a doubt: a code for programs, a sentence in pieces around the names of joints, and a phrase
// without names.
struct DoubtText
{
    EDoubt doubt;
    const char* code;
    const char* before;
    const char* between; // between two joint names; null if the sentence names only one
    const char* behind;
    const char* phrase; // null if a drafted row cannot raise this doubt
};

// Rows are function calls, because the formatter keeps their layout.
constexpr DoubtText Row(EDoubt doubt, const char* code, const char* before, const char* behind,
                        const char* phrase)
{
    return {doubt, code, before, nullptr, behind, phrase};
}

constexpr DoubtText RowOfTwo(EDoubt doubt, const char* code, const char* before, const char* between,
                             const char* behind)
{
    return {doubt, code, before, between, behind, nullptr};
}

constexpr DoubtText kTexts[] = {
    Row(EDoubt::NotBelow, "not-below", "", " is not below the expected parent joint",
        "it is not below the expected parent joint"),
    Row(EDoubt::SidesSwapped, "sides-swapped", "", " is on the other side: left and right are swapped",
        "left and right may be swapped"),
    Row(EDoubt::ClavicleIsArm, "clavicle-is-arm", "", " is one joint too far out for an upper arm",
        "the joint before may be the upper arm"),
    Row(EDoubt::ArmIsClavicle, "arm-is-clavicle", "",
        " is too short for an upper arm and looks like a clavicle", "it may be the clavicle"),
    Row(EDoubt::LegsUp, "legs-up", "", " points up like the trunk, so it is not a leg",
        "the legs point up like the trunk"),
    Row(EDoubt::OddLength, "odd-length", "the bone lengths in the limb of ", " look wrong",
        "its bones are out of proportion"),
    RowOfTwo(EDoubt::OtherName, "other-name", "it uses ", " although ", " is the joint by name"),
    RowOfTwo(EDoubt::SpineCut, "spine-cut", "the spine continues above ", " up to ", ""),
    Row(EDoubt::Turned, "turned", "", " ends up rotated sideways", nullptr),
};

const DoubtText& TextOf(EDoubt doubt)
{
    return *std::ranges::find(kTexts, doubt, &DoubtText::doubt);
}

// If one bone is misrotated, usually many are: they share one sentence, which names only a few.
std::string TurnedSentence(const std::vector<ProfileDoubt>& doubts)
{
    constexpr size_t kNamed = 4;
    std::string joints;
    size_t count = 0;
    for (const ProfileDoubt& doubt : doubts)
    {
        if (doubt.kind != EDoubt::Turned)
            continue;
        if (count < kNamed)
            joints += (count > 0 ? ", " : "") + Quoted(doubt.joint);
        ++count;
    }
    if (count == 0)
        return {};
    const std::string more = count > kNamed ? " and " + std::to_string(count - kNamed) + " more" : "";
    return "bones end up rotated sideways, which aligning may fix: " + joints + more;
}

} // namespace

const char* DoubtCode(EDoubt doubt)
{
    return TextOf(doubt).code;
}

const char* DoubtPhrase(EDoubt doubt)
{
    return TextOf(doubt).phrase;
}

std::string DoubtSentence(const ProfileDoubt& doubt)
{
    const DoubtText& text = TextOf(doubt.kind);
    const std::string other = text.between ? text.between + Quoted(doubt.other) : "";
    return text.before + Quoted(doubt.joint) + other + text.behind;
}

const char* SurenessName(ESureness sureness)
{
    return kSurenessNames[static_cast<size_t>(sureness)];
}

std::vector<std::string> DoubtWords(const ProfileVerdict& verdict)
{
    std::vector<std::string> words;
    for (const ProfileDoubt& doubt : verdict.doubts)
    {
        if (doubt.kind != EDoubt::Turned)
            words.push_back(DoubtSentence(doubt));
    }
    if (std::string turned = TurnedSentence(verdict.doubts); !turned.empty())
        words.push_back(std::move(turned));
    return words;
}

std::vector<Notice> DoubtWarnings(const std::string& source, const ProfileChoice& choice)
{
    std::vector<Notice> warnings;
    for (const std::string& words : DoubtWords(choice.verdict))
        warnings.push_back(MakeNotice(
            source, "doubt", "bone map " + Quoted(choice.profile.name) + ": " + words, ESeverity::Warning));
    return warnings;
}

Notice DoubtfulNotice(const std::string& source, const ProfileChoice& choice)
{
    std::string words = "the best-matching bone map, " + Quoted(choice.profile.name) + ", is doubtful";
    for (const std::string& doubt : DoubtWords(choice.verdict))
        words += "\n  " + doubt;
    words += "\n  pass --profile to use it anyway";
    return MakeNotice(source, "doubtful", words);
}

} // namespace gw
