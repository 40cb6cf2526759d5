#pragma once

#include "Vec3.h"

#include <array>
#include <cstddef>
#include <string>
#include <string_view>

namespace gw {

class CProfileOwner;

/// The frame rates that the editor accepts. A file may hold others, which count all the same.
inline constexpr int kLowestFrameRate = 30;
inline constexpr int kHighestFrameRate = 240;
/// How far the root's position may lie from 0, on each axis.
inline constexpr int kOffsetLimit = 10'000;
/// The message about a number outside its limits, formatted with the two limits.
inline constexpr int kNumberLimitsMessage = 157;

/// The edit fields of the profile editor, by their control ids.
enum EProfileField : int
{
    kNameField = 1038,
    kOffsetXField = 1039, ///< the three offset fields are never shown and still read
    kOffsetYField = 1040,
    kOffsetZField = 1041,
    kFrameRateField = 1042,
};

/// The texts that stand in the edit fields, which may differ from what the profile holds while the user
/// types.
class CProfileFields
{
public:
    /// The text of a field; empty for an id that is none.
    const std::string& Text(int id) const;
    /// Nothing for an id that is no field.
    void Set(int id, std::string_view text);
    /// Writes a profile's values into all fields. The offset is cut to integers.
    void Show(std::string_view name, const Vec3& rootOffset, int frameRate);

    /// The numbers in the fields, brought within their limits. A field whose number was outside shows the
    /// nearest limit then, and the owner tells the user.
    Vec3 ReadRootOffset(CProfileOwner& owner);
    int ReadFrameRate(CProfileOwner& owner);
    /// The name, cut to the characters that a name may have and without blanks at its end.
    std::string ReadName() const;

private:
    static constexpr size_t kFieldCount = 5;

    int ReadNumber(int id, int low, int high, CProfileOwner& owner);

    std::array<std::string, kFieldCount> m_kText; // from kNameField on
};

} // namespace gw
