#include "HoldFoot.h"

#include "Play.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

// How much of a fade lies outside of the contact. A foot that is held before the source's stands, or longer,
// stands in more frames than the source's.
constexpr double kOutside = 0.25;

double Smoothstep(double x)
{
    x = std::clamp(x, 0.0, 1.0);
    return x * x * (3.0 - 2.0 * x);
}

// One end of a contact: the fade goes from `outer` (not held) to `inner` (held), in frames from the end
// inward.
struct Fade
{
    double outer;
    double inner;

    double Share(double framesInward) const
    {
        return inner <= outer ? 1.0 : Smoothstep((framesInward - outer) / (inner - outer));
    }
};

// `gap` is the number of frames to the next contact, or to the end of the motion.
Fade FadeOf(double gap, double length, double fadeFrames)
{
    return {-std::min(kOutside * fadeFrames, 0.5 * gap) - 0.5,
            std::min((1.0 - kOutside) * fadeFrames, 0.5 * length) - 0.5};
}

// A motion that begins or ends in a contact has no end there.
constexpr Fade kNoFade{0.0, -1.0};

// One contact with its fades.
struct Hold
{
    Contact contact;
    Fade start;
    Fade end;

    int First() const { return contact.first + static_cast<int>(std::floor(std::min(start.outer, 0.0))); }
    int Behind() const { return contact.end - static_cast<int>(std::floor(std::min(end.outer, 0.0))); }
    double Share(int frame) const
    {
        return std::min(start.Share(frame - contact.first), end.Share(contact.end - 1 - frame));
    }
};

Hold MakeHold(std::span<const Contact> contacts, size_t index, int frameCount, double fadeFrames)
{
    const Contact& contact = contacts[index];
    const int before = index == 0 ? 0 : contacts[index - 1].end;
    const int after = index + 1 == contacts.size() ? frameCount : contacts[index + 1].first;
    const double length = contact.end - contact.first;
    return {contact, contact.first == 0 ? kNoFade : FadeOf(contact.first - before, length, fadeFrames),
            contact.end == frameCount ? kNoFade : FadeOf(after - contact.end, length, fadeFrames)};
}

// The mean of a path over the ground, by the shares.
Vec3 MiddleOf(const Hold& hold, std::span<const Vec3> path)
{
    double x = 0.0;
    double z = 0.0;
    double total = 0.0;
    for (int frame = hold.contact.first; frame < hold.contact.end; ++frame)
    {
        const Vec3& place = path[static_cast<size_t>(frame)];
        const double share = hold.Share(frame);
        x += share * static_cast<double>(place.x);
        z += share * static_cast<double>(place.z);
        total += share;
    }
    return {static_cast<float>(x / total), 0.0f, static_cast<float>(z / total)};
}

} // namespace

std::vector<FootHold> HoldFoot(const FootPaths& foot, std::span<const Contact> contacts, double play,
                               double fadeFrames)
{
    std::vector<FootHold> holds(foot.path.size());
    const auto scale = static_cast<float>(foot.scale);
    const auto frameCount = static_cast<int>(foot.path.size());
    for (size_t i = 0; i < contacts.size(); ++i)
    {
        const Hold hold = MakeHold(contacts, i, frameCount, fadeFrames);
        const Vec3 place = MiddleOf(hold, foot.path);
        const Vec3 middle = MiddleOf(hold, foot.source);
        for (int frame = std::max(hold.First(), 0); frame < std::min(hold.Behind(), frameCount); ++frame)
        {
            FootHold& present = holds[static_cast<size_t>(frame)];
            const auto share = static_cast<float>(hold.Share(frame));
            if (share <= present.share)
                continue;
            Vec3 drift = (foot.source[static_cast<size_t>(frame)] - middle) * scale;
            drift.y = 0.0f;
            present = {share, place + BeyondPlay(drift, play)};
        }
    }
    return holds;
}

} // namespace gw
