// `info`: prints what a file contains. Motion files are loaded like for a conversion; containers are read
// without decoding linked pictures, of which only the names are shown.

#include "CJsonWriter.h"
#include "CKeyframeControl.h"
#include "CSceneFile.h"
#include "CommandTable.h"
#include "FindingWords.h"
#include "InfoContainer.h"
#include "JsonStatus.h"
#include "MotionFacts.h"
#include "NoticeJson.h"
#include "PackageBlocks.h"
#include "PackagedMotion.h"
#include "Paths.h"
#include "Text.h"
#include "Words.h"

#include <algorithm>
#include <cstdio>

namespace gw {

namespace {

// The timing of a track.
struct Timing
{
    int64_t frames = 0;
    float lastFrame = 0.0f;
    float frameSeconds = 0.0f;

    float Rate() const { return 1.0f / frameSeconds; }
    float Seconds() const { return lastFrame * frameSeconds; }
};

Timing TrackTiming(const CKeyframeControl* track)
{
    if (!track)
        return {};
    const size_t frames = std::max({track->m_kKeyTimes.size(), track->m_kRotationTimes.size(),
                                    track->m_kPositionTimes.size(), track->m_kScaleTimes.size()});
    return {static_cast<int64_t>(frames), track->m_fEndTime, track->m_fFrequency};
}

// A batch run writes packages as .orn, so the extension is not enough.
std::string FormatOf(CSceneFile& file)
{
    if (file.IsContainer())
        return FindPackage(file.Scene()).info ? "Kinetra" : "orn";
    return LowerCase(SplitPath(file.ReadPath()).extension).substr(1);
}

void PrintTiming(const Timing& timing)
{
    if (timing.frames == 0)
    {
        std::puts("frames:  none");
        return;
    }
    std::printf("frames:  %lld\n", static_cast<long long>(timing.frames));
    std::printf("rate:    %g per second (%g s each)\n", timing.Rate(), timing.frameSeconds);
    std::printf("length:  %g s\n", timing.Seconds());
}

void PrintBones(const std::vector<FoundNode>& nodes)
{
    std::printf("bones:   %zu\n", nodes.size());
    for (const FoundNode& found : nodes)
        PrintIndented(found.depth + 1, Printable(found.node->NameView()));
}

void WriteTiming(CJsonWriter& json, const Timing& timing)
{
    json.Key("frames").Integer(timing.frames);
    json.Key("lastFrame").Number(timing.lastFrame);
    json.Key("frameSeconds").Number(timing.frameSeconds);
    json.Key("rate").Number(timing.frames == 0 ? 0.0f : timing.Rate());
    json.Key("seconds").Number(timing.Seconds());
}

void WriteBones(CJsonWriter& json, const std::vector<FoundNode>& nodes)
{
    json.Key("bones").BeginArray();
    for (const FoundNode& found : nodes)
    {
        json.BeginObject();
        json.Key("name").Text(found.node->NameView());
        json.Key("parent");
        if (found.parent)
            json.Text(found.parent->NameView());
        else
            json.Null();
        json.EndObject();
    }
    json.EndArray();
}

void PrintClips(const ImportFacts& facts)
{
    for (const std::string& clip : facts.clips)
        std::printf("clip:    %s%s\n", Printable(clip).c_str(), clip == facts.clip ? " (shown)" : "");
}

// What only the files of modeling programs say.
void PrintSpace(const ImportFacts& facts, const Timing& timing)
{
    if (facts.unitMeters <= 0.0)
        return;
    const std::string unit(UnitOfMeters(facts.unitMeters));
    if (unit.empty())
        std::printf("unit:    %g metres\n", facts.unitMeters);
    else
        std::printf("unit:    %s\n", unit.c_str());
    if (facts.wasTurnedUp)
        std::puts("up:      turned to Y");
    if (!facts.isRateOfFile && timing.frames > 1)
        std::puts("sampled: at a chosen rate, because the file has none (see --rate)");
}

void WriteSpace(CJsonWriter& json, const ImportFacts& facts)
{
    if (facts.unitMeters <= 0.0)
        return;
    json.Key("unitMeters").Number(static_cast<float>(facts.unitMeters));
    json.Key("turnedUp").Bool(facts.wasTurnedUp);
    json.Key("rateOfFile").Bool(facts.isRateOfFile);
}

void WriteClips(CJsonWriter& json, const ImportFacts& facts)
{
    json.Key("clips").BeginArray();
    for (const std::string& clip : facts.clips)
        json.Text(clip);
    json.EndArray();
}

// Returns how many frames of a result belong to a source frame; 1 if this is not known, or if a rate was
// given.
int SourceShare(const CSceneFile& file)
{
    return file.IsScene() || file.HasGivenRate() ? 1 : FramesPerSourceFrame(file.Motion());
}

void Print(const std::string& path, CSceneFile& file)
{
    std::printf("file:    %s\nformat:  %s\n", Printable(path).c_str(), FormatOf(file).c_str());
    if (file.IsContainer())
        PrintContainer(file.Scene());
    const Timing timing = TrackTiming(file.FirstTrack());
    PrintClips(file.Motion().imported);
    PrintSpace(file.Motion().imported, timing);
    if (!file.IsScene() || timing.frames != 0)
        PrintTiming(timing);
    if (const int count = SourceShare(file); count > 1)
        std::printf("source:  %d frames per source frame; %g per second is the source's speed\n", count,
                    timing.Rate() * static_cast<float>(count));
    PrintBones(file.Nodes());
    if (file.IsContainer())
        PrintObjects(file.Scene());
}

void WriteJson(const std::string& path, CSceneFile& file)
{
    CJsonWriter json(stdout);
    json.BeginObject();
    if (file.IsDamaged())
        WriteFailed(json, MakeNotice(path, file.Failure()));
    else
        WriteStatus(json, "ok");
    json.Key("file").Text(path);
    json.Key("format").Text(FormatOf(file));
    WriteTiming(json, TrackTiming(file.FirstTrack()));
    json.Key("framesPerSourceFrame").Integer(SourceShare(file));
    WriteBones(json, file.Nodes());
    WriteClips(json, file.Motion().imported);
    WriteSpace(json, file.Motion().imported);
    WriteRecord(json, path, file.Record());
    if (file.IsContainer())
        WriteContainer(json, file.Scene());
    json.EndObject();
    json.EndDocument();
}

} // namespace

EExit RunInfo(const ShellOptions& options)
{
    const std::string& path = options.files[0];
    CSceneFile file;
    file.Scene().SetPictureLimit(0); // only the names of linked pictures are printed
    file.SelectSource(options.clip, options.rate);
    if (!file.Load(path))
    {
        file.SayFailure(path);
        return EExit::Failed;
    }
    if (!file.IsDamaged())
        file.ShowInside(options, path);
    if (options.listClips && !options.json)
    {
        for (const std::string& clip : file.Motion().imported.clips)
            std::puts(Printable(clip).c_str());
        return EExit::Done;
    }
    if (options.json)
        WriteJson(path, file);
    else
        Print(path, file);
    SayWarnings(options, path, file.Record());
    if (!file.IsContainer()) // the host knows how to play a package
        SayRateOfResult(options, path, file.Motion());
    if (!file.IsDamaged())
        return EExit::Done;
    SayDamage(path, file.Failure());
    return EExit::Failed;
}

} // namespace gw
