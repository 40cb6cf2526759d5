// Writes the fields of scene objects as JSON members. Counts, blocks and nested lists arrive as separate
// calls, so a pending count is held back until the next field shows whether it belongs to it.

#include "CFieldDescriber.h"

#include "CJsonWriter.h"

#include <algorithm>
#include <cstring>

namespace gw {

namespace {

// How a value of each kind is converted to JSON.
struct KindRow
{
    size_t floats; // number of floats in it, or 0
    int64_t (*integer)(const void* value);
};

template <class T>
int64_t IntegerAt(const void* value)
{
    T number;
    std::memcpy(&number, value, sizeof number);
    return number;
}

constexpr KindRow kKinds[] = {
    {0,  IntegerAt<uint8_t> }, // Bool
    {0,  IntegerAt<uint8_t> }, // Byte
    {0,  IntegerAt<uint16_t>}, // Word
    {0,  IntegerAt<uint32_t>}, // Unsigned
    {0,  IntegerAt<int32_t> }, // Signed
    {1,  nullptr            }, // Float
    {3,  nullptr            }, // Vector
    {4,  nullptr            }, // Quaternion
    {16, nullptr            }, // Matrix
};

void WriteValue(CJsonWriter& json, EFieldKind kind, const std::byte* value)
{
    const KindRow& row = kKinds[static_cast<size_t>(kind)];
    if (kind == EFieldKind::Bool)
        return json.Bool(row.integer(value) != 0);
    if (row.integer)
        return json.Integer(row.integer(value));
    float floats[16];
    std::memcpy(floats, value, row.floats * sizeof(float));
    if (row.floats == 1)
        return json.Number(floats[0]);
    json.Numbers({floats, row.floats});
}

std::string Hex(const std::byte* bytes, size_t count)
{
    constexpr char kDigits[] = "0123456789abcdef";
    std::string text;
    for (size_t i = 0; i < count; ++i)
    {
        text += kDigits[std::to_integer<unsigned>(bytes[i]) >> 4];
        text += kDigits[std::to_integer<unsigned>(bytes[i]) & 15];
    }
    return text;
}

// The bytes of embedded files and pictures are not useful to read, so only the start of a long block is
// shown.
void WriteBytes(CJsonWriter& json, const std::byte* bytes, size_t count)
{
    constexpr size_t kShownBytes = 64;
    if (count <= kShownBytes)
        return json.Text(Hex(bytes, count));
    json.BeginObject();
    json.Key("bytes").Integer(static_cast<int64_t>(count));
    json.Key("first").Text(Hex(bytes, kShownBytes));
    json.EndObject();
}

} // namespace

CFieldDescriber::PendingCount CFieldDescriber::TakeCount(std::string_view nextName)
{
    const PendingCount pending = std::exchange(m_kCount, {});
    if (pending.name == nextName)
        return pending;
    if (!pending.name.empty() && IsTold(EDescribe::Fields))
    {
        Key(pending.name);
        json_.Integer(static_cast<int64_t>(pending.count));
    }
    return {};
}

void CFieldDescriber::Key(std::string_view name)
{
    if (!m_kNest.empty())
    {
        if (!m_kNest.back())
            json_.Key(name);
        return;
    }
    const int earlier = m_kSeen[std::string(name)]++;
    json_.Key(earlier == 0 ? std::string(name) : std::string(name) + '[' + std::to_string(earlier) + ']');
}

void CFieldDescriber::Text(const char* name, CText& text)
{
    TakeCount(name);
    if (!IsTold(EDescribe::Fields))
        return;
    Key(name);
    if (text.IsNull())
        json_.Null();
    else
        json_.Text(text.View());
}

bool CFieldDescriber::Presence(const char* name, bool present)
{
    TakeCount({});
    if (present)
    {
        m_kCount = {name, 1};
    }
    else if (IsTold(EDescribe::Fields))
    {
        Key(name);
        json_.Null();
    }
    return present;
}

size_t CFieldDescriber::Count(const char* name, size_t count, size_t)
{
    TakeCount({});
    m_kCount = {name, count};
    return count;
}

void CFieldDescriber::Values(const char* name, EFieldKind kind, void* values, size_t count)
{
    const bool isBlock = !TakeCount(name).name.empty() || count != 1;
    if (!IsTold(EDescribe::Fields))
        return;
    Key(name);
    const std::byte* value = static_cast<const std::byte*>(values);
    if (!isBlock)
        return WriteValue(json_, kind, value);
    if (kind == EFieldKind::Byte)
        return WriteBytes(json_, value, count);
    json_.BeginArray();
    for (size_t i = 0; i < count; ++i)
        WriteValue(json_, kind, value + i * FieldBytes(kind));
    json_.EndArray();
}

void CFieldDescriber::Slot(const char* name, const CLinkSlot& slot)
{
    TakeCount(name);
    if (!IsTold(EDescribe::Links))
        return;
    Key(name);
    const auto number = numbers_.find(slot.Get());
    if (number == numbers_.end())
        json_.Null();
    else
        json_.Integer(static_cast<int64_t>(number->second));
}

void CFieldDescriber::BeginArray(const char* name, EListKind kind)
{
    TakeCount(name);
    if (m_kNest.empty())
        m_bArrayIsTold = m_eWhat == (kind == EListKind::Links ? EDescribe::Links : EDescribe::Fields);
    if (m_bArrayIsTold)
    {
        Key(name);
        json_.BeginArray();
    }
    m_kNest.push_back(true);
}

void CFieldDescriber::EndArray()
{
    TakeCount({});
    m_kNest.pop_back();
    if (m_bArrayIsTold)
        json_.EndArray();
}

void CFieldDescriber::BeginElement()
{
    if (m_bArrayIsTold)
        json_.BeginObject();
    m_kNest.push_back(false);
}

void CFieldDescriber::EndElement()
{
    TakeCount({});
    m_kNest.pop_back();
    if (m_bArrayIsTold)
        json_.EndObject();
}

} // namespace gw
