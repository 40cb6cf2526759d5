// A planted foot is recognized by two things at once: its joints are close to their floors, and they hardly
// move. Either alone is not enough, because a swinging foot passes low over the floor and a raised foot may
// be held still. Recordings are noisy, so there are two pairs of thresholds: a strict one to start a contact
// and a looser one to end it. The speed of a frame is the lower of the speeds before and after it. So the
// frames in which a foot lands and lifts off belong to the contact. Finally, touches that are too short are
// dropped.

#include "FindContacts.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

double SpeedBetween(const FloorPath& joint, int from, int to, double secondsPerFrame)
{
    const Vec3& start = joint.positions[static_cast<size_t>(from)];
    return Vec3Length(joint.positions[static_cast<size_t>(to)] - start) / (secondsPerFrame * (to - from));
}

// Returns the larger value, or NaN if one of them is NaN.
double LargerOf(double a, double b)
{
    return a > b || std::isnan(a) ? a : b;
}

bool IsWithin(const FootMotion& motion, double height, double speed)
{
    return motion.height < height && motion.speed < speed;
}

} // namespace

std::vector<FootMotion> MotionOf(const FloorPath& joint, double secondsPerFrame)
{
    const auto last = static_cast<int>(joint.positions.size()) - 1;
    const int span =
        std::max(1, static_cast<int>(std::lround(std::min(kSpeedSeconds / secondsPerFrame, 1e6))));
    std::vector<FootMotion> motion;
    motion.reserve(joint.positions.size());
    for (int frame = 0; frame <= last; ++frame)
    {
        const int before = std::max(frame - span, 0);
        const int after = std::min(frame + span, last);
        const auto between = [&](int from, int to) { return SpeedBetween(joint, from, to, secondsPerFrame); };
        double speed = 0.0;
        if (before < frame && frame < after)
            speed = std::min(between(before, frame), between(frame, after));
        else if (before < after)
            speed = between(before, after);
        const float height = joint.positions[static_cast<size_t>(frame)].y - joint.floor;
        motion.push_back({static_cast<double>(height), speed});
    }
    return motion;
}

std::vector<FootMotion> JointMotion(const std::vector<FootMotion>& first,
                                    const std::vector<FootMotion>& second)
{
    std::vector<FootMotion> motion = first;
    for (size_t frame = 0; frame < motion.size(); ++frame)
        motion[frame] = {LargerOf(motion[frame].height, second[frame].height),
                         LargerOf(motion[frame].speed, second[frame].speed)};
    return motion;
}

std::vector<Contact> FindContacts(std::span<const FootMotion> motion, double leg, double secondsPerFrame)
{
    std::vector<Contact> contacts;
    bool stands = false;
    for (int frame = 0; frame < static_cast<int>(motion.size()); ++frame)
    {
        const FootMotion& at = motion[static_cast<size_t>(frame)];
        const bool stood = stands;
        stands = stood ? IsWithin(at, kLeaveHeight * leg, kLeaveSpeed * leg)
                       : IsWithin(at, kStandHeight * leg, kStandSpeed * leg);
        if (stands && !stood)
            contacts.push_back({frame, frame});
        if (stands)
            contacts.back().end = frame + 1;
    }
    std::erase_if(contacts, [=](const Contact& contact) {
        return (contact.end - contact.first) * secondsPerFrame < kLeastContactSeconds;
    });
    return contacts;
}

std::vector<Contact> FindContacts(std::span<const FloorPath> joints, double leg, double secondsPerFrame)
{
    std::vector<FootMotion> motion;
    for (const FloorPath& joint : joints)
    {
        const std::vector<FootMotion> more = MotionOf(joint, secondsPerFrame);
        motion = motion.empty() ? more : JointMotion(motion, more);
    }
    return FindContacts(std::span<const FootMotion>(motion), leg, secondsPerFrame);
}

std::vector<Contact> MergedContacts(std::vector<Contact> contacts, const std::vector<Contact>& more)
{
    contacts.insert(contacts.end(), more.begin(), more.end());
    std::ranges::sort(contacts, {}, &Contact::first);
    std::vector<Contact> merged;
    for (const Contact& contact : contacts)
    {
        if (merged.empty() || merged.back().end < contact.first)
            merged.push_back(contact);
        else
            merged.back().end = std::max(merged.back().end, contact.end);
    }
    return merged;
}

} // namespace gw
