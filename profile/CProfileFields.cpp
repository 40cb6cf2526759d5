#include "CProfileFields.h"

#include "CProfileOwner.h"
#include "Numbers.h"
#include "ProfileFile.h"
#include "ProfileNames.h"
#include "Text.h"

#include <algorithm>

namespace gw {

const std::string& CProfileFields::Text(int id) const
{
    static const std::string kNoText;
    const auto index = static_cast<size_t>(id - kNameField); // ids below the first one wrap to large numbers
    return index < m_kText.size() ? m_kText[index] : kNoText;
}

void CProfileFields::Set(int id, std::string_view text)
{
    const auto index = static_cast<size_t>(id - kNameField);
    if (index < m_kText.size())
        m_kText[index] = text;
}

void CProfileFields::Show(std::string_view name, const Vec3& rootOffset, int frameRate)
{
    Set(kNameField, name);
    Set(kOffsetXField, std::to_string(CutToInteger(rootOffset.x)));
    Set(kOffsetYField, std::to_string(CutToInteger(rootOffset.y)));
    Set(kOffsetZField, std::to_string(CutToInteger(rootOffset.z)));
    Set(kFrameRateField, std::to_string(frameRate));
}

int CProfileFields::ReadNumber(int id, int low, int high, CProfileOwner& owner)
{
    const int number = ParseInt(Text(id));
    const int clamped = std::clamp(number, low, high);
    if (clamped != number)
    {
        Set(id, std::to_string(clamped));
        const int limits[] = {low, high};
        owner.ShowMessage(kNumberLimitsMessage, EButtons::OK, limits);
    }
    return clamped;
}

Vec3 CProfileFields::ReadRootOffset(CProfileOwner& owner)
{
    const auto read = [&](int id) {
        return static_cast<float>(ReadNumber(id, -kOffsetLimit, kOffsetLimit, owner));
    };
    return {read(kOffsetXField), read(kOffsetYField), read(kOffsetZField)};
}

int CProfileFields::ReadFrameRate(CProfileOwner& owner)
{
    return ReadNumber(kFrameRateField, kLowestFrameRate, kHighestFrameRate, owner);
}

std::string CProfileFields::ReadName() const
{
    return std::string(CutTrailing(FirstCharacters(Text(kNameField), kProfileNameLimit)));
}

} // namespace gw
