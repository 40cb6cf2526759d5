// Draws poses side by side into one picture, or one after another into many. All poses of a motion are
// measured first, so that they share one scale and one floor; then each is projected into its own panel.

#include "RenderPicture.h"

#include "CGLView.h"
#include "CPicturePainter.h"
#include "CPosedLines.h"
#include "PicturePainter.h"
#include "UprightPoint.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <memory>

namespace gw {

namespace {

constexpr float kMargin = 1.08f;       // around the figure
constexpr int kFloorSamples = 40;      // poses of a motion that are looked at to find its floor
constexpr float kFloorShare = 0.25f;   // of these, the share whose lowest point may be below the floor
constexpr int kLeastLabelWidth = 90;   // of a panel, in pixels
constexpr int kLeastLabelHeight = 100; // smaller panels have no labels
constexpr int kMostFloorLines = 40;

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

struct Range
{
    float least = std::numeric_limits<float>::max();
    float largest = std::numeric_limits<float>::lowest();

    void Add(float value)
    {
        least = std::min(least, value);
        largest = std::max(largest, value);
    }
    bool IsEmpty() const { return least > largest; }
    float Middle() const { return 0.5f * (least + largest); }
};

template <class Visit>
void EachPoint(const std::vector<PosedLine>& lines, const Visit& visit)
{
    for (const PosedLine& line : lines)
    {
        visit(line.from);
        visit(line.to);
    }
}

// Returns a round number: 1, 2 or 5 times a power of ten, at or below a positive value.
float RoundBelow(float value)
{
    const float power = std::pow(10.0f, std::floor(std::log10(value)));
    const float digits = value / power;
    return power * (digits >= 5.0f ? 5.0f : digits >= 2.0f ? 2.0f : 1.0f);
}

/// Draws the poses of one motion.
class CPoseDrawer
{
public:
    CPoseDrawer(const PictureOptions& options, const PictureMotion& motion, LineColor labelColor)
        : options_(options), motion_(motion), style_(options.isDark ? kDarkStyle : kLightStyle),
          m_kLabelColor(labelColor), m_kLines(motion, style_, options.hasAxes)
    {
        m_kView.SetScene(motion.root.Get(), motion.frameStep, motion.lastFrame);
    }

    // Finds the floor, the direction that the figure faces, and the extent of all poses.
    void Measure(const std::vector<Moment>& moments)
    {
        FindFloor();
        GoTo(moments.front());
        m_kCamera = CPictureCamera(options_.view, Across());
        for (const Moment& moment : moments)
        {
            const std::vector<PosedLine> lines = LinesAt(moment);
            const Vec3 center = CenterOf(lines);
            EachPoint(lines, [&](const Vec3& point) {
                const Vec3 seen = m_kCamera.Project(point, center);
                m_fHalfWidth = std::max(m_fHalfWidth, std::fabs(seen.x));
                m_kHeight.Add(seen.y);
                m_kHeight.Add(m_kCamera.Project({point.x, m_fFloor, point.z}, center).y); // the shadow
            });
        }
        m_kHeight.Add(0.0f); // the floor below the figure
    }

    PicturePanel Draw(const Moment& moment, const Cell& cell)
    {
        PicturePanel panel{.left = cell.left,
                           .top = cell.top,
                           .width = cell.width,
                           .height = cell.height,
                           .lines = {},
                           .labels = {}};
        const std::vector<PosedLine> lines = LinesAt(moment);
        const Vec3 center = CenterOf(lines);
        const Placing placing = PlacingIn(cell);
        AddFloor(panel, placing, center);
        AddShadow(panel, placing, center, lines);
        AddFigure(panel, placing, center, lines);
        if (HasLabels(cell))
            AddLabels(panel, cell, moment);
        return panel;
    }

private:
    /// Where projected points are in a picture.
    struct Placing
    {
        float x;     ///< of the center, in pixels
        float y;     ///< of the center, on the floor
        float scale; ///< pixels per unit
        float width; ///< of a bone, in pixels
        float reach; ///< of the panel's diagonal, in units
    };

    void GoTo(const Moment& moment)
    {
        if (moment.lastFrame > 0)
            m_kView.Seek(moment.frame, moment.lastFrame);
        else
            m_kView.SeekStart();
    }

    std::vector<PosedLine> LinesAt(const Moment& moment)
    {
        GoTo(moment);
        return m_kLines.Lines(options_.highlight);
    }

    void FindFloor()
    {
        const int last = LastFrame(motion_);
        const int stride = std::max(1, last / kFloorSamples);
        std::vector<float> lowest;
        for (int frame = 0; frame <= last; frame += stride)
        {
            Range height;
            EachPoint(LinesAt({frame, last}), [&](const Vec3& point) { height.Add(point.y); });
            if (!height.IsEmpty())
                lowest.push_back(height.least);
        }
        if (lowest.empty())
            return;
        const auto floor =
            lowest.begin() + static_cast<long>(kFloorShare * static_cast<float>(lowest.size() - 1));
        std::ranges::nth_element(lowest, floor);
        m_fFloor = *floor;
    }

    Vec3 Across() const
    {
        if (!motion_.leftHip || !motion_.rightHip)
            return kVec3UnitX;
        Vec3 across = UprightPoint(motion_.leftHip->m_kWorldMatrix.Translation(), motion_.up) -
                      UprightPoint(motion_.rightHip->m_kWorldMatrix.Translation(), motion_.up);
        across.y = 0.0f;
        across = Vec3Normalized(across);
        const bool isUsable = std::fabs(Vec3Dot(across, across) - 1.0f) < 0.01f;
        return isUsable ? across : kVec3UnitX;
    }

    // Returns the point of the floor below the middle of a pose.
    Vec3 CenterOf(const std::vector<PosedLine>& lines) const
    {
        Range x;
        Range z;
        EachPoint(lines, [&](const Vec3& point) {
            x.Add(point.x);
            z.Add(point.z);
        });
        return x.IsEmpty() ? Vec3{0.0f, m_fFloor, 0.0f} : Vec3{x.Middle(), m_fFloor, z.Middle()};
    }

    bool HasLabels(const Cell& cell) const
    {
        return options_.hasLabels && cell.width >= kLeastLabelWidth && cell.height >= kLeastLabelHeight;
    }
    static int LabelSize(const Cell& cell) { return std::clamp(cell.height / 24, 11, 20); }

    Placing PlacingIn(const Cell& cell) const
    {
        const auto width = static_cast<float>(cell.width);
        const auto labels = static_cast<float>(HasLabels(cell) ? 3 * LabelSize(cell) : 0);
        const float height = static_cast<float>(cell.height) - labels;
        const float extent = std::max(m_kHeight.largest - m_kHeight.least, 1e-6f);
        const float scale = std::min(width / std::max(2.0f * m_fHalfWidth, 1e-6f), height / extent) / kMargin;
        const float middle = labels + 0.5f * height;
        return {static_cast<float>(cell.left) + 0.5f * width,
                static_cast<float>(cell.top) + middle + m_kHeight.Middle() * scale, scale,
                std::clamp(0.012f * extent * scale, 1.5f, 12.0f), (width + height) / scale};
    }

    void AddLine(PicturePanel& panel, const Placing& placing, const Vec3& from, const Vec3& to,
                 LineColor color, float width) const
    {
        panel.lines.push_back({placing.x + from.x * placing.scale, placing.y - from.y * placing.scale,
                               placing.x + to.x * placing.scale, placing.y - to.y * placing.scale, color,
                               width});
    }

    // A grid that is fixed to the floor.
    void AddFloor(PicturePanel& panel, const Placing& placing, const Vec3& center) const
    {
        const float size = std::max(m_kHeight.largest - m_kHeight.least, 2.0f * m_fHalfWidth);
        if (!(size > 0.0f) || !std::isfinite(size))
            return;
        const float step = RoundBelow(0.34f * size);
        const int count = std::min(static_cast<int>(std::ceil(0.5f * placing.reach / step)), kMostFloorLines);
        const float reach = step * static_cast<float>(count);
        const float x = std::round(center.x / step) * step;
        const float z = std::round(center.z / step) * step;
        const auto add = [&](const Vec3& from, const Vec3& to) {
            AddLine(panel, placing, m_kCamera.Project(from, center), m_kCamera.Project(to, center),
                    style_.floor, 1.0f);
        };
        for (int i = -count; i <= count; ++i)
        {
            const float at = step * static_cast<float>(i);
            add({x + at, m_fFloor, z - reach}, {x + at, m_fFloor, z + reach});
            add({x - reach, m_fFloor, z + at}, {x + reach, m_fFloor, z + at});
        }
    }

    void AddShadow(PicturePanel& panel, const Placing& placing, const Vec3& center,
                   const std::vector<PosedLine>& lines) const
    {
        for (const PosedLine& line : lines)
        {
            if (!line.isBone)
                continue;
            AddLine(panel, placing, m_kCamera.Project({line.from.x, m_fFloor, line.from.z}, center),
                    m_kCamera.Project({line.to.x, m_fFloor, line.to.z}, center), style_.shadow,
                    0.9f * placing.width);
        }
    }

    // Nearer lines cover farther ones, and axes cover everything.
    void AddFigure(PicturePanel& panel, const Placing& placing, const Vec3& center,
                   const std::vector<PosedLine>& lines) const
    {
        struct Seen
        {
            Vec3 from;
            Vec3 to;
            const PosedLine* line;
        };
        std::vector<Seen> seen;
        seen.reserve(lines.size());
        for (const PosedLine& line : lines)
            seen.push_back({m_kCamera.Project(line.from, center), m_kCamera.Project(line.to, center), &line});
        const auto bonesEnd =
            std::stable_partition(seen.begin(), seen.end(), [](const Seen& s) { return s.line->isBone; });
        std::stable_sort(seen.begin(), bonesEnd,
                         [](const Seen& a, const Seen& b) { return a.from.z + a.to.z < b.from.z + b.to.z; });
        const float boneWidth = options_.hasAxes ? 0.5f * placing.width : placing.width; // axes lie on bones
        const float thinWidth = options_.hasAxes ? 2.0f : 1.0f;
        for (const Seen& s : seen)
            AddLine(panel, placing, s.from, s.to, s.line->color, s.line->isBone ? boneWidth : thinWidth);
    }

    void AddLabels(PicturePanel& panel, const Cell& cell, const Moment& moment) const
    {
        const int size = LabelSize(cell);
        PictureLabel label{.text = motion_.label,
                           .left = cell.left + size,
                           .baseline = cell.top + size * 5 / 3,
                           .maxWidth = cell.width - 2 * size,
                           .size = size,
                           .color = m_kLabelColor};
        if (!label.text.empty())
            panel.labels.push_back(label);
        const double share =
            moment.lastFrame > 0 ? static_cast<double>(moment.frame) / moment.lastFrame : 0.0;
        label.text = "frame " + std::to_string(std::lround(share * LastFrame(motion_)));
        label.baseline += size * 4 / 3;
        label.color = style_.soft;
        panel.labels.push_back(label);
    }

    const PictureOptions& options_;
    const PictureMotion& motion_;
    const PictureStyle& style_;
    LineColor m_kLabelColor;
    CPosedLines m_kLines;
    CGLView m_kView;
    CPictureCamera m_kCamera;
    float m_fFloor = 0.0f;
    float m_fHalfWidth = 0.0f;
    Range m_kHeight; ///< of projected points above the center
};

using Drawers = std::vector<std::unique_ptr<CPoseDrawer>>;

Drawers MeasuredDrawers(const PictureOptions& options, const std::vector<Moment>& moments)
{
    const PictureStyle& style = options.isDark ? kDarkStyle : kLightStyle;
    Drawers drawers;
    for (const PictureMotion& motion : options.motions)
    {
        const LineColor color = drawers.empty() ? style.source : style.result;
        drawers.push_back(std::make_unique<CPoseDrawer>(options, motion, color));
        drawers.back()->Measure(moments);
    }
    return drawers;
}

RgbPicture DrawAll(const PictureOptions& options, CPicturePainter& painter)
{
    const Grid grid = GridOf(options);
    const std::vector<Moment> moments = MomentsOf(options);
    const bool strip = moments.size() > 1;
    const Drawers drawers = MeasuredDrawers(options, moments);
    std::vector<PicturePanel> panels;
    for (int motion = 0; motion < static_cast<int>(drawers.size()); ++motion)
    {
        for (int pose = 0; pose < options.poseCount; ++pose)
            panels.push_back(drawers[static_cast<size_t>(motion)]->Draw(
                moments[static_cast<size_t>(pose)], strip ? grid.At(pose, motion) : grid.At(motion, 0)));
    }
    return painter.Paint(panels, (options.isDark ? kDarkStyle : kLightStyle).paper);
}

bool DrawFrames(const PictureOptions& options, CPicturePainter& painter, const std::vector<Moment>& moments,
                const std::function<bool(const RgbPicture&)>& take)
{
    const Grid grid = GridOf(options);
    const Drawers drawers = MeasuredDrawers(options, moments);
    for (const Moment& moment : moments)
    {
        std::vector<PicturePanel> panels;
        for (size_t motion = 0; motion < drawers.size(); ++motion)
            panels.push_back(drawers[motion]->Draw(moment, grid.At(static_cast<int>(motion), 0)));
        if (!take(painter.Paint(panels, (options.isDark ? kDarkStyle : kLightStyle).paper)))
            return false;
    }
    return true;
}

} // namespace

int LastFrame(const PictureMotion& motion)
{
    constexpr float kMost = 1e6f; // longer than any motion, and exactly representable
    return motion.lastFrame > 0.0f ? static_cast<int>(std::min(motion.lastFrame, kMost)) : 0;
}

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
        picture = DrawAll(options, *painter);
    painter->End();
    return begun ? EPictureAnswer::Done : EPictureAnswer::NoContext;
}

EPictureAnswer RenderFrames(const PictureOptions& options, int count, int stride,
                            const std::function<bool(const RgbPicture&)>& take)
{
    if (!IsDrawable(options) || options.poseCount != 1 || count < 1)
        return EPictureAnswer::BadSize;
    CPicturePainter* const painter = LoadPicturePainter();
    if (!painter)
        return EPictureAnswer::NoPainter;
    const int last = LastFrame(options.motions.front());
    std::vector<Moment> moments;
    moments.reserve(static_cast<size_t>(count));
    for (int i = 0; i < count; ++i)
        moments.push_back({std::min(FirstFrame(options) + i * stride, last), last});
    const bool begun = painter->Begin(options.width, options.height);
    const bool drawn = begun && DrawFrames(options, *painter, moments, take);
    painter->End();
    if (!begun)
        return EPictureAnswer::NoContext;
    return drawn ? EPictureAnswer::Done : EPictureAnswer::Stopped;
}

} // namespace gw
