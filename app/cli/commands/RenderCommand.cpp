// `render`: draws a frame, or a strip of poses, into a picture file.

#include "AttachBoneMeshes.h"
#include "CJsonWriter.h"
#include "CSceneFile.h"
#include "CommandTable.h"
#include "Output.h"
#include "PackageBlocks.h"
#include "PackagedMotion.h"
#include "Paths.h"
#include "RenderPicture.h"
#include "SourceTiming.h"
#include "Text.h"
#include "Words.h"
#include "WritePng.h"

#include <algorithm>
#include <cstdio>
#include <limits>

namespace gw {

namespace {

PictureMotion Shown(CNode* root, const SourceTiming& timing)
{
    return {Ref<CNode>(root), timing.FrameStep(), timing.lastFrame};
}

// Shows the first root that moves, animated by its first track, with bone meshes added so that its bones are
// visible.
bool ShowScene(const std::string& path, CSceneFile& file, PictureMotion& motion)
{
    for (const FoundNode& found : file.Nodes())
    {
        const CKeyframeControl* track = found.parent ? nullptr : PreviewTrack(found.node);
        if (!track)
            continue;
        AttachBoneMeshes(found.node);
        motion = Shown(found.node, TimingOf(track));
        return true;
    }
    SayFailure(path, {EFailure::NoTrack, 0, {}});
    return false;
}

// The trees outlive their files.
bool LoadMotion(const ShellOptions& options, const std::string& path, PictureMotion& motion)
{
    CSceneFile file;
    if (!file.LoadWhole(path))
        return false;
    SayWarnings(options, path, file.Record());
    CMotionFile inside;
    const bool isPackage = file.IsContainer() && FindPackage(file.Scene()).info;
    if (file.IsContainer() && !isPackage)
        return ShowScene(path, file, motion);
    if (isPackage && !LoadPackagedMotion(path, file.Scene(), inside))
        return false;
    const CMotionFile& shown = isPackage ? inside : file.Motion();
    motion = Shown(shown.motionRoot.Get(), TimingOf(shown));
    return true;
}

int ToInt(int64_t number)
{
    using Limits = std::numeric_limits<int>;
    return static_cast<int>(std::clamp<int64_t>(number, Limits::min(), Limits::max()));
}

// Allocates the motions' places in the picture, still empty.
PictureOptions PictureOf(const ShellOptions& options)
{
    PictureOptions picture;
    picture.motions.resize(options.with.empty() ? 1 : 2);
    picture.width = options.size.width;
    picture.height = options.size.height;
    picture.frame = ToInt(options.frame);
    picture.poseCount = ToInt(options.strip);
    return picture;
}

std::string SizeText(const PictureOptions& picture)
{
    return std::to_string(picture.width) + 'x' + std::to_string(picture.height);
}

bool CanDraw(const ShellOptions& options, const PictureOptions& picture)
{
    if (!HasExtension(options.output, ".png"))
        return Refuse(Printable(options.output) + ": the picture must be a .png file");
    if (picture.poseCount < 1)
        return Refuse("--strip " + std::to_string(options.strip) + ": a picture needs at least one pose");
    const std::string poses = picture.poseCount == 1 ? "a pose" : std::to_string(options.strip) + " poses";
    return IsDrawable(picture) ||
           Refuse("cannot draw " + poses + " in " + SizeText(picture) + " pixels: each side must be 1 to " +
                  std::to_string(kLongestSide) + ", and each pose needs at least one pixel");
}

// `picture` is null if none was drawn.
void WriteJson(const ShellOptions& options, const PictureOptions* picture)
{
    CJsonWriter json(stdout);
    json.BeginObject();
    json.Key("source").Text(options.files[0]);
    json.Key("output").Text(options.output);
    json.Key("outcome").Text(picture ? "drawn" : "skipped");
    if (picture)
    {
        json.Key("width").Integer(picture->width);
        json.Key("height").Integer(picture->height);
        json.Key("frame").Integer(picture->frame);
        json.Key("poses").Integer(picture->poseCount);
    }
    json.EndObject();
    json.EndDocument();
}

std::string PictureWords(const PictureOptions& picture)
{
    const std::string frame = std::to_string(picture.frame);
    const std::string poses = picture.poseCount == 1
                                  ? "frame " + frame
                                  : std::to_string(picture.poseCount) + " poses starting at frame " + frame;
    return SizeText(picture) + " pixels, " + poses;
}

EExit Tell(const ShellOptions& options, const PictureOptions* picture)
{
    const std::string words = picture ? PictureWords(*picture) : "skipped, the output exists";
    if (options.json)
        WriteJson(options, picture);
    else if (!options.quiet)
        std::printf("%s -> %s: %s\n", Printable(options.files[0]).c_str(), Printable(options.output).c_str(),
                    words.c_str());
    return EExit::Done;
}

bool Draw(const PictureOptions& options, const std::string& output)
{
    RgbPicture picture;
    const EPictureAnswer answer = RenderPicture(options, picture);
    if (answer == EPictureAnswer::NoPainter)
        return Refuse(
            "drawing needs gw_picture_painter.so next to the program, and the libraries that it loads");
    if (answer != EPictureAnswer::Done)
        return Refuse("the OpenGL driver cannot draw this picture without a display; Mesa's driver can");
    if (WritePng(output, picture))
        return true;
    SayNotWritten(output);
    return false;
}

} // namespace

EExit RunRender(const ShellOptions& options)
{
    PictureOptions picture = PictureOf(options);
    if (!IsDecidedOnExisting(options) || !CanDraw(options, picture))
        return EExit::Usage;
    if (options.skipExisting && IsTaken(options.output))
        return Tell(options, nullptr);
    if (!MayWrite(options, options.output) || !LoadMotion(options, options.files[0], picture.motions[0]))
        return EExit::Failed;
    if (!options.with.empty() && !LoadMotion(options, options.with, picture.motions[1]))
        return EExit::Failed;
    picture.frame = FirstFrame(picture);
    return Draw(picture, options.output) ? Tell(options, &picture) : EExit::Failed;
}

} // namespace gw
