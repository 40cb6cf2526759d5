#include "DoubtWords.h"

#include "CJsonWriter.h"
#include "CNode.h"
#include "CReport.h"
#include "ChooseProfile.h"
#include "Words.h"

#include <algorithm>

namespace gw {

namespace {

constexpr const char* kSurenessNames[] = {"sure", "likely", "doubtful"};

const char* DoubtName(const ProfileDoubt& doubt)
{
    switch (doubt.kind)
    {
    case EProfileDoubt::Places:
        return "places";
    case EProfileDoubt::OtherName:
        return "other-name";
    case EProfileDoubt::SpineCut:
        return "spine-cut";
    case EProfileDoubt::Turned:
        return "turned";
    }
    return "";
}

std::string_view NameOf(const CNode* joint)
{
    return joint ? joint->NameView() : std::string_view();
}

std::string Sentence(const ProfileDoubt& doubt)
{
    const std::string joint = Quoted(NameOf(doubt.joint));
    const std::string other = Quoted(NameOf(doubt.other));
    switch (doubt.kind)
    {
    case EProfileDoubt::Places:
        return "a body of these joints is odd at " + joint;
    case EProfileDoubt::OtherName:
        return "it takes " + joint + " where " + other + " is the joint by its name";
    case EProfileDoubt::SpineCut:
        return "the spine goes on above " + joint + " up to " + other;
    case EProfileDoubt::Turned:
        return "the bone of " + joint + " comes out turned across";
    }
    return {};
}

// Bones that come out turned are many where one is, and share a sentence.
std::string TurnedSentence(const std::vector<ProfileDoubt>& doubts)
{
    std::string joints;
    size_t count = 0;
    for (const ProfileDoubt& doubt : doubts)
    {
        if (doubt.kind != EProfileDoubt::Turned)
            continue;
        joints += (count > 0 ? ", " : "") + Quoted(NameOf(doubt.joint));
        ++count;
    }
    return count == 0 ? "" : "these bones come out turned across: " + joints;
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
        warnings.push_back(ShellFailure(source, "doubt", "profile " + Quoted(choice.name) + ": " + words));
        warnings.back().warning = true;
    }
    return warnings;
}

CReport DoubtfulReport(const std::string& source, const ProfileChoice& choice)
{
    std::string words = "the profile that fits best, " + Quoted(choice.name) + ", is doubtful";
    for (const std::string& doubt : DoubtWords(choice.verdict))
        words += "\n  " + doubt;
    words += "\n  name it with --profile to use it all the same, or draft one with 'gaitwright suggest'";
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
        json.Key("kind").Text(DoubtName(doubt));
        json.Key("joint").Text(NameOf(doubt.joint));
        json.Key("other").Text(NameOf(doubt.other));
        json.Key("words").Text(Sentence(doubt));
        json.EndObject();
    }
    json.EndArray();
}

} // namespace gw
