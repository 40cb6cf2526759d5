// Sentences and codes for the doubts about a bone map. Doubts of the same kind share one sentence that lists
// their joints.

#include "DoubtWords.h"

#include "CJsonWriter.h"
#include "CReport.h"
#include "ChooseProfile.h"
#include "Text.h"
#include "Words.h"

#include <algorithm>

namespace gw {

namespace {

constexpr const char* kSurenessNames[] = {"sure", "likely", "doubtful"};

// A code for programs, and a sentence for people, in pieces around joint names.
struct DoubtText
{
    const char* name;
    const char* before;
    const char* between; // between two joint names; null if only one is named
    const char* behind;
};

// In EBodyDoubt order.
constexpr DoubtText kPlaceTexts[] = {
    {"not-below",       "",                                 nullptr, " is not below the expected parent joint"                 },
    {"sides-swapped",   "",                                 nullptr, " is on the other side: left and right are swapped"       },
    {"clavicle-is-arm", "",                                 nullptr, " is one joint too far out for an upper arm"              },
    {"arm-is-clavicle", "",                                 nullptr, " is too short for an upper arm and looks like a clavicle"},
    {"legs-up",         "",                                 nullptr, " points up like the trunk, so it is not a leg"           },
    {"odd-length",      "the bone lengths in the limb of ", nullptr, " look wrong"                                             },
};

// In EProfileDoubt order, without the first one.
constexpr DoubtText kTexts[] = {
    {"other-name", "it uses ",                   " although ", " is the joint by name"    },
    {"spine-cut",  "the spine continues above ", " up to ",    ""                         },
    {"turned",     "",                           nullptr,      " ends up rotated sideways"},
};

const DoubtText& TextOf(const ProfileDoubt& doubt)
{
    if (doubt.kind == EProfileDoubt::Places)
        return kPlaceTexts[static_cast<size_t>(doubt.places)];
    return kTexts[static_cast<size_t>(doubt.kind) - 1];
}

std::string Sentence(const ProfileDoubt& doubt)
{
    const DoubtText& text = TextOf(doubt);
    const std::string other = text.between ? text.between + Quoted(doubt.other) : "";
    return text.before + Quoted(doubt.joint) + other + text.behind;
}

// If one bone is misrotated, many are: they share a sentence that names only a few.
std::string TurnedSentence(const std::vector<ProfileDoubt>& doubts)
{
    constexpr size_t kNamed = 4;
    std::string joints;
    size_t count = 0;
    for (const ProfileDoubt& doubt : doubts)
    {
        if (doubt.kind != EProfileDoubt::Turned)
            continue;
        if (count < kNamed)
            joints += (count > 0 ? ", " : "") + Quoted(doubt.joint);
        ++count;
    }
    if (count == 0)
        return {};
    const std::string more = count > kNamed ? " and " + std::to_string(count - kNamed) + " more" : "";
    return "bones end up rotated sideways, which --align may fix: " + joints + more;
}

} // namespace

const char* SurenessName(ESureness sureness)
{
    return kSurenessNames[static_cast<size_t>(sureness)];
}

std::vector<std::string> DoubtWords(const ProfileVerdict& verdict)
{
    std::vector<std::string> words;
    for (const ProfileDoubt& doubt : verdict.doubts)
    {
        if (doubt.kind != EProfileDoubt::Turned)
            words.push_back(Sentence(doubt));
    }
    if (std::string turned = TurnedSentence(verdict.doubts); !turned.empty())
        words.push_back(std::move(turned));
    return words;
}

std::vector<CReport> DoubtWarnings(const std::string& source, const ProfileChoice& choice)
{
    std::vector<CReport> warnings;
    for (const std::string& words : DoubtWords(choice.verdict))
    {
        warnings.push_back(
            ShellFailure(source, "doubt", "profile " + Quoted(choice.profile.name) + ": " + words));
        warnings.back().warning = true;
    }
    return warnings;
}

CReport DoubtfulReport(const std::string& source, const ProfileChoice& choice)
{
    std::string words = "the best-matching profile, " + Quoted(choice.profile.name) + ", is doubtful";
    for (const std::string& doubt : DoubtWords(choice.verdict))
        words += "\n  " + doubt;
    words += "\n  pass --profile to use it anyway, or draft one with 'gaitwright suggest'";
    return ShellFailure(source, "doubtful", words);
}

void WriteVerdict(CJsonWriter& json, const ProfileVerdict& verdict)
{
    json.Key("sureness").Text(SurenessName(verdict.sureness));
    json.Key("spineJointsLeftOut").Integer(static_cast<int64_t>(verdict.leftOut));
    json.Key("turn").Number(static_cast<float>(verdict.turn));
    json.Key("doubts").BeginArray();
    for (const ProfileDoubt& doubt : verdict.doubts)
    {
        json.BeginObject();
        json.Key("kind").Text(TextOf(doubt).name);
        json.Key("joint").Text(doubt.joint);
        json.Key("other").Text(doubt.other);
        json.Key("words").Text(Sentence(doubt));
        json.EndObject();
    }
    json.EndArray();
}

} // namespace gw
