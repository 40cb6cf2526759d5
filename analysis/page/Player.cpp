// The positions of all points in all shown frames are stored as 16-bit integers, in base64, because a browser
// reads that at once. JSON numbers would take three times the space.

#include "Player.h"

#include "CFigurePoser.h"
#include "CMarkup.h"
#include "HostBones.h"
#include "PageStyle.h"
#include "SourceScale.h"

#include <algorithm>
#include <cmath>
#include <cstdint>

namespace gw {

namespace {

constexpr size_t kMostPositions = 120000; // of one figure, about a megabyte of base64
constexpr double kMostSteps = 32000.0;    // of a coordinate

/// One figure's coordinates: x, y and z of each point, frame by frame.
struct Track
{
    std::vector<FigureBone> bones;
    std::vector<double> coordinates;
    size_t pointCount = 0;
};

struct Placing
{
    double frameScale; ///< frames of this clip per source frame
    double floor;
    double scale;
};

Track TrackOf(CFigurePoser& poser, const std::vector<int>& frames, const Placing& placing)
{
    Track track{.bones = poser.Bones(), .coordinates = {}, .pointCount = 0};
    Vec3 origin = kVec3Zero;
    for (size_t i = 0; i < frames.size(); ++i)
    {
        const std::vector<Vec3> points = poser.Points(frames[i] * placing.frameScale);
        if (i == 0)
            origin = {points[0].x, static_cast<float>(placing.floor), points[0].z};
        track.pointCount = points.size();
        for (const Vec3& point : points)
        {
            const Vec3 placed = point - origin;
            for (const float coordinate : {placed.x, placed.y, placed.z})
                track.coordinates.push_back(static_cast<double>(coordinate) * placing.scale);
        }
    }
    return track;
}

// Returns the length of one step in the coordinates' unit.
double StepOf(const Track& track)
{
    double largest = 1.0;
    for (const double coordinate : track.coordinates)
    {
        if (std::isfinite(coordinate))
            largest = std::max(largest, std::fabs(coordinate));
    }
    return largest / kMostSteps;
}

// Little-endian, as browsers store numbers. A coordinate that is not finite becomes 0.
std::string BytesOf(const Track& track, double step)
{
    std::string bytes;
    bytes.reserve(2 * track.coordinates.size());
    for (const double coordinate : track.coordinates)
    {
        const double steps = std::isfinite(coordinate) ? std::round(coordinate / step) : 0.0;
        const auto bits = static_cast<uint16_t>(static_cast<int16_t>(steps));
        bytes += static_cast<char>(bits & 0xff);
        bytes += static_cast<char>(bits >> 8);
    }
    return bytes;
}

void AppendFigure(CMarkup& page, const Track& track)
{
    const double step = StepOf(track);
    page.Raw("{\"points\":").Integer(static_cast<long long>(track.pointCount)).Raw(",\"step\":");
    page.Number(step, 6).Raw(",\"bones\":[");
    for (size_t i = 0; i < track.bones.size(); ++i)
    {
        const FigureBone& bone = track.bones[i];
        page.Raw(i > 0 ? ",[" : "[").Integer(static_cast<long long>(bone.from)).Raw(",");
        page.Integer(static_cast<long long>(bone.to)).Raw(",");
        page.Integer(static_cast<long long>(bone.side)).Raw("]");
    }
    page.Raw("],\"positions\":\"").Base64(BytesOf(track, step)).Raw("\"}");
}

void AppendContacts(CMarkup& page, const std::vector<Contact>& contacts)
{
    page.Raw("[");
    for (size_t i = 0; i < contacts.size(); ++i)
    {
        page.Raw(i > 0 ? ",[" : "[").Integer(contacts[i].first).Raw(",");
        page.Integer(contacts[i].end).Raw("]");
    }
    page.Raw("]");
}

void AppendFeet(CMarkup& page, const ConvertedMotion& motion)
{
    const std::vector<FootDetail>& feet = motion.measured->detail.feet;
    for (size_t i = 0; i < feet.size(); ++i)
    {
        const std::string& name = motion.measured->sums.feet[i].target;
        page.Raw(i > 0 ? ",{\"name\":" : "{\"name\":").JsonText(name).Raw(",\"source\":");
        AppendContacts(page, feet[i].sourceContacts);
        page.Raw(",\"result\":");
        AppendContacts(page, feet[i].resultContacts);
        page.Raw("}");
    }
}

void AppendMarks(CMarkup& page, std::span<const ChartMark> marks)
{
    for (size_t i = 0; i < marks.size(); ++i)
    {
        page.Raw(i > 0 ? ",[" : "[").Integer(marks[i].frame).Raw(",");
        page.Integer(static_cast<long long>(marks[i].number)).Raw("]");
    }
}

// Returns the stored frames of the source: all, or every second one and so on.
std::vector<int> FramesOf(int frameCount, size_t pointCount)
{
    const size_t most = std::max<size_t>(kMostPositions / std::max<size_t>(pointCount, 1), 2);
    const int stride = static_cast<int>((static_cast<size_t>(frameCount) + most - 1) / most);
    std::vector<int> frames;
    for (int frame = 0; frame < frameCount; frame += stride)
        frames.push_back(frame);
    return frames;
}

constexpr std::string_view kMarkup =
    "<h3>Player</h3>\n<div class=\"player\" id=\"player\">\n"
    "<canvas tabindex=\"0\" role=\"img\" aria-label=\"Source and result, moving. Drag to turn the figures.\">"
    "</canvas>\n"
    "<div class=\"bar\"><div class=\"marks\"></div>"
    "<input type=\"range\" min=\"0\" value=\"0\" aria-label=\"Frame\"/><div class=\"strips\"></div></div>\n"
    "<p class=\"controls\"><button type=\"button\" class=\"play\">Play</button>"
    "<select aria-label=\"Speed\"><option value=\"1\">full speed</option><option value=\"0.5\">half speed"
    "</option><option value=\"0.25\">quarter speed</option></select><span class=\"views\"></span>"
    "<span class=\"about\"><i class=\"key left\"></i>left <i class=\"key right\"></i>right "
    "<i class=\"key strip source\"></i>planted in the source <i class=\"key strip result\"></i>in the "
    "result <span class=\"feet\"></span></span></p>\n"
    "<noscript><p class=\"about\">The player needs scripts.</p></noscript>\n</div>\n";

} // namespace

void AppendPlayer(CMarkup& page, const ConvertedMotion& motion, std::span<const ChartMark> marks)
{
    const ConversionMeasures& sums = motion.measured->sums;
    CFigurePoser source(motion.sourceClip, sums.bones, &BoneMeasures::source);
    CFigurePoser result(motion.resultClip, sums.bones, &BoneMeasures::target);
    const size_t points = std::max(source.Bones().size(), result.Bones().size()) + 1;
    const std::vector<int> frames = FramesOf(sums.frameCount, points);
    if (frames.size() < 2)
        return;
    const Track sourceTrack =
        TrackOf(source, frames, {1.0, motion.measured->detail.sourceFloor, SourceScale(sums)});
    const Track resultTrack = TrackOf(result, frames, {sums.frameScale, 0.0, 1.0});
    result.Points(0.0);
    const Vec3 across = result.Across(kRightBones.thigh, kLeftBones.thigh);
    page.Raw(kMarkup).Raw("<script type=\"application/json\" id=\"motion\">\n{\"frames\":");
    page.Integer(sums.frameCount).Raw(",\"stride\":").Integer(frames[1]);
    page.Raw(",\"frameScale\":").Number(sums.frameScale, 6);
    page.Raw(",\"seconds\":").Number(motion.measured->detail.secondsPerFrame, 8);
    page.Raw(",\"across\":[").Number(static_cast<double>(across.x), 5).Raw(",");
    page.Number(static_cast<double>(across.z), 5).Raw("],\n\"feet\":[");
    AppendFeet(page, motion);
    page.Raw("],\"marks\":[");
    AppendMarks(page, marks);
    page.Raw("],\n\"source\":");
    AppendFigure(page, sourceTrack);
    page.Raw(",\n\"result\":");
    AppendFigure(page, resultTrack);
    page.Raw("}\n</script>\n<script>\n").Raw(kPlayerScript).Raw("</script>\n");
}

} // namespace gw
