// Draws poses side by side into one picture. All poses of a motion are measured first, so that they share one
// scale; then each is drawn into its own cell.

#include "RenderPicture.h"

#include "Angles.h"
#include "CGLView.h"
#include "CPicturePainter.h"
#include "GLScene.h"
#include "PicturePainter.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

constexpr float kMargin = 1.1f; // around the figure

struct Cell
{
    int left;
    int top;
    int width;
    int height;
};

// The picture divided into equal views; the first ones get the remaining pixels.
struct Grid
{
    int width;
    int height;
    int columns;
    int rows;

    Cell At(int column, int row) const
    {
        const int left = width * column / columns;
        const int top = height * row / rows;
        return {left, top, width * (column + 1) / columns - left, height * (row + 1) / rows - top};
    }
};

// A moment in all motions: a frame of the first one, relative to its frame count.
struct Moment
{
    int frame;
    int lastFrame;
};

int LastFrame(const PictureMotion& motion)
{
    constexpr float kMost = 1e6f; // longer than any motion, and exactly representable
    return motion.lastFrame > 0.0f ? static_cast<int>(std::min(motion.lastFrame, kMost)) : 0;
}

std::vector<Moment> MomentsOf(const PictureOptions& options)
{
    const int last = LastFrame(options.motions.front());
    const int first = FirstFrame(options);
    const int gaps = std::max(options.poseCount - 1, 1);
    std::vector<Moment> moments;
    moments.reserve(static_cast<size_t>(options.poseCount));
    for (int64_t pose = 0; pose < options.poseCount; ++pose)
        moments.push_back({first + static_cast<int>((last - first) * pose / gaps), last});
    return moments;
}

Grid GridOf(const PictureOptions& options)
{
    const int motions = static_cast<int>(options.motions.size());
    if (options.poseCount > 1)
        return {options.width, options.height, options.poseCount, motions};
    return {options.width, options.height, motions, 1};
}

void Paste(const RgbPicture& part, const Cell& cell, RgbPicture& picture)
{
    for (int y = 0; y < cell.height; ++y)
        std::copy_n(part.Pixel(0, y), part.RowBytes(), picture.Pixel(cell.left, cell.top + y));
}

// Center and half size of the lines' axis-aligned box; zero without lines.
struct Extent
{
    Vec3 centre = kVec3Zero;
    Vec3 half = kVec3Zero;
};

Extent ExtentOf(std::span<const LineEnd> ends)
{
    if (ends.empty())
        return {};
    Vec3 low = ends[0].point;
    Vec3 high = low;
    for (const LineEnd& end : ends)
    {
        const Vec3& p = end.point;
        low = {std::min(low.x, p.x), std::min(low.y, p.y), std::min(low.z, p.z)};
        high = {std::max(high.x, p.x), std::max(high.y, p.y), std::max(high.z, p.z)};
    }
    return {(low + high) * 0.5f, (high - low) * 0.5f};
}

// Draws the poses of one motion.
class CPoseDrawer
{
public:
    CPoseDrawer(const PictureMotion& motion, const std::string& highlight)
    {
        m_kView.SetScene(motion.root.Get(), motion.frameStep, motion.lastFrame);
        m_kView.SetHighlight(highlight);
    }

    // Computes the box that contains every pose.
    void Measure(const std::vector<Moment>& moments)
    {
        for (const Moment& moment : moments)
        {
            GoTo(moment);
            const Vec3 half = ExtentOf(m_kView.DrawScene().Ends()).half;
            m_kHalf = {std::max(m_kHalf.x, half.x), std::max(m_kHalf.y, half.y), std::max(m_kHalf.z, half.z)};
        }
    }

    RgbPicture Draw(CPicturePainter& painter, const Moment& moment, const Cell& cell)
    {
        GoTo(moment);
        CCamera& camera = m_kView.m_kCamera;
        camera.m_kLookAt = ExtentOf(m_kView.DrawScene().Ends()).centre;
        camera.m_kEye = camera.m_kLookAt + Vec3{0.0f, 0.0f, EyeDistance(cell)};
        return painter.Paint(SceneOf(m_kView), cell.width, cell.height);
    }

private:
    void GoTo(const Moment& moment)
    {
        if (moment.lastFrame > 0)
            m_kView.Seek(moment.frame, moment.lastFrame);
        else
            m_kView.SeekStart();
    }

    // Returns the distance at which the near side of the box fits into the cell. A bounding sphere would take
    // twice the space.
    float EyeDistance(const Cell& cell) const
    {
        const float heightToWidth = static_cast<float>(cell.height) / static_cast<float>(cell.width);
        const float slope = static_cast<float>(std::tan(kAngleOfView / 2 * kDegreesToRadians64));
        return m_kHalf.z + kMargin / slope * std::max(m_kHalf.y, m_kHalf.x * heightToWidth);
    }

    CGLView m_kView;
    Vec3 m_kHalf = kVec3Zero;
};

void DrawAll(const PictureOptions& options, CPicturePainter& painter, RgbPicture& picture)
{
    picture = RgbPicture(options.width, options.height);
    const Grid grid = GridOf(options);
    const std::vector<Moment> moments = MomentsOf(options);
    const bool strip = moments.size() > 1;
    for (int motion = 0; motion < static_cast<int>(options.motions.size()); ++motion)
    {
        CPoseDrawer drawer(options.motions[static_cast<size_t>(motion)], options.highlight);
        drawer.Measure(moments);
        for (int pose = 0; pose < options.poseCount; ++pose)
        {
            const Cell cell = strip ? grid.At(pose, motion) : grid.At(motion, 0);
            Paste(drawer.Draw(painter, moments[static_cast<size_t>(pose)], cell), cell, picture);
        }
    }
}

} // namespace

int FirstFrame(const PictureOptions& options)
{
    return std::clamp(options.frame, 0, LastFrame(options.motions.front()));
}

bool IsDrawable(const PictureOptions& options)
{
    // Each part of a side needs at least one pixel.
    const auto holds = [](int side, int parts) { return side <= kLongestSide && parts <= side; };
    if (options.motions.empty() || options.motions.size() > kLongestSide || options.poseCount < 1)
        return false;
    const Grid grid = GridOf(options);
    return holds(grid.width, grid.columns) && holds(grid.height, grid.rows);
}

EPictureAnswer RenderPicture(const PictureOptions& options, RgbPicture& picture)
{
    if (!IsDrawable(options))
        return EPictureAnswer::BadSize;
    CPicturePainter* const painter = LoadPicturePainter();
    if (!painter)
        return EPictureAnswer::NoPainter;
    const bool begun = painter->Begin(options.width, options.height);
    if (begun)
        DrawAll(options, *painter, picture);
    painter->End();
    return begun ? EPictureAnswer::Done : EPictureAnswer::NoContext;
}

} // namespace gw
