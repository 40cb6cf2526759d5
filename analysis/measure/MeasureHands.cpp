// Finds what a hand touches. A motion has joints but no skin, so thigh, torso, head and hand get the radii of
// an adult body. Both sides use the same radii. These decide only what counts as a touch, not how far the
// result is off: that is the difference between the distances from the center line or point of a part.

#include "MeasureHands.h"

#include "CBodyTrack.h"
#include "Figures.h"
#include "Series.h"

#include <algorithm>
#include <cmath>
#include <vector>

namespace gw {

namespace {

constexpr double kTouch =
    50.0; // mm from where a wrist lies on a part, nearer or farther; radii of the parts:
constexpr double kThighRadius = 40.0;
constexpr double kTorsoRadius = 60.0;
constexpr double kHeadRadius = 70.0;
constexpr double kHandRadius = 40.0;  // wrist against wrist
constexpr double kFloorRadius = 30.0; // a flat hand
constexpr float kHeadMiddle = 107.0f; // above the head's joint
constexpr double kLeastTouchSeconds = 0.08;

double DistanceFromLine(const Vec3& point, const Vec3& start, const Vec3& end)
{
    const Vec3 line = end - start;
    const double square = Vec3Dot(line, line);
    const double share = square > 0.0 ? std::clamp(Vec3Dot(point - start, line) / square, 0.0, 1.0) : 0.0;
    return Vec3Length(point - start - line * static_cast<float>(share));
}

class CHandMeter
{
public:
    CHandMeter(const HandSides& sides, size_t side)
        : sides_(sides), m_uiSide(side), m_kTouches(sides.source.FrameCount())
    {
    }

    HandMeasures Measure();

private:
    using Places = std::vector<Vec3>;

    // `distance` returns the hand's distance from the part, given a body and a frame.
    template <class Distance>
    void AddPart(const char* name, double radius, const Distance& distance);
    void AddBody();
    void AddHead();
    void AddFloor();
    void MeasureDepth();

    const HandSides& sides_;
    size_t m_uiSide;
    std::vector<bool> m_kTouches;
    HandMeasures m_kHand;
};

template <class Distance>
void CHandMeter::AddPart(const char* name, double radius, const Distance& distance)
{
    const Places& sourceHand = sides_.source.Hand(m_uiSide);
    const Places& resultHand = sides_.result.Hand(m_uiSide);
    std::vector<float> gaps;
    double largest = 0.0;
    size_t largestFrame = 0;
    for (size_t f = 0; f < sourceHand.size(); ++f)
    {
        const double away = distance(sides_.source, sourceHand[f], f);
        if (!(std::fabs(away - radius) <= kTouch))
            continue;
        m_kTouches[f] = true;
        const double gap = std::fabs(distance(sides_.result, resultHand[f], f) - away);
        gaps.push_back(static_cast<float>(gap));
        if (std::isfinite(gap) && gap > largest)
        {
            largest = gap;
            largestFrame = f;
        }
    }
    if (static_cast<double>(gaps.size()) * sides_.secondsPerFrame < kLeastTouchSeconds)
        return;
    const auto gap = static_cast<double>(Percentile(std::move(gaps), kMostShare));
    if (m_kHand.gap && gap <= *m_kHand.gap)
        return;
    m_kHand.gap = gap;
    m_kHand.gapPart = name;
    m_kHand.gapLargest = largest;
    m_kHand.gapFrame = static_cast<int>(largestFrame);
}

void CHandMeter::AddBody()
{
    for (size_t leg = 0; leg < sides_.source.Legs().size(); ++leg)
        AddPart("thigh", kThighRadius, [=](const CBodyTrack& body, const Vec3& hand, size_t f) {
            return DistanceFromLine(hand, body.Legs()[leg].hip[f], body.Legs()[leg].knee[f]);
        });
    if (!sides_.source.Neck().empty() && !sides_.result.Neck().empty())
        AddPart("torso", kTorsoRadius, [](const CBodyTrack& body, const Vec3& hand, size_t f) {
            return DistanceFromLine(hand, body.Hips(f), body.Neck()[f]);
        });
    const size_t other = 1 - m_uiSide;
    if (!sides_.source.Hand(other).empty() && !sides_.result.Hand(other).empty())
        AddPart("other hand", kHandRadius, [=](const CBodyTrack& body, const Vec3& hand, size_t f) {
            return Vec3Length(hand - body.Hand(other)[f]);
        });
}

// On both sides, the center of the head is where the result's neck points: the head's rotation is measured as
// a direction instead.
void CHandMeter::AddHead()
{
    if (sides_.source.Head().empty() || sides_.result.Head().empty())
        return;
    const Places& head = sides_.result.Head();
    const Places& neck = sides_.result.Neck();
    AddPart("head", kHeadRadius, [&](const CBodyTrack& body, const Vec3& hand, size_t f) {
        return Vec3Length(hand - body.Head()[f] - Vec3Normalized(head[f] - neck[f]) * kHeadMiddle);
    });
}

void CHandMeter::AddFloor()
{
    AddPart("floor", kFloorRadius, [this](const CBodyTrack& body, const Vec3& hand, size_t) {
        return static_cast<double>(hand.y) - (&body == &sides_.source ? sides_.sourceFloor : 0.0);
    });
}

void CHandMeter::MeasureDepth()
{
    const Places& hand = sides_.result.Hand(m_uiSide);
    for (size_t f = 0; f < hand.size(); ++f)
    {
        const auto depth = static_cast<double>(-hand[f].y);
        if (!std::isfinite(depth) || depth <= m_kHand.depth)
            continue;
        m_kHand.depth = depth;
        m_kHand.depthFrame = static_cast<int>(f);
    }
}

HandMeasures CHandMeter::Measure()
{
    AddBody();
    AddHead();
    AddFloor();
    MeasureDepth();
    m_kHand.touchFrames = static_cast<size_t>(std::ranges::count(m_kTouches, true));
    return std::move(m_kHand);
}

} // namespace

HandMeasures MeasureHand(const HandSides& sides, size_t side)
{
    return CHandMeter(sides, side).Measure();
}

} // namespace gw
