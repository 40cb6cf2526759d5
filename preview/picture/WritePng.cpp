#include "WritePng.h"

#include "CAnimatedPng.h"
#include "CPicturePainter.h"
#include "CSafeFile.h"
#include "PicturePainter.h"
#include "RenderPicture.h"

#include <algorithm>
#include <cmath>
#include <span>

namespace gw {

namespace {

constexpr double kDelayDenominator = 1000.0;

uint16_t Milliseconds(double seconds)
{
    return static_cast<uint16_t>(std::clamp(std::round(seconds * kDelayDenominator), 1.0, 60000.0));
}

} // namespace

bool WritePng(const std::string& path, const RgbPicture& picture)
{
    CPicturePainter* const painter = LoadPicturePainter();
    if (!painter)
        return false;
    const std::vector<std::byte> bytes = painter->EncodePng(picture);
    CSafeFile file;
    return !bytes.empty() && file.Open(path) && file.Write(std::span(bytes)) && file.Commit();
}

EPictureAnswer WriteAnimation(const std::string& path, const PictureOptions& options,
                              const PngAnimation& animation)
{
    CPicturePainter* const painter = LoadPicturePainter();
    if (!painter)
        return EPictureAnswer::NoPainter;
    CSafeFile file;
    if (!file.Open(path))
        return EPictureAnswer::Stopped;
    CAnimatedPng png(static_cast<uint32_t>(animation.frameCount), Milliseconds(animation.secondsPerFrame),
                     static_cast<uint16_t>(kDelayDenominator));
    const EPictureAnswer answer =
        RenderFrames(options, animation.frameCount, animation.stride, [&](const RgbPicture& picture) {
            const std::vector<std::byte> frame = painter->EncodePng(picture);
            const std::string bytes = png.Frame({reinterpret_cast<const char*>(frame.data()), frame.size()});
            return !bytes.empty() && file.Write(bytes);
        });
    if (answer != EPictureAnswer::Done)
        return answer;
    return file.Write(CAnimatedPng::End()) && file.Commit() ? answer : EPictureAnswer::Stopped;
}

} // namespace gw
