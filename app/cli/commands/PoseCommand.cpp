#include "CJsonWriter.h"
#include "CKeyframeControl.h"
#include "COutputFile.h"
#include "CSceneFile.h"
#include "CommandTable.h"
#include "JsonStatus.h"
#include "Output.h"
#include "Paths.h"
#include "PoseArrays.h"
#include "PosedObject.h"
#include "Streams.h"
#include "Text.h"
#include "Words.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

void WriteNode(CJsonWriter& json, const FoundNode& found)
{
    json.BeginObject();
    json.Key("name").Text(found.node->NameView());
    json.Key("parent");
    if (found.parent)
        json.Text(found.parent->NameView());
    else
        json.Null();
    json.Key("local").Numbers(found.node->m_kMatrix.m);
    json.Key("world").Numbers(found.node->m_kWorldMatrix.m);
    json.EndObject();
}

// With --json, the document is one line; otherwise each node is a line.
void BeginElement(const ShellOptions& options, CJsonWriter& json)
{
    if (!options.json)
        json.BreakLine();
}

void WriteNodes(const ShellOptions& options, CJsonWriter& json, const CSceneFile& file)
{
    json.Key("nodes").BeginArray();
    for (const FoundNode& found : file.Nodes())
    {
        BeginElement(options, json);
        WriteNode(json, found);
    }
    json.EndArray();
}

void WriteObjects(const ShellOptions& options, CJsonWriter& json, CSceneFile& file)
{
    json.Key("objects").BeginArray();
    for (CObject* object : file.Objects())
    {
        CSpatial* spatial = RecordCast<CSpatial>(object);
        if (!spatial)
            continue;
        BeginElement(options, json);
        WritePosedObject(json, *spatial);
    }
    json.EndArray();
}

// A container can claim any end without holding a key for it.
constexpr size_t kAnyFrameCount = size_t{1} << 20;

// Returns the number of frames; 0, after printing the reason, for a file without frames or with too many.
size_t FramesOf(const std::string& path, CSceneFile& file)
{
    const CKeyframeControl* track = file.FirstTrack();
    const size_t keys = track ? std::max(track->m_kKeyTimes.size(), track->m_kRotationTimes.size()) : 0;
    const double frames = track ? std::floor(static_cast<double>(track->m_fEndTime)) + 1.0 : 0.0;
    if (frames >= 1.0 && frames <= static_cast<double>(std::max(keys, kAnyFrameCount)))
        return static_cast<size_t>(frames);
    SayError(path, "no-frames", "the file does not have a usable number of frames");
    return 0;
}

/// The files that --all writes.
struct ArrayFiles
{
    std::string poses;
    std::string positions; ///< empty for .csv, which has everything
    std::string names;
};

void WriteJson(const ShellOptions& options, const ArrayFiles& files, size_t frameCount, size_t boneCount)
{
    CJsonWriter json(stdout);
    json.BeginObject();
    WriteStatus(json, "ok");
    json.Key("source").Text(options.files[0]);
    json.Key("output").Text(files.poses);
    if (!files.positions.empty())
    {
        json.Key("positions").Text(files.positions);
        json.Key("names").Text(files.names);
    }
    json.Key("frames").Integer(static_cast<int64_t>(frameCount));
    json.Key("bones").Integer(static_cast<int64_t>(boneCount));
    json.EndObject();
    json.EndDocument();
}

EExit TellAll(const ShellOptions& options, const ArrayFiles& files, size_t frameCount, size_t boneCount)
{
    if (options.json)
        WriteJson(options, files, frameCount, boneCount);
    else
        PrintResult(options, options.output,
                    Printable(options.files[0]) + " -> " + Printable(options.output) + ": " +
                        std::to_string(frameCount) + " frames of " + std::to_string(boneCount) + " bones");
    return EExit::Done;
}

EExit WriteAllAsNpy(const ShellOptions& options, CSceneFile& file, size_t frameCount)
{
    const std::string stem = options.output.substr(0, options.output.rfind('.'));
    const ArrayFiles files{options.output, stem + ".positions.npy", stem + ".names.txt"};
    for (const std::string& path : {files.poses, files.positions, files.names})
    {
        if (!MayWrite(options, path))
            return EExit::Failed;
    }
    if (!WritePosesAsNpy(files.poses, files.positions, file, frameCount) ||
        !WriteBoneNames(files.names, file))
        return EExit::Failed;
    return TellAll(options, files, frameCount, file.Nodes().size());
}

EExit WriteAllAsCsv(const ShellOptions& options, CSceneFile& file, size_t frameCount)
{
    COutputFile output;
    if (!output.Open(options, options.output, ".csv") ||
        !WritePosesAsCsv(output.Path(), options.output, file, frameCount) || !output.DeliverOrSay())
        return EExit::Failed;
    return TellAll(options, {options.output, {}, {}}, frameCount, file.Nodes().size());
}

EExit WriteEveryPose(const ShellOptions& options, CSceneFile& file)
{
    const size_t frameCount = FramesOf(options.files[0], file);
    if (frameCount == 0)
        return EExit::Failed;
    return HasExtension(options.output, ".npy") ? WriteAllAsNpy(options, file, frameCount)
                                                : WriteAllAsCsv(options, file, frameCount);
}

bool IsOutputRight(const ShellOptions& options)
{
    if (!options.all)
        return options.output.empty() ||
               Refuse("-o is for --all; without it, the pose goes to standard output");
    return HasExtension(options.output, ".csv") || HasExtension(options.output, ".npy") ||
           IsStream(options.output) || Refuse("--all needs -o OUT, where OUT ends in .csv or .npy, or is -");
}

} // namespace

EExit RunPose(const ShellOptions& options)
{
    const std::string& path = options.files[0];
    if (!IsOutputRight(options))
        return EExit::Usage;
    CSceneFile file;
    file.SelectSource(options.clip, options.rate);
    if (!file.LoadWhole(path))
        return EExit::Failed;
    if (!options.objects)
        file.ShowInside(options, path);
    SayWarnings(options, path, file.Record());
    if (options.all)
        return WriteEveryPose(options, file);
    const float time = options.time ? *options.time : file.TimeOf(options.frame);
    file.Update(time);

    CJsonWriter json(stdout);
    json.BeginObject();
    if (options.json)
        WriteStatus(json, "ok");
    if (options.time)
        json.Key("time").Number(time);
    else
        json.Key("frame").Integer(options.frame);
    if (options.objects)
        WriteObjects(options, json, file);
    else
        WriteNodes(options, json, file);
    json.EndObject();
    json.EndDocument();
    return EExit::Done;
}

} // namespace gw
