// Lines are drawn as triangles: GL's own wide lines have no round ends, and not every driver has them.

#include "CLabelFont.h"
#include "COffscreenContext.h"
#include "CPicturePainter.h"
#include "CSmoothSurface.h"

#include <array>
#include <cmath>
#include <numbers>
#include <optional>

#include <GL/gl.h>
#include <png.h>

namespace gw {

namespace {

constexpr int kCapCorners = 8; // of a round end

class CGLPicturePainter : public CPicturePainter
{
public:
    bool Begin(int width, int height) override;
    RgbPicture Paint(std::span<const PicturePanel> panels, LineColor paper) override;
    void End() override;
    std::vector<std::byte> EncodePng(const RgbPicture& picture) override;

private:
    std::optional<COffscreenContext> context_;
    std::optional<CSmoothSurface> surface_;
    std::optional<CLabelFont> font_; ///< loaded with the first label
    int m_iWidth = 0;
    int m_iHeight = 0;
};

struct Corner
{
    float x;
    float y;
    LineColor color;
};

// Appends a line with round ends, as triangles around its first corner.
void AppendLine(std::vector<Corner>& corners, const PictureLine& line)
{
    const float half = 0.5f * line.width;
    const float angle = std::atan2(line.toY - line.fromY, line.toX - line.fromX);
    const auto steps = static_cast<size_t>(half > 1.0f ? kCapCorners : 1);
    std::vector<Corner> outline;
    for (size_t i = 0; i < 2 * (steps + 1); ++i)
    {
        const bool isEnd = i <= steps; // first around the end, then around the start
        const float turn =
            std::numbers::pi_v<float> * static_cast<float>(isEnd ? i : i - 1) / static_cast<float>(steps);
        const float around = angle - 0.5f * std::numbers::pi_v<float> + turn;
        outline.push_back({(isEnd ? line.toX : line.fromX) + half * std::cos(around),
                           (isEnd ? line.toY : line.fromY) + half * std::sin(around), line.color});
    }
    for (size_t i = 2; i < outline.size(); ++i)
        corners.insert(corners.end(), {outline[0], outline[i - 1], outline[i]});
}

void DrawPanel(const PicturePanel& panel, int pictureHeight)
{
    std::vector<Corner> corners;
    for (const PictureLine& line : panel.lines)
        AppendLine(corners, line);
    if (corners.empty())
        return;
    glScissor(panel.left, pictureHeight - panel.top - panel.height, panel.width, panel.height);
    glVertexPointer(2, GL_FLOAT, sizeof(Corner), &corners[0].x);
    glColorPointer(4, GL_UNSIGNED_BYTE, sizeof(Corner), &corners[0].color);
    glDrawArrays(GL_TRIANGLES, 0, static_cast<GLsizei>(corners.size()));
}

float Share(uint8_t channel)
{
    return static_cast<float>(channel) / 255.0f;
}

void CGLPicturePainter::End()
{
    surface_.reset();
    context_.reset();
}

bool CGLPicturePainter::Begin(int width, int height)
{
    End(); // before another context becomes current
    m_iWidth = width;
    m_iHeight = height;
    if (!context_.emplace().Create(width, height))
        return false;
    surface_.emplace(width, height);
    glViewport(0, 0, width, height);
    glMatrixMode(GL_PROJECTION);
    glLoadIdentity();
    glOrtho(0.0, width, height, 0.0, -1.0, 1.0); // pixels, from the upper left corner
    glMatrixMode(GL_MODELVIEW);
    glLoadIdentity();
    glShadeModel(GL_FLAT);
    glEnableClientState(GL_VERTEX_ARRAY);
    glEnableClientState(GL_COLOR_ARRAY);
    return true;
}

RgbPicture CGLPicturePainter::Paint(std::span<const PicturePanel> panels, LineColor paper)
{
    surface_->Select();
    glDisable(GL_SCISSOR_TEST);
    glClearColor(Share(paper.red), Share(paper.green), Share(paper.blue), 1.0f);
    glClear(GL_COLOR_BUFFER_BIT);
    glEnable(GL_SCISSOR_TEST);
    for (const PicturePanel& panel : panels)
        DrawPanel(panel, m_iHeight);
    glDisable(GL_SCISSOR_TEST); // it would clip the copy
    surface_->Resolve();
    glFinish();
    RgbPicture picture = context_->ReadPixels(m_iWidth, m_iHeight);
    for (const PicturePanel& panel : panels)
    {
        if (!panel.labels.empty() && !font_)
            font_.emplace();
        for (const PictureLabel& label : panel.labels)
            font_->Draw(picture, label);
    }
    return picture;
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

extern "C" [[gnu::visibility("default")]] gw::CPicturePainter* gw_picture_painter()
{
    static gw::CGLPicturePainter painter;
    return &painter;
}
