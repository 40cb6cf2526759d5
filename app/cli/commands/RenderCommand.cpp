// `render`: draws a frame, or a strip of poses, into a picture file.

#include "AttachBoneMeshes.h"
#include "CJsonWriter.h"
#include "CSceneFile.h"
#include "CommandTable.h"
#include "EditMotion.h"
#include "JsonStatus.h"
#include "Output.h"
#include "PackageBlocks.h"
#include "PackagedMotion.h"
#include "Paths.h"
#include "PictureSides.h"
#include "RenderPicture.h"
#include "SourceTiming.h"
#include "Text.h"
#include "Words.h"
#include "WritePng.h"

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <limits>

namespace gw {

namespace {

constexpr int kMostFrames = 1800; // of an animation: a minute at 30 per second, some 50 MB

PictureMotion Shown(CNode* root, const SourceTiming& timing)
{
    return {.root = Ref<CNode>(root), .frameStep = timing.FrameStep(), .lastFrame = timing.lastFrame};
}

// The scene's time between two frames is the reciprocal of the frame time.
float FrameSeconds(const PictureMotion& motion)
{
    return motion.frameStep > 0.0f ? 1.0f / motion.frameStep : 0.0f;
}

EPictureView ViewOf(const ShellOptions& options)
{
    constexpr const char* kNames[] = {"front", "side", "three-quarter", "top"}; // indexed by EPictureView
    return static_cast<EPictureView>(std::ranges::find(kNames, options.view) - std::begin(kNames));
}

const std::string& OutputOf(const ShellOptions& options)
{
    return options.animate.empty() ? options.output : options.animate;
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

// A result plays at the speed of its source, although its header has the source's rate for more frames.
PictureMotion Shown(const CMotionFile& file, float rate)
{
    const float seconds =
        rate > 0.0f ? 1.0f / rate : file.GetFrequency() / static_cast<float>(FramesPerSourceFrame(file));
    SetFrameTime(*file.motionRoot, seconds);
    return Shown(file.motionRoot.Get(), TimingOf(file));
}

// The trees outlive their files.
bool LoadMotion(const ShellOptions& options, const std::string& path, PictureMotion& motion)
{
    CSceneFile file;
    file.SelectSource(options.clip, options.rate);
    if (!file.LoadWhole(path))
        return false;
    SayWarnings(options, path, file.Record());
    CMotionFile inside;
    const bool isPackage = file.IsContainer() && FindPackage(file.Scene()).info;
    if (file.IsContainer() && !isPackage)
        return ShowScene(path, file, motion);
    if (isPackage && !LoadPackagedMotion(path, file.Scene(), inside))
        return false;
    motion = Shown(isPackage ? inside : file.Motion(), options.rate);
    return true;
}

bool LoadPosed(const ShellOptions& options, const std::string& path, PictureMotion& motion)
{
    if (!LoadMotion(options, path, motion))
        return false;
    const PathParts parts = SplitPath(path);
    motion.label = Printable(parts.stem + parts.extension);
    FindPictureSides(motion, options.upright, FrameSeconds(motion));
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
    picture.view = ViewOf(options);
    picture.isDark = options.background == "dark";
    picture.hasAxes = options.axes;
    return picture;
}

std::string SizeText(const PictureOptions& picture)
{
    return std::to_string(picture.width) + 'x' + std::to_string(picture.height);
}

bool CanDraw(const ShellOptions& options, const PictureOptions& picture)
{
    if (!HasExtension(OutputOf(options), ".png"))
        return Refuse(Printable(OutputOf(options)) + ": the picture must be a .png file");
    if (!options.animate.empty() && options.strip != 1)
        return Refuse("--animate and --strip cannot be combined");
    if (picture.poseCount < 1)
        return Refuse("--strip " + std::to_string(options.strip) + ": a picture needs at least one pose");
    const std::string poses = picture.poseCount == 1 ? "a pose" : std::to_string(options.strip) + " poses";
    return IsDrawable(picture) ||
           Refuse("cannot draw " + poses + " in " + SizeText(picture) + " pixels: each side must be 1 to " +
                  std::to_string(kLongestSide) + ", and each pose needs at least one pixel");
}

// Returns the frames of an animation: at most 30 per second, and at most kMostFrames.
PngAnimation AnimationOf(const PictureOptions& picture)
{
    const PictureMotion& motion = picture.motions.front();
    const auto seconds = static_cast<double>(FrameSeconds(motion));
    const bool isRateKnown = seconds > 0.001 && seconds < 10.0;
    PngAnimation animation;
    animation.stride = isRateKnown ? std::max(1, static_cast<int>(std::lround(1.0 / (30.0 * seconds)))) : 1;
    animation.secondsPerFrame = isRateKnown ? seconds * animation.stride : 1.0 / 30.0;
    const int64_t count = (LastFrame(motion) - FirstFrame(picture)) / animation.stride + 1;
    animation.frameCount = static_cast<int>(std::min<int64_t>(count, kMostFrames));
    return animation;
}

// `picture` is null if none was drawn.
void WriteJson(const ShellOptions& options, const PictureOptions* picture)
{
    CJsonWriter json(stdout);
    json.BeginObject();
    WriteStatus(json, "ok");
    json.Key("source").Text(options.files[0]);
    json.Key("output").Text(OutputOf(options));
    json.Key("outcome").Text(picture ? "drawn" : "skipped");
    if (picture)
    {
        json.Key("width").Integer(picture->width);
        json.Key("height").Integer(picture->height);
        json.Key("frame").Integer(picture->frame);
        json.Key("poses").Integer(picture->poseCount);
        if (!options.animate.empty())
            json.Key("pictures").Integer(AnimationOf(*picture).frameCount);
    }
    json.EndObject();
    json.EndDocument();
}

std::string PictureWords(const ShellOptions& options, const PictureOptions& picture)
{
    if (!options.animate.empty())
    {
        const PngAnimation animation = AnimationOf(picture);
        const bool isCut = animation.frameCount == kMostFrames;
        return SizeText(picture) + " pixels, " + std::to_string(animation.frameCount) + " pictures" +
               (isCut ? ", the most that an animation has" : "");
    }
    const std::string frame = std::to_string(picture.frame);
    const std::string poses = picture.poseCount == 1
                                  ? "frame " + frame
                                  : std::to_string(picture.poseCount) + " poses starting at frame " + frame;
    return SizeText(picture) + " pixels, " + poses;
}

EExit Tell(const ShellOptions& options, const PictureOptions* picture)
{
    const std::string words = picture ? PictureWords(options, *picture) : "skipped, the output exists";
    if (options.json)
        WriteJson(options, picture);
    else if (!options.quiet)
        std::printf("%s -> %s: %s\n", Printable(options.files[0]).c_str(),
                    Printable(OutputOf(options)).c_str(), words.c_str());
    return EExit::Done;
}

bool Draw(const ShellOptions& shell, const PictureOptions& options)
{
    RgbPicture picture;
    const std::string& output = OutputOf(shell);
    const bool isAnimated = !shell.animate.empty();
    const EPictureAnswer answer =
        isAnimated ? WriteAnimation(output, options, AnimationOf(options)) : RenderPicture(options, picture);
    if (answer == EPictureAnswer::NoPainter)
        return Refuse("no-painter",
                      "drawing needs the module gw_picture_painter next to the program, and the "
                      "libraries that it loads");
    if (answer != EPictureAnswer::Done && answer != EPictureAnswer::Stopped)
        return Refuse("no-display",
                      "the OpenGL driver cannot draw this picture without a display; Mesa's driver can");
    if (isAnimated ? answer == EPictureAnswer::Done : WritePng(output, picture))
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
    if (options.skipExisting && IsTaken(OutputOf(options)))
        return Tell(options, nullptr);
    if (!MayWrite(options, OutputOf(options)) || !LoadPosed(options, options.files[0], picture.motions[0]))
        return EExit::Failed;
    if (!options.with.empty() && !LoadPosed(options, options.with, picture.motions[1]))
        return EExit::Failed;
    picture.frame = FirstFrame(picture);
    return Draw(options, picture) ? Tell(options, &picture) : EExit::Failed;
}

} // namespace gw
