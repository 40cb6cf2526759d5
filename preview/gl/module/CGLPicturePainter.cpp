#include "COffscreenContext.h"
#include "CPicturePainter.h"
#include "GLPainter.h"

#include <optional>

#include <png.h>

namespace gw {

namespace {

class CGLPicturePainter : public CPicturePainter
{
public:
    bool Begin(int width, int height) override;
    RgbPicture Paint(const GLScene& scene, int width, int height) override;
    void End() override { context_.reset(); }
    std::vector<std::byte> EncodePng(const RgbPicture& picture) override;

private:
    std::optional<COffscreenContext> context_;
};

bool CGLPicturePainter::Begin(int width, int height)
{
    context_.reset(); // before another one becomes current
    if (!context_.emplace().Create(width, height))
        return false;
    InitGL();
    return true;
}

RgbPicture CGLPicturePainter::Paint(const GLScene& scene, int width, int height)
{
    ResizeGL(width, height);
    PaintGL(scene);
    return context_->ReadPixels(width, height);
}

std::vector<std::byte> CGLPicturePainter::EncodePng(const RgbPicture& picture)
{
    png_image image{};
    image.version = PNG_IMAGE_VERSION;
    image.width = static_cast<png_uint_32>(picture.width);
    image.height = static_cast<png_uint_32>(picture.height);
    image.format = PNG_FORMAT_RGB;
    png_alloc_size_t byteCount = PNG_IMAGE_PNG_SIZE_MAX(image);
    std::vector<std::byte> bytes(byteCount);
    if (!png_image_write_to_memory(&image, bytes.data(), &byteCount, 0, picture.rgb.data(), 0, nullptr))
        byteCount = 0;
    bytes.resize(byteCount);
    return bytes;
}

} // namespace

} // namespace gw

extern "C" gw::CPicturePainter* gw_picture_painter()
{
    static gw::CGLPicturePainter painter;
    return &painter;
}
