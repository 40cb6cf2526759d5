#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <span>
#include <vector>

namespace gw {

/// Properties of a picture, known before its pixels.
struct PictureHead
{
    int32_t width = 0;
    int32_t height = 0;
    int32_t left = 0; ///< position of a film frame on the screen
    int32_t top = 0;
    uint32_t delay = 0;               ///< hundredths of a second until the next frame
    int32_t horizontalResolution = 0; ///< dots per inch, or 0 if not stored in the file
    int32_t verticalResolution = 0;
};

/// Returns the memory for a picture's pixels, rows of width x 4 bytes (blue, green, red, alpha) without gaps,
/// or null to stop.
using CPictureSink = std::function<uint8_t*(const PictureHead&)>;

/// Decodes and encodes picture files in memory. The format is named ("PNG"), never guessed. The codec is in a
/// module that is loaded for the first picture; see LoadPictureCodec. It does not throw.
class CPictureCodec
{
public:
    virtual ~CPictureCodec() = default;

    /// Passes the first picture of a file, or every frame, to a sink. Returns false if nothing could be
    /// decoded.
    virtual bool Decode(std::span<const std::byte> file, const char* format, bool everyFrame,
                        const CPictureSink& sink) = 0;
    /// Encodes rows without gaps, 3 or 4 bytes per pixel. Quality is 1 to 100, for formats that have it.
    virtual bool Encode(const PictureHead& head, const uint8_t* pixels, int32_t bytesPerPixel,
                        const char* format, int32_t quality, std::vector<uint8_t>& file) = 0;
};

/// The module's exported function that returns the codec, and its type.
inline constexpr const char* kPictureCodecEntry = "gw_picture_codec";
using CPictureCodecEntry = CPictureCodec* (*)();

} // namespace gw
