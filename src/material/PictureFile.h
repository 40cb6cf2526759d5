#pragma once

#include "CPictureCodec.h"

#include <cstddef>
#include <cstdint>
#include <functional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

class CPixelBuffer;
struct PictureMemory;

/// Returns the codec, loaded at the first call; null if its module is not next to the program.
CPictureCodec* LoadPictureCodec();

/// Receives a frame's properties and returns the buffer for its pixels.
using CFrameTaker = std::function<CPixelBuffer&(const PictureHead&)>;

/// Reads a picture file into a buffer, 4 bytes per pixel. The format is recognized by its first bytes,
/// otherwise by its extension. Returns false, with an empty buffer, if it is not a regular file or a picture,
/// or is too large. If the memory of a scene's pictures is given, the pixels count there, and a picture that
/// exceeds it is not read.
bool ReadPicture(const std::string& path, CPixelBuffer& pixels, PictureMemory* memory = nullptr);
/// Reads every frame of a film, or the only one of a picture. Returns false if any frame failed.
bool ReadFrames(const std::string& path, const CFrameTaker& take, PictureMemory* memory = nullptr);
/// Decodes the bytes of a JPEG file.
bool DecodeJPEG(std::span<const uint8_t> file, CPixelBuffer& pixels);

/// Encodes a picture with 3 or 4 bytes per pixel; false for others. The format is an extension without its
/// dot.
bool EncodePicture(const CPixelBuffer& pixels, std::string_view extension, int32_t quality,
                   std::vector<uint8_t>& file);
/// Writes a picture file in the format of its extension, replacing an old one atomically.
bool WritePicture(const std::string& path, const CPixelBuffer& pixels, int32_t quality);

} // namespace gw
