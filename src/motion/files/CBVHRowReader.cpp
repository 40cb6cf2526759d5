// Motion rows are nearly all of a BVH file, so loading spends its time here. A cursor reads one row into a
// small array of numbers, which immediately become one key per joint: no text is copied, and keys are stored
// directly in their track arrays. The arrays are reserved once, but never for more keys than the file's bytes
// can hold, because the count in the file is only a claim.
//
// Some exporters write short rows, or repeat each joint's offset in its position channels. A joint whose
// values are missing takes them from its own columns of the next row, as readers have always done; repeated
// offsets are detected in the first rows and reported.

#include "CBVHRowReader.h"

#include "Angles.h"
#include "AxisRotation.h"
#include "CTextLines.h"
#include "Numbers.h"
#include "ReadFloat.h"
#include "TKBVHFile.h"
#include "Text.h"

#include <algorithm>

namespace gw {

namespace {

constexpr size_t kBytesPerValue = 2;      // a digit and a separator
constexpr int kProbeRows = 8;             // rows in which repeated offsets are searched
constexpr double kRepeatTolerance = 0.01; // of an offset's length

bool IsSeparator(char c)
{
    return c == ' ' || c == '\t' || c == ',';
}

const char* TokenEnd(const char* text, const char* end)
{
    return std::find_if(text, end, IsSeparator);
}

const char* SkipSeparators(const char* text, const char* end)
{
    while (text != end && IsSeparator(*text))
        ++text;
    return text;
}

void AppendKey(TKBVHJoint& joint, const float* values)
{
    CAxisRotation rotation;
    Vec3 position = joint.offset;
    float* const components[] = {&position.x, &position.y, &position.z};
    for (const int channel : joint.channels)
    {
        const float value = *values++;
        if (channel < kFirstRotation)
            *components[channel] += value;
        else if (channel < kFirstScale)
            rotation.RotateRows(static_cast<size_t>(channel - kFirstRotation), value * kDegreesToRadians);
    }
    joint.rotationKeys.push_back(QuatFromMat3(rotation.Matrix()));
    joint.positionKeys.push_back(position);
}

// Returns whether a joint's position channels repeat its offset. False for a joint without an offset.
bool RepeatsOffset(const TKBVHJoint& joint, const float* values)
{
    Vec3 position = kVec3Zero;
    float* const components[] = {&position.x, &position.y, &position.z};
    for (size_t i = 0; i < joint.channels.size(); ++i)
    {
        if (joint.channels[i] < kFirstRotation)
            *components[joint.channels[i]] = values[i];
    }
    return Vec3Length(position - joint.offset) <= kRepeatTolerance * Vec3Length(joint.offset);
}

bool HasPositions(const TKBVHJoint& joint)
{
    return std::ranges::count_if(joint.channels, [](int channel) { return channel < kFirstRotation; }) >= 3;
}

} // namespace

CBVHRowReader::CBVHRowReader(TKBVHJoint& root, CFailureRecord& record)
    : record_(record), m_uiRootValues(std::max<size_t>(root.channels.size(), 1)), m_iProbes(kProbeRows)
{
    // The root takes a value even without channels.
    if (root.channels.empty())
        m_kRow.resize(1);
    AddColumns(root);
}

void CBVHRowReader::AddColumns(TKBVHJoint& joint)
{
    if (!joint.channels.empty())
        m_kColumns.push_back({&joint, m_kRow.size(), {}});
    m_kRow.resize(m_kRow.size() + joint.channels.size());
    for (const auto& child : joint.children)
        AddColumns(*child);
}

bool CBVHRowReader::RowsFit(size_t frameCount, size_t byteCount) const
{
    return frameCount <= (byteCount + 1) / (kBytesPerValue * m_uiRootValues);
}

void CBVHRowReader::ReserveKeys(size_t frameCount, size_t byteCount)
{
    // If rows will be short, the arrays grow as needed, and so they do for the rows of a second motion: each
    // exact reservation copies them.
    if (frameCount > (byteCount + 1) / (kBytesPerValue * m_kRow.size()))
        return;
    for (const Column& column : m_kColumns)
    {
        if (!column.joint->rotationKeys.empty())
            continue;
        column.joint->rotationKeys.reserve(frameCount);
        column.joint->positionKeys.reserve(frameCount);
    }
}

bool CBVHRowReader::ReadRows(CTextLines& lines, size_t frameCount)
{
    ReserveKeys(frameCount, lines.BytesLeft());
    std::string_view row;
    for (size_t frame = 0; frame < frameCount; ++frame)
    {
        if (!lines.NextRow(row))
            return false;
        m_uiLine = lines.LineNumber();
        if (!ReadRow(row))
            return false;
        lines.ForgetRead();
    }
    FillLastKeys();
    return true;
}

bool CBVHRowReader::ReadRow(std::string_view row)
{
    if (!ReadValues(row))
        return false;
    if (m_uiValues < m_kRow.size() && !CheckLength(m_uiValues == 0))
        return false;
    if (m_iProbes > 0)
        LookForDoubledOffsets();
    AppendKeys();
    return true;
}

bool CBVHRowReader::ReadValues(std::string_view row)
{
    const char* const end = row.data() + row.size();
    const char* text = row.data();
    for (m_uiValues = 0; m_uiValues < m_kRow.size(); ++m_uiValues)
    {
        text = SkipSeparators(text, end);
        if (text == end)
            break;
        ENumber kind;
        const char* next;
        m_kRow[m_uiValues] = ReadFloat(text, end, next, kind);
        if (kind != ENumber::Whole)
        {
            next = TokenEnd(text, end);
            if (!JudgeToken({text, next}, m_uiValues))
                return false;
        }
        text = next;
    }
    return true;
}

// Handles a token that is not a plain number: reads as much as possible, or refuses it. Root values are read
// like atof, which accepts some texts that sscanf rejects.
bool CBVHRowReader::JudgeToken(std::string_view token, size_t index)
{
    ENumber kind;
    float& value = m_kRow[index];
    value = 0.0f;
    if (index < m_uiRootValues)
        value = static_cast<float>(ParseDouble(token, kind));
    else
        ScanFloat(token, value, kind);
    if (kind == ENumber::None || kind == ENumber::Unusual || !std::isfinite(value))
        return record_.Fail(EFailure::BadNumber, m_uiLine, Quote(token));
    if (kind == ENumber::Stuck)
        record_.Warn(EFailure::StuckNumber, m_uiLine, Quote(token));
    return true;
}

bool CBVHRowReader::CheckLength(bool blank)
{
    if (blank)
        return record_.Fail(EFailure::BlankLine, m_uiLine);
    const auto lacks = [this](const Column& c) { return c.first + c.joint->channels.size() > m_uiValues; };
    const auto column = std::ranges::find_if(m_kColumns, lacks);
    const std::string name = column == m_kColumns.end() ? std::string() : column->joint->name;
    if (m_uiValues < m_uiRootValues)
        return record_.Fail(EFailure::MissingTokens, m_uiLine, name);
    record_.Warn(EFailure::ShortRow, m_uiLine, name);
    return true;
}

void CBVHRowReader::AppendKeys()
{
    for (Column& column : m_kColumns)
    {
        if (column.pending.empty() && column.first + column.joint->channels.size() <= m_uiValues)
            AppendKey(*column.joint, &m_kRow[column.first]);
        else
            AppendLate(column);
    }
}

// After a short row, a joint's values are out of step with the rows: a key is added whenever enough values
// have arrived.
void CBVHRowReader::AppendLate(Column& column)
{
    const size_t count = column.joint->channels.size();
    const size_t first = std::min(column.first, m_uiValues);
    const size_t last = std::min(column.first + count, m_uiValues);
    const auto row = m_kRow.begin();
    column.pending.insert(column.pending.end(), row + static_cast<ptrdiff_t>(first),
                          row + static_cast<ptrdiff_t>(last));
    if (column.pending.size() < count)
        return;
    AppendKey(*column.joint, column.pending.data());
    column.pending.erase(column.pending.begin(), column.pending.begin() + static_cast<ptrdiff_t>(count));
}

// Completes a partial last key, with 0 for missing values.
void CBVHRowReader::FillLastKeys()
{
    for (Column& column : m_kColumns)
    {
        if (column.pending.empty())
            continue;
        column.pending.resize(column.joint->channels.size());
        AppendKey(*column.joint, column.pending.data());
        column.pending.clear();
    }
}

void CBVHRowReader::LookForDoubledOffsets()
{
    --m_iProbes;
    size_t candidates = 0;
    std::vector<const TKBVHJoint*> repeating;
    for (const auto& [joint, first, pending] : m_kColumns)
    {
        if (joint->kind == EJointKind::Root || first + joint->channels.size() > m_uiValues)
            continue;
        if (!HasPositions(*joint) || joint->offset == kVec3Zero)
            continue;
        ++candidates;
        if (RepeatsOffset(*joint, &m_kRow[first]))
            repeating.push_back(joint);
    }
    if (repeating.empty() || repeating.size() * 2 < candidates)
        return;
    record_.Warn(EFailure::DoubledOffsets, m_uiLine, repeating[0]->name);
    m_iProbes = 0;
}

} // namespace gw
