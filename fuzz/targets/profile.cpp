// A bone map: its rows are matched with a skeleton, and written and read again.

#include "CMapRowTable.h"
#include "CNode.h"
#include "FuzzTarget.h"
#include "ProfileFile.h"
#include "ProfileFit.h"

namespace gw {

namespace {

// The contents of a profile as the editor reads it. `isWhole` is true if each row has both names, so that it
// can be parsed again.
struct ReadRows
{
    explicit ReadRows(std::string_view text)
    {
        CProfileReader reader(text);
        name = reader.Name();
        for (ProfileLine line; reader.Next(line);)
        {
            if (line.kind == EProfileLine::Position)
                position = line.position;
            else if (line.kind == EProfileLine::FrameRate)
                frameRate = line.frameRate;
            else
                Add(line);
        }
    }

    void Add(const ProfileLine& line)
    {
        rows.AddRow(line.source, line.target, line.Numbers(), ERowColumns::All);
        isWhole = isWhole && !line.source.empty() && !line.target.empty();
    }

    std::string Text() const { return ProfileText(name, frameRate, position, rows); }

    std::string name;
    Vec3 position = kVec3Zero;
    int frameRate = 0;
    CMapRowTable rows;
    bool isWhole = true;
};

// An invalid axis equals the neutral one, so texts may differ while numbers do not. A row without a source
// ignores its rotation.
bool IsSameRow(const CMapRowTable& a, const CMapRowTable& b, int row)
{
    const RowNumbers one = a.Numbers(row);
    const RowNumbers two = b.Numbers(row);
    return a.Text(row, kSourceColumn) == b.Text(row, kSourceColumn) &&
           a.Text(row, kTargetColumn) == b.Text(row, kTargetColumn) && one.axes == two.axes &&
           (a.IsFixed(row) || one.rotation == two.rotation);
}

bool HaveSameRows(const CMapRowTable& a, const CMapRowTable& b)
{
    bool same = a.RowCount() == b.RowCount();
    for (int row = 0; same && row < a.RowCount(); ++row)
        same = IsSameRow(a, b, row);
    return same;
}

} // namespace

void FuzzOne(std::span<const std::byte> input)
{
    std::string text;
    const std::string path = ScratchFile("in.prf", input);
    Require(ReadProfileText(path, text) == (input.size() <= kProfileByteLimit),
            "a profile has a longest size");
    const ReadRows first(text);
    const std::string written = first.Text();
    const ReadRows second(written);
    Require(!first.isWhole || HaveSameRows(first.rows, second.rows), "rows survive a save");

    const Ref<CNode> bone = new CNode(1);
    bone->SetName("LowerTorso");
    CProfileFit fit;
    Require(MeasureFit(path, bone.Get(), bone.Get(), fit) == (input.size() <= kProfileByteLimit),
            "what can be read can be measured");
    Require(fit.foundCount <= fit.rowCount, "no more rows are found than there are");
}

} // namespace gw
