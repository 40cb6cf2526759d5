// Reads and writes picture files through the codec. The codec's library supports far more formats than
// pictures need, some of which run commands, so only the formats in the table below are passed to it, and by
// name.

#include "PictureFile.h"

#include "CMappedFile.h"
#include "COrrinStream.h"
#include "CPixelBuffer.h"
#include "CSafeFile.h"
#include "Paths.h"
#include "Processes.h"
#include "Text.h"

#include <algorithm>
#include <optional>

using namespace std::string_view_literals;

namespace gw {

namespace {

constexpr uint64_t kFrameObjectBytes = 512; // the image object of a frame, which can be as small as one pixel

// The allowed picture formats. A name in a file must not select from everything the picture library supports,
// because some formats run commands.
struct ExtensionRow
{
    const char* extension;
    const char* format;
};
constexpr ExtensionRow kExtensions[] = {
    {"bmp",  "BMP" },
    {"dib",  "BMP" },
    {"gif",  "GIF" },
    {"jpg",  "JPEG"},
    {"jpeg", "JPEG"},
    {"jpe",  "JPEG"},
    {"png",  "PNG" },
    {"tga",  "TGA" },
    {"tif",  "TIFF"},
    {"tiff", "TIFF"},
    {"pcx",  "PCX" },
    {"dds",  "DDS" },
    {"psd",  "PSD" },
    {"pbm",  "PBM" },
    {"pgm",  "PGM" },
    {"ppm",  "PPM" },
    {"pnm",  "PNM" },
};

// The first bytes of each format, for pictures whose name does not identify it.
struct BeginningRow
{
    std::string_view beginning;
    const char* format;
};
constexpr BeginningRow kBeginnings[] = {
    {"BM"sv,           "BMP" },
    {"GIF8"sv,         "GIF" },
    {"\xff\xd8\xff"sv, "JPEG"},
    {"\x89PNG\r\n"sv,  "PNG" },
    {"II*\0"sv,        "TIFF"},
    {"MM\0*"sv,        "TIFF"},
    {"DDS "sv,         "DDS" },
    {"8BPS"sv,         "PSD" },
};

const char* FormatOfExtension(std::string_view extension)
{
    const auto row = std::ranges::find_if(
        kExtensions, [&](const ExtensionRow& known) { return EqualNoCase(known.extension, extension); });
    return row == std::end(kExtensions) ? nullptr : row->format;
}

std::string_view ExtensionOf(const PathParts& parts)
{
    return std::string_view(parts.extension).substr(parts.extension.empty() ? 0 : 1);
}

const char* FormatOf(const std::string& path, std::string_view file)
{
    const auto row = std::ranges::find_if(
        kBeginnings, [&](const BeginningRow& known) { return file.starts_with(known.beginning); });
    return row == std::end(kBeginnings) ? FormatOfExtension(ExtensionOf(SplitPath(path))) : row->format;
}

CPictureCodec* OpenCodec()
{
    void* const entry = ModuleEntry("gw_picture_codec", kPictureCodecEntry);
    return entry ? reinterpret_cast<CPictureCodecEntry>(entry)() : nullptr;
}

// Counts a picture's pixels before they are read; false if the scene's pictures would take too much memory.
bool Reserve(PictureMemory& memory, const PictureHead& head, bool everyFrame)
{
    const uint64_t pixels = static_cast<uint64_t>(head.width) * static_cast<uint64_t>(head.height);
    const uint64_t bytes = 4 * pixels + (everyFrame ? kFrameObjectBytes : 0);
    memory.m_bFull = bytes > memory.m_uiByteLimit - memory.m_uiBytesUsed;
    memory.m_uiBytesUsed += memory.m_bFull ? 0 : bytes;
    return !memory.m_bFull;
}

bool Decode(std::span<const std::byte> file, const char* format, bool everyFrame, PictureMemory* memory,
            const CFrameTaker& take)
{
    CPictureCodec* codec = format ? LoadPictureCodec() : nullptr;
    std::optional<CPixelLock> lock;
    const uint64_t usedBefore = memory ? memory->m_uiBytesUsed : 0;
    const auto place = [&](const PictureHead& head) -> uint8_t* {
        if (memory && !Reserve(*memory, head, everyFrame))
            return nullptr;
        lock.reset();
        CPixelBuffer& pixels = take(head);
        if (!pixels.SetRowAlignment(false) || !pixels.Create(head.width, head.height, 0))
            return nullptr;
        if (head.horizontalResolution > 0 && head.verticalResolution > 0)
            pixels.SetResolution(head.horizontalResolution, head.verticalResolution);
        return lock.emplace(pixels).Bytes().data();
    };
    const bool good = codec && codec->Decode(file, format, everyFrame, place);
    if (!good && memory)
        memory->m_uiBytesUsed = usedBefore; // the caller frees the pixels read so far
    return good;
}

bool DecodeOne(std::span<const std::byte> file, const char* format, PictureMemory* memory,
               CPixelBuffer& pixels)
{
    if (!pixels.Free())
        return false;
    const bool good =
        Decode(file, format, false, memory, [&](const PictureHead&) -> CPixelBuffer& { return pixels; });
    if (!good)
        pixels.Free();
    return good;
}

// Returns rows without gaps, as the codec needs them: the original ones, or packed into `packed`.
const uint8_t* DenseRows(const CPixelBuffer& pixels, const CPixelView& view, std::vector<uint8_t>& packed)
{
    const auto pixelBytes = static_cast<size_t>(pixels.GetBytesPerPixel());
    const size_t rowBytes = static_cast<size_t>(pixels.GetWidth()) * pixelBytes;
    if (rowBytes == pixels.GetStride())
        return view.Row(0);
    packed.reserve(rowBytes * static_cast<size_t>(pixels.GetHeight()));
    for (int32_t y = 0; y < pixels.GetHeight(); ++y)
        packed.insert(packed.end(), view.Row(y), view.Row(y) + rowBytes);
    return packed.data();
}

} // namespace

CPictureCodec* LoadPictureCodec()
{
    static CPictureCodec* const codec = OpenCodec();
    return codec;
}

bool ReadPicture(const std::string& path, CPixelBuffer& pixels, PictureMemory* memory)
{
    CMappedFile file;
    const bool isThere = file.Open(path) == EFailure::None;
    const bool isDecoded =
        DecodeOne(file.Bytes(), isThere ? FormatOf(path, file.Text()) : nullptr, memory, pixels);
    return isDecoded && file.IsWhole();
}

bool ReadFrames(const std::string& path, const CFrameTaker& take, PictureMemory* memory)
{
    CMappedFile file;
    const bool isThere = file.Open(path) == EFailure::None;
    const bool isDecoded =
        Decode(file.Bytes(), isThere ? FormatOf(path, file.Text()) : nullptr, true, memory, take);
    return isDecoded && file.IsWhole();
}

bool DecodeJPEG(std::span<const uint8_t> file, CPixelBuffer& pixels)
{
    return DecodeOne(std::as_bytes(file), "JPEG", nullptr, pixels);
}

bool EncodePicture(const CPixelBuffer& pixels, std::string_view extension, int32_t quality,
                   std::vector<uint8_t>& file)
{
    const char* format = FormatOfExtension(extension);
    const CPixelView view(pixels);
    if (!format || !view || pixels.GetBytesPerPixel() < 3)
        return false;
    CPictureCodec* codec = LoadPictureCodec();
    const CPixelLayout& layout = pixels.Layout();
    const PictureHead head{.width = layout.m_iWidth,
                           .height = layout.m_iHeight,
                           .horizontalResolution = layout.m_iHorizontalResolution,
                           .verticalResolution = layout.m_iVerticalResolution};
    std::vector<uint8_t> packed;
    return codec && codec->Encode(head, DenseRows(pixels, view, packed), pixels.GetBytesPerPixel(), format,
                                  quality, file);
}

bool WritePicture(const std::string& path, const CPixelBuffer& pixels, int32_t quality)
{
    std::vector<uint8_t> bytes;
    CSafeFile file;
    return EncodePicture(pixels, ExtensionOf(SplitPath(path)), quality, bytes) && file.Open(path) &&
           file.Write(std::as_bytes(std::span(bytes))) && file.Commit();
}

} // namespace gw
