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

/// The codec of this machine, loaded at the first call; null where its module does not lie beside the
/// program.
CPictureCodec* LoadPictureCodec();

/// Where a frame goes: its head is told, and the answer is the buffer that takes its pixels.
using CFrameTaker = std::function<CPixelBuffer&(const PictureHead&)>;

/// Reads a picture file into a buffer, 4 bytes a pixel. What it begins with tells the format, else its
/// extension. False, with the buffer empty, for what is no regular file, no picture, or too large. If the
/// memory of a scene's pictures is given, the pixels count there, and a picture that exceeds it is not read.
bool ReadPicture(const std::string& path, CPixelBuffer& pixels, PictureMemory* memory = nullptr);
/// Reads every frame of a film, or the one of a picture. False when any of it could not be taken.
bool ReadFrames(const std::string& path, const CFrameTaker& take, PictureMemory* memory = nullptr);
/// The picture in the bytes of a JPEG file.
bool DecodeJPEG(std::span<const uint8_t> file, CPixelBuffer& pixels);

/// Makes a picture file's bytes of a picture with 3 or 4 bytes a pixel; false for others. The format is an
/// extension without its point.
bool EncodePicture(const CPixelBuffer& pixels, std::string_view extension, int32_t quality,
                   std::vector<uint8_t>& file);
/// Writes a picture file of the format that the extension tells, replacing an old one in one step.
bool WritePicture(const std::string& path, const CPixelBuffer& pixels, int32_t quality);

} // namespace gw
