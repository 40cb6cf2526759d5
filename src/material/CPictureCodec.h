#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <span>
#include <vector>

namespace gw {

/// What is known of a picture before its pixels come.
struct PictureHead
{
    int32_t width = 0;
    int32_t height = 0;
    int32_t left = 0; ///< of a film's frame: where it lies on the screen
    int32_t top = 0;
    uint32_t delay = 0;               ///< hundredths of a second until the next frame
    int32_t horizontalResolution = 0; ///< dots per inch, 0 where the file does not tell
    int32_t verticalResolution = 0;
};

/// Gives the place for a picture's pixels, rows of width x 4 bytes (blue, green, red, alpha) without gaps, or
/// null to stop.
using CPictureSink = std::function<uint8_t*(const PictureHead&)>;

/// Pictures as the bytes of their files. The format is told by its name ("PNG"), never guessed. It stands in
/// a module of its own, loaded when the first picture is met; see LoadPictureCodec. Nothing here throws.
class CPictureCodec
{
public:
    virtual ~CPictureCodec() = default;

    /// Hands the first picture of a file to a sink, or every frame. False when nothing could be decoded.
    virtual bool Decode(std::span<const std::byte> file, const char* format, bool everyFrame,
                        const CPictureSink& sink) = 0;
    /// Makes a file of rows without gaps, 3 or 4 bytes a pixel. Quality goes from 1 to 100 and is for formats
    /// that have such a thing.
    virtual bool Encode(const PictureHead& head, const uint8_t* pixels, int32_t bytesPerPixel,
                        const char* format, int32_t quality, std::vector<uint8_t>& file) = 0;
};

/// The name under which the module gives out its codec, and the type of that function.
inline constexpr const char* kPictureCodecEntry = "gw_picture_codec";
using CPictureCodecEntry = CPictureCodec* (*)();

} // namespace gw
