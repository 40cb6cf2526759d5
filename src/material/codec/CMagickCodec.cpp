// The picture codec, on top of Magick++. The library allocates whatever a file claims and reports problems by
// exceptions, so its resources are limited at start and every call is wrapped.

#include "CPictureCodec.h"

#include <algorithm>
#include <cmath>
#include <cstring>
#include <exception>
#include <string>
#include <vector>

#include <Magick++.h>

namespace gw {

namespace {

// Pixels take 8 bytes each while they are decoded. Beyond this limit they are cached in a file: a picture of
// 64 megapixels can be read, and a larger one is refused before anything is allocated.
constexpr MagickCore::MagickSizeType kMemoryBytes = MagickCore::MagickSizeType{32} << 20;
constexpr MagickCore::MagickSizeType kDiskBytes = MagickCore::MagickSizeType{512} << 20;
constexpr MagickCore::MagickSizeType kFrameLimit = 4096; // each costs 13 KB, whatever its size

constexpr double kCentimetresPerInch = 2.54;

void Initialize()
{
    Magick::InitializeMagick(nullptr);
    Magick::ResourceLimits::memory(kMemoryBytes);
    Magick::ResourceLimits::map(0); // a mapped file on a full disk raises a signal instead of an error
    Magick::ResourceLimits::disk(kDiskBytes);
    Magick::ResourceLimits::listLength(kFrameLimit);
    Magick::ResourceLimits::thread(1);
}

int32_t DotsPerInch(double density, Magick::ResolutionType units)
{
    if (units == Magick::PixelsPerCentimeterResolution)
        density *= kCentimetresPerInch;
    return units == Magick::UndefinedResolution || !(density >= 1.0 && density < 1e6)
               ? 0
               : static_cast<int32_t>(std::lround(density));
}

PictureHead HeadOf(const Magick::Image& image)
{
    const Magick::Geometry page = image.page();
    return {.width = static_cast<int32_t>(image.columns()),
            .height = static_cast<int32_t>(image.rows()),
            .left = static_cast<int32_t>(page.xOff()),
            .top = static_cast<int32_t>(page.yOff()),
            .delay = static_cast<uint32_t>(image.animationDelay()),
            .horizontalResolution = DotsPerInch(image.xResolution(), image.resolutionUnits()),
            .verticalResolution = DotsPerInch(image.yResolution(), image.resolutionUnits())};
}

// A truncated picture is only a warning, and the available part is returned.
template <class F>
void Attempt(F step)
{
    try
    {
        step();
    } catch (const Magick::Warning&)
    {
    }
}

std::vector<Magick::Image> ReadFrames(const Magick::Blob& blob, const char* format, bool everyFrame)
{
    std::vector<Magick::Image> frames;
    if (everyFrame)
    {
        Magick::ReadOptions options;
        std::strncpy(options.imageInfo()->magick, format, MaxTextExtent - 1);
        Attempt([&] { Magick::readImages(&frames, blob, options); });
        return frames;
    }
    Magick::Image& image = frames.emplace_back();
    image.magick(format);
    image.subRange(1);
    Attempt([&] { image.read(blob); });
    return frames;
}

// Without an alpha channel, its bytes can be anything.
void MakeOpaque(uint8_t* pixels, size_t count)
{
    for (uint8_t* alpha = pixels + 3; count > 0; --count, alpha += 4)
        *alpha = 255;
}

// The export below copies channels unchanged: cyan would become red.
void ConvertToSRGB(Magick::Image& image)
{
    const Magick::ColorspaceType space = image.colorSpace();
    if (space != Magick::sRGBColorspace && space != Magick::GRAYColorspace)
        image.colorSpace(Magick::sRGBColorspace);
}

bool HandOver(Magick::Image& image, const CPictureSink& sink)
{
    const PictureHead head = HeadOf(image);
    uint8_t* const pixels = head.width > 0 && head.height > 0 ? sink(head) : nullptr;
    if (!pixels)
        return false;
    ConvertToSRGB(image);
    image.write(0, 0, image.columns(), image.rows(), "BGRA", Magick::CharPixel, pixels);
    if (!image.matte())
        MakeOpaque(pixels, image.columns() * image.rows());
    return true;
}

bool DecodeFrames(std::span<const std::byte> file, const char* format, bool everyFrame,
                  const CPictureSink& sink)
{
    std::vector<Magick::Image> frames =
        ReadFrames(Magick::Blob(file.data(), file.size()), format, everyFrame);
    return !frames.empty() && std::ranges::all_of(frames, [&](auto& frame) { return HandOver(frame, sink); });
}

// A picture with few colors keeps them exactly; others get the nearest ones, without dithering.
void PrepareGif(Magick::Image& image)
{
    constexpr size_t kColors = 256;
    image.quantizeColors(kColors);
    image.quantizeDither(false);
    image.quantize();
}

void EncodeFrame(const PictureHead& head, const uint8_t* pixels, int32_t bytesPerPixel, const char* format,
                 int32_t quality, std::vector<uint8_t>& file)
{
    Magick::Image image(static_cast<size_t>(head.width), static_cast<size_t>(head.height),
                        bytesPerPixel == 4 ? "BGRA" : "BGR", Magick::CharPixel, pixels);
    image.magick(format);
    image.resolutionUnits(Magick::PixelsPerInchResolution);
    image.density(Magick::Geometry(static_cast<size_t>(std::max(head.horizontalResolution, 1)),
                                   static_cast<size_t>(std::max(head.verticalResolution, 1))));
    if (std::strcmp(format, "GIF") == 0)
        PrepareGif(image);
    else
        image.quality(static_cast<size_t>(std::clamp(quality, 1, 100)));
    Magick::Blob blob;
    Attempt([&] { image.write(&blob); });
    const auto* bytes = static_cast<const uint8_t*>(blob.data());
    file.assign(bytes, bytes + blob.length());
}

class CMagickCodec : public CPictureCodec
{
public:
    CMagickCodec() { Initialize(); }

    bool Decode(std::span<const std::byte> file, const char* format, bool everyFrame,
                const CPictureSink& sink) override
    try
    {
        return DecodeFrames(file, format, everyFrame, sink);
    } catch (const std::exception&)
    {
        return false;
    }

    bool Encode(const PictureHead& head, const uint8_t* pixels, int32_t bytesPerPixel, const char* format,
                int32_t quality, std::vector<uint8_t>& file) override
    try
    {
        EncodeFrame(head, pixels, bytesPerPixel, format, quality, file);
        return !file.empty();
    } catch (const std::exception&)
    {
        return false;
    }
};

} // namespace

} // namespace gw

extern "C" [[gnu::visibility("default")]] gw::CPictureCodec* gw_picture_codec()
{
    static gw::CMagickCodec codec;
    return &codec;
}
