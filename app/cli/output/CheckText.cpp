#include "CheckText.h"

#include "CJsonWriter.h"
#include "CompareText.h"
#include "ConvertedMotion.h"
#include "FaultWords.h"
#include "KeyFigures.h"
#include "Text.h"

#include <cstdio>

namespace gw {

namespace {

constexpr const char* kIndent = "    ";

void PrintParts(const std::vector<PartMeasures>& parts)
{
    std::printf("%sparts:", kIndent);
    const char* separator = " ";
    for (const PartMeasures& part : parts)
    {
        if (part.boneCount == 0)
            continue;
        std::printf("%s%.*s %.3f", separator, static_cast<int>(part.name.size()), part.name.data(),
                    part.meanError);
        separator = ", ";
    }
    std::printf(" deg mean\n");
}

void PrintWorst(const std::vector<WorstFrame>& frames)
{
    for (const WorstFrame& worst : frames)
    {
        const FaultWords& words = WordsOf(worst.fault);
        std::printf("%sworst: frame %d, %s %.2f %s (%s)\n", kIndent, worst.frame, words.text, worst.amount,
                    words.unit, Printable(worst.target).c_str());
    }
}

void WriteParts(CJsonWriter& json, const std::vector<PartMeasures>& parts)
{
    json.Key("parts").BeginArray();
    for (const PartMeasures& part : parts)
    {
        json.BeginObject();
        json.Key("part").Text(part.name);
        json.Key("bones").Integer(static_cast<int64_t>(part.boneCount));
        json.Key("meanError").Number(static_cast<float>(part.meanError));
        json.Key("largestError").Number(static_cast<float>(part.largestError));
        json.Key("largestBone").Text(part.largestBone);
        json.Key("largestFrame").Integer(part.largestFrame);
        json.EndObject();
    }
    json.EndArray();
}

void WriteWorst(CJsonWriter& json, const std::vector<WorstFrame>& frames)
{
    json.Key("worstFrames").BeginArray();
    for (const WorstFrame& worst : frames)
    {
        json.BeginObject();
        json.Key("frame").Integer(worst.frame);
        json.Key("fault").Text(WordsOf(worst.fault).name);
        json.Key("amount").Number(static_cast<float>(worst.amount));
        json.Key("target").Text(worst.target);
        json.Key("source").Text(worst.source);
        if (!worst.part.empty())
            json.Key("part").Text(worst.part);
        json.EndObject();
    }
    json.EndArray();
}

void WriteKneePops(CJsonWriter& json, const std::vector<FootMeasures>& feet)
{
    json.Key("kneePopFrames").BeginObject();
    for (const FootMeasures& foot : feet)
    {
        json.Key(foot.target).BeginArray();
        for (const int frame : foot.kneePopFrames)
            json.Integer(frame);
        json.EndArray();
    }
    json.EndObject();
}

} // namespace

void PrintCheck(const MeasuredConversion& measured, std::string_view title)
{
    std::printf("  %.*s\n", static_cast<int>(title.size()), title.data());
    PrintParts(measured.detail.parts);
    PrintSums(measured.sums, kIndent);
    PrintWorst(FindWorstFrames(measured.sums, measured.detail, kWorstFrames));
}

void WriteCheck(CJsonWriter& json, const MeasuredConversion& measured)
{
    WriteMeasures(json, measured.sums);
    WriteParts(json, measured.detail.parts);
    WriteKneePops(json, measured.sums.feet);
    WriteWorst(json, FindWorstFrames(measured.sums, measured.detail, kWorstFrames));
}

void WriteKeyFigures(CJsonWriter& json, const MeasuredConversion& measured, const char* key)
{
    json.Key(key).BeginObject();
    for (const KeyFigure& figure : KeyFiguresOf(measured.sums, measured.detail))
    {
        json.Key(figure.key);
        figure.value ? json.Number(static_cast<float>(*figure.value)) : json.Null();
    }
    json.EndObject();
}

} // namespace gw
