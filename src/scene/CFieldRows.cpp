// Turns fields into table rows. Each kind of value has one formatting function in kTextOf. An array is one
// row: everything in it, nested arrays included, is appended to the row's cell.

#include "CFieldRows.h"

#include "HTMLMarkup.h"
#include "HTMLText.h"

#include <algorithm>
#include <cstring>

namespace gw {

namespace {

constexpr size_t kShownValues = 64; // more would not help a reader, and pages of large meshes would not open

template <class T>
std::string IntegerAt(const std::byte* value)
{
    T number;
    std::memcpy(&number, value, sizeof number);
    return std::to_string(number);
}

template <class T>
std::string TextAt(const std::byte* value)
{
    T number;
    std::memcpy(&number, value, sizeof number);
    return HTMLText(number);
}

// Indexed by EFieldKind.
constexpr std::string (*kTextOf[])(const std::byte* value) = {
    TextAt<bool>,        // Bool
    IntegerAt<uint8_t>,  // Byte
    IntegerAt<uint16_t>, // Word
    IntegerAt<uint32_t>, // Unsigned
    IntegerAt<int32_t>,  // Signed
    TextAt<float>,       // Float
    TextAt<Vec3>,        // Vector
    TextAt<Quat>,        // Quaternion
    TextAt<Mat4>,        // Matrix
};

std::string LengthText(size_t count)
{
    return count > kShownValues ? " ... " + std::to_string(count) + " in all" : "";
}

} // namespace

void CFieldRows::Show(const char* name, const std::string& text)
{
    if (m_uiArrays == 0)
        m_kRows.push_back({name, text, {}});
    else if (m_uiRecords <= kShownValues)
        m_kRows.back().cell += ' ' + text;
}

void CFieldRows::Text(const char* name, CText& text)
{
    Show(name, text.IsNull() ? "NULL" : HTMLText(text.View()));
}

bool CFieldRows::Presence(const char* name, bool present)
{
    if (!present)
        Show(name, "NULL");
    return present;
}

void CFieldRows::Values(const char* name, EFieldKind kind, void* values, size_t count)
{
    const auto* value = static_cast<const std::byte*>(values);
    std::string text;
    for (size_t i = 0; i < std::min(count, kShownValues); ++i)
        text.append(i == 0 ? "" : " ")
            .append(kTextOf[static_cast<size_t>(kind)](value + i * FieldBytes(kind)));
    Show(name, text + LengthText(count));
}

void CFieldRows::Slot(const char* name, const CLinkSlot& slot)
{
    const std::string anchor = HTMLObjectAnchor(slot.Get());
    if (m_uiArrays == 0)
        m_kRows.push_back({name, anchor, {}});
    else
        m_kRows.back().cell += HTMLLineBreak() + anchor;
    if (slot.Get())
        m_kRows.back().linked.push_back(slot.Get());
}

size_t CFieldRows::Count(const char*, size_t count, size_t)
{
    m_uiCount = count;
    return count;
}

void CFieldRows::BeginArray(const char* name, EListKind kind)
{
    if (m_uiArrays++ > 0)
        return;
    m_uiRecords = 0;
    m_kRows.push_back({name, kind == EListKind::Records ? std::to_string(m_uiCount) : "", {}});
}

void CFieldRows::EndArray()
{
    --m_uiArrays;
}

void CFieldRows::BeginElement()
{
    if (m_uiArrays == 1 && ++m_uiRecords <= kShownValues)
        m_kRows.back().cell += HTMLLineBreak();
}

} // namespace gw
