// Profiles are read as the oldest reader did: lines of up to 1024 characters, tokens of up to 255, and
// missing tokens keep the value from the previous line. Maps in use depend on these rules, so they are part
// of the format.

#include "ProfileFile.h"

#include "CMapRowTable.h"
#include "CMappedFile.h"
#include "Numbers.h"
#include "SystemConventions.h"
#include "Text.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <span>

namespace gw {

namespace {

// A longer line is read as several lines.
constexpr size_t kLineLimit = 1024;
// Token buffers have 256 characters, including the terminator.
constexpr size_t kTokenLimit = 255;

// Reads the next of up to six integers: it follows a comma, which must not be the first character left.
bool NextInList(std::string_view& rest, int& number)
{
    const size_t comma = rest.find(',');
    if (comma == rest.npos || comma == 0)
        return false;
    rest.remove_prefix(comma + 1);
    number = ParseInt(rest);
    return true;
}

// Parses "rx,ry,rz,ax,ay,az", or ".ax,ay,az". Missing numbers keep their defaults.
RowNumbers ParseNumbers(std::string_view text)
{
    RowNumbers numbers;
    auto& [rotation, axes] = numbers;
    const std::array<int*, 6> all{&rotation[0], &rotation[1], &rotation[2], &axes[0], &axes[1], &axes[2]};
    std::span<int* const> list = all;
    if (text.starts_with('.'))
    {
        list = list.last<3>();
        text.remove_prefix(1);
    }
    if (text.empty())
        return numbers;
    *list.front() = ParseInt(text);
    for (int* number : list.subspan(1))
    {
        if (!NextInList(text, *number))
            break;
    }
    return numbers;
}

float ParseDecimal(std::string_view text)
{
    return static_cast<float>(ParseDouble(text));
}

std::string AxisList(const AxisCodes& axes)
{
    return std::to_string(axes[0]) + ',' + std::to_string(axes[1]) + ',' + std::to_string(axes[2]);
}

std::string RowText(const CMapRowTable& rows, int row)
{
    const std::string axes = AxisList(rows.Numbers(row).axes);
    const std::string& target = rows.Text(row, kTargetColumn);
    if (rows.IsFixed(row))
        return "* " + target + " . ." + axes;
    std::string text = rows.Text(row, kSourceColumn) + " <---> " + target + ' ';
    for (int axis = 0; axis < 3; ++axis)
        text += rows.Text(row, kRotationColumn + axis) + ',';
    return text + axes;
}

} // namespace

std::string ReadProfileName(const std::string& path)
{
    CMappedFile file;
    if (file.Open(path) != EFailure::None)
        return {};
    return CProfileReader(file.Text().substr(0, kProfileByteLimit)).Name();
}

bool ReadProfileText(const std::string& path, std::string& text)
{
    CMappedFile file;
    if (file.Open(path) != EFailure::None || file.Bytes().size() > kProfileByteLimit)
        return false;
    text = file.Text();
    return true;
}

int CutToInteger(float value)
{
    constexpr float kBeyond = 2147483648.0f; // the first float that does not fit into an int
    if (std::isnan(value))
        return 0;
    if (value >= kBeyond)
        return std::numeric_limits<int>::max();
    return value < -kBeyond ? std::numeric_limits<int>::min() : static_cast<int>(value);
}

RowNumbers ProfileLine::Numbers() const
{
    return ParseNumbers(numberText);
}

CProfileReader::CProfileReader(std::string_view text) : m_kRest(SkipByteOrderMark(text))
{
    std::string_view name;
    if (NextPiece(name))
        m_kName = CutTrailing(name);
}

// Reads up to kLineLimit characters of a line. A zero byte ends them, as it ends any text.
bool CProfileReader::NextPiece(std::string_view& piece)
{
    if (m_kRestOfLine.empty())
    {
        if (!NextLine(m_kRest, m_kRestOfLine))
            return false;
        ++m_uiLine;
    }
    piece = m_kRestOfLine.substr(0, kLineLimit);
    m_kRestOfLine.remove_prefix(piece.size());
    piece = piece.substr(0, piece.find('\0'));
    return true;
}

void CProfileReader::TakeTokens(std::string_view piece)
{
    for (std::string_view& token : m_kToken)
    {
        const std::string_view word = NextWord(piece);
        if (word.empty())
            return;
        token = word.substr(0, kTokenLimit);
    }
}

bool CProfileReader::Next(ProfileLine& line)
{
    std::string_view piece;
    if (!NextPiece(piece))
        return false;
    TakeTokens(piece);
    line = {};
    line.line = m_uiLine;
    const auto& [first, second, third, fourth] = m_kToken;
    if (EqualNoCase(first, "Position"))
    {
        line.kind = EProfileLine::Position;
        line.position = {ParseDecimal(second), ParseDecimal(third), ParseDecimal(fourth)};
        return true;
    }
    if (EqualNoCase(first, "FrameRate"))
    {
        line.kind = EProfileLine::FrameRate;
        line.frameRate = ParseInt(second);
        return true;
    }
    const bool fixed = first == "*";
    line.kind = fixed ? EProfileLine::Fixed : EProfileLine::Mapping;
    line.source = fixed ? kFixedSource : first;
    line.target = fixed ? second : third;
    line.numberText = fourth;
    return true;
}

std::string ProfileText(std::string_view name, int frameRate, const Vec3& position, const CMapRowTable& rows)
{
    const auto cut = [](float value) { return std::to_string(CutToInteger(value)); };
    std::string text(name);
    text += kLineEnd;
    text.append("FrameRate ").append(std::to_string(frameRate)).append(kLineEnd);
    text.append("Position ").append(cut(position.x)).append(" ").append(cut(position.y));
    text.append(" ").append(cut(position.z)).append(kLineEnd);
    for (int row = 0; row < rows.RowCount(); ++row)
        text.append(RowText(rows, row)).append(kLineEnd);
    return text;
}

} // namespace gw
