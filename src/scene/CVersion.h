#pragma once

namespace gw {

/// The version of a container file.
struct CVersion
{
    int m_iMajor = -1;
    int m_iMinor = -1;

    constexpr int Number() const { return m_iMajor * 100 + m_iMinor; }
    constexpr bool IsSupported() const { return 1 <= Number() && Number() < 121; }
    constexpr bool AtLeast(CVersion other) const { return Number() >= other.Number(); }
};

/// The newest version, which is always written.
inline constexpr CVersion kNewestVersion{1, 20};

} // namespace gw
