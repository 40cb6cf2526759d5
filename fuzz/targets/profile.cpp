// A bone map: its rows measured against a skeleton, and written and read again.

#include "CMapRowTable.h"
#include "CNode.h"
#include "FuzzTarget.h"
#include "ProfileFile.h"
#include "ProfileFit.h"

namespace gw {

namespace {

// What a profile says, as the editor takes it. `isWhole` where each row has both its names, so that it can be
// told apart again.
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
        rows.AddRow(line.source, line.target, line.numbers, ERowColumns::All);
        isWhole = isWhole && !line.source.empty() && !line.target.empty();
    }

    std::string Text() const { return ProfileText(name, frameRate, position, rows); }

    std::string name;
    Vec3 position = kVec3Zero;
    int frameRate = 0;
    CMapRowTable rows;
    bool isWhole = true;
};

// An axis that is none stands for the neutral one, so that texts may differ where numbers do not; and a row
// without a source has no use for a rotation.
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
