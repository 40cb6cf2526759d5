#pragma once

#include "Vec3.h"

#include <array>
#include <cstddef>
#include <string>
#include <string_view>

namespace gw {

class CProfileOwner;

/// The frame rates that the editor accepts. Files can contain others, which are used anyway.
inline constexpr int kLowestFrameRate = 30;
inline constexpr int kHighestFrameRate = 240;
/// How far the root's position may lie from 0, on each axis.
inline constexpr int kOffsetLimit = 10'000;
/// The message about a number outside its limits; formatted with both limits.
inline constexpr int kNumberLimitsMessage = 157;

/// The edit fields of the profile editor, by control id.
enum EProfileField : int
{
    kNameField = 1038,
    kOffsetXField = 1039, ///< the three offset fields are never shown, but read
    kOffsetYField = 1040,
    kOffsetZField = 1041,
    kFrameRateField = 1042,
};

/// The texts in the edit fields, which can differ from the profile while the user types.
class CProfileFields
{
public:
    /// Returns the text of a field; empty for an unknown id.
    const std::string& Text(int id) const;
    /// Ignored for an unknown id.
    void Set(int id, std::string_view text);
    /// Writes a profile's values into all fields. The offset is truncated to integers.
    void Show(std::string_view name, const Vec3& rootOffset, int frameRate);

    /// Return the numbers in the fields, clamped to their limits. A field whose number was outside then shows
    /// the limit, and the owner informs the user.
    Vec3 ReadRootOffset(CProfileOwner& owner);
    int ReadFrameRate(CProfileOwner& owner);
    /// Returns the name, cut to the maximum length and without trailing blanks.
    std::string ReadName() const;

private:
    static constexpr size_t kFieldCount = 5;

    int ReadNumber(int id, int low, int high, CProfileOwner& owner);

    std::array<std::string, kFieldCount> m_kText; // starting at kNameField
};

} // namespace gw
