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

// Checks how high and how fast the joints of a foot are in a frame.
class CFootState
{
public:
    CFootState(std::span<const FloorPath> joints, double leg, double secondsPerFrame)
        : m_kJoints(joints), m_fLeg(leg), m_fSecondsPerFrame(secondsPerFrame),
          m_iSpan(std::max(1, static_cast<int>(std::lround(std::min(kSpeedSeconds / secondsPerFrame, 1e6)))))
    {
    }

    int FrameCount() const { return m_kJoints.empty() ? 0 : static_cast<int>(m_kJoints[0].positions.size()); }
    bool IsWithin(int frame, double height, double speed) const
    {
        return std::ranges::all_of(m_kJoints, [=, this](const FloorPath& joint) {
            const double above = static_cast<double>(At(joint, frame).y - joint.floor);
            return above < height * m_fLeg && Speed(joint, frame) < speed * m_fLeg;
        });
    }

private:
    static const Vec3& At(const FloorPath& joint, int frame)
    {
        return joint.positions[static_cast<size_t>(frame)];
    }
    double SpeedBetween(const FloorPath& joint, int from, int to) const
    {
        return Vec3Length(At(joint, to) - At(joint, from)) / (m_fSecondsPerFrame * (to - from));
    }
    // Returns the lower of the speeds before and after the frame, so a contact includes its first and last
    // frame.
    double Speed(const FloorPath& joint, int frame) const
    {
        const int before = std::max(frame - m_iSpan, 0);
        const int after = std::min(frame + m_iSpan, FrameCount() - 1);
        if (before == frame && after == frame)
            return 0.0;
        if (before == frame || after == frame)
            return SpeedBetween(joint, before, after);
        return std::min(SpeedBetween(joint, before, frame), SpeedBetween(joint, frame, after));
    }

    std::span<const FloorPath> m_kJoints;
    double m_fLeg;
    double m_fSecondsPerFrame;
    int m_iSpan;
};

} // namespace

std::vector<Contact> FindContacts(std::span<const FloorPath> joints, double leg, double secondsPerFrame)
{
    const CFootState foot(joints, leg, secondsPerFrame);
    std::vector<Contact> contacts;
    bool stands = false;
    for (int frame = 0; frame < foot.FrameCount(); ++frame)
    {
        const bool stood = stands;
        stands = stood ? foot.IsWithin(frame, kLeaveHeight, kLeaveSpeed)
                       : foot.IsWithin(frame, kStandHeight, kStandSpeed);
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
