#include "PoseArrays.h"

#include "CSafeFile.h"
#include "CSceneFile.h"
#include "Text.h"
#include "Words.h"

#include <bit>
#include <charconv>
#include <span>
#include <vector>

namespace gw {

namespace {

static_assert(std::endian::native == std::endian::little, "the header says that floats are little-endian");

// Files are written in pieces of this size.
constexpr size_t kPieceBytes = size_t{1} << 20;

// Collects text and writes it to a file that replaces another only when it is complete.
class CArrayFile
{
public:
    explicit CArrayFile(const std::string& path) : m_bGood(m_kFile.Open(path)) {}

    void Add(std::string_view text)
    {
        m_kText += text;
        if (m_kText.size() >= kPieceBytes)
            Flush();
    }
    void Add(std::span<const float> numbers)
    {
        Add(std::string_view(reinterpret_cast<const char*>(numbers.data()), numbers.size_bytes()));
    }
    bool Commit()
    {
        Flush();
        return m_bGood && m_kFile.Commit();
    }

private:
    void Flush()
    {
        m_bGood = m_bGood && m_kFile.Write(m_kText);
        m_kText.clear();
    }

    CSafeFile m_kFile;
    std::string m_kText;
    bool m_bGood;
};

// The header of NumPy's format 1.0: magic, version, length of the text, and the text, padded so that the
// numbers start at a multiple of 64.
std::string NpyHeader(const std::string& shape)
{
    constexpr size_t kAlignment = 64;
    constexpr size_t kFixed = 10;
    std::string text = "{'descr': '<f4', 'fortran_order': False, 'shape': (" + shape + "), }";
    text.resize((text.size() + kFixed) / kAlignment * kAlignment + kAlignment - kFixed, ' ');
    text.back() = '\n';
    const char length[] = {static_cast<char>(text.size() % 256), static_cast<char>(text.size() / 256)};
    return std::string("\x93NUMPY\x01\x00", 8) + std::string(length, 2) + text;
}

void AppendNumber(std::string& line, float number)
{
    char digits[32];
    line += ',';
    line.append(digits, std::to_chars(digits, std::end(digits), number).ptr);
}

// Quoted if it contains what separates cells or rows.
std::string Cell(std::string_view text)
{
    if (text.find_first_of(",\"\r\n") == text.npos)
        return std::string(text);
    std::string cell = "\"";
    for (const char c : text)
        cell += c == '"' ? std::string("\"\"") : std::string(1, c);
    return cell + '"';
}

bool Tell(bool isWritten, const std::string& path)
{
    if (!isWritten)
        SayNotWritten(path);
    return isWritten;
}

} // namespace

bool WritePosesAsCsv(const std::string& path, const std::string& shownPath, CSceneFile& file,
                     size_t frameCount)
{
    CArrayFile csv(path);
    std::string line = "frame,bone,x,y,z";
    for (const char row : {'0', '1', '2', '3'})
    {
        for (const char column : {'0', '1', '2', '3'})
            line += std::string(",m") + row + column;
    }
    csv.Add(line + '\n');
    const std::vector<FoundNode> nodes = file.Nodes();
    for (size_t frame = 0; frame < frameCount; ++frame)
    {
        file.Update(file.TimeOf(static_cast<int64_t>(frame)));
        for (const FoundNode& found : nodes)
        {
            const Mat4& world = found.node->m_kWorldMatrix;
            const Vec3 position = world.Translation();
            line = std::to_string(frame) + ',' + Cell(found.node->NameView());
            for (const float number : {position.x, position.y, position.z})
                AppendNumber(line, number);
            for (const float number : world.m)
                AppendNumber(line, number);
            csv.Add(line + '\n');
        }
    }
    return Tell(csv.Commit(), shownPath);
}

bool WritePosesAsNpy(const std::string& path, const std::string& positionsPath, CSceneFile& file,
                     size_t frameCount)
{
    const std::vector<FoundNode> nodes = file.Nodes();
    const std::string shape = std::to_string(frameCount) + ", " + std::to_string(nodes.size());
    CArrayFile matrices(path);
    CArrayFile positions(positionsPath);
    matrices.Add(NpyHeader(shape + ", 4, 4"));
    positions.Add(NpyHeader(shape + ", 3"));
    for (size_t frame = 0; frame < frameCount; ++frame)
    {
        file.Update(file.TimeOf(static_cast<int64_t>(frame)));
        for (const FoundNode& found : nodes)
        {
            const Vec3 position = found.node->m_kWorldMatrix.Translation();
            const float place[] = {position.x, position.y, position.z};
            matrices.Add(found.node->m_kWorldMatrix.m);
            positions.Add(place);
        }
    }
    return Tell(matrices.Commit(), path) && Tell(positions.Commit(), positionsPath);
}

bool WriteBoneNames(const std::string& path, const CSceneFile& file)
{
    CArrayFile names(path);
    for (const FoundNode& found : file.Nodes())
        names.Add(std::string(found.node->NameView()) + '\n');
    return Tell(names.Commit(), path);
}

} // namespace gw
