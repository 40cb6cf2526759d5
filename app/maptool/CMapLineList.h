#pragma once

#include "MapLines.h"

#include <cstddef>
#include <functional>
#include <string_view>
#include <vector>

namespace gw {

/// The map tool's list of lines, of which one may be selected, and the two values that lines set.
class CMapLineList
{
public:
    static constexpr int kNone = -1;
    /// Whether both bones of a mapping are there.
    using Fits = std::function<bool(const MapLine&)>;

    const std::vector<MapLine>& Lines() const { return m_kLines; }
    bool IsEmpty() const { return m_kLines.empty(); }
    /// The index of the selected line, or kNone.
    int Selected() const { return m_iSelected; }
    /// Null when there is none.
    const MapLine* SelectedLine() const;
    /// Selects a line, or with any other index none.
    void Select(int index);

    /// Appends a mapping without a rotation, and before it the three lines of a map's head where no line
    /// speaks of a position yet.
    void Add(std::string_view source, std::string_view target);
    /// Takes the lines of a file for those that stand here, and the values that they set. Mappings that do
    /// not fit are left out; answers how many.
    size_t Replace(const std::vector<MapLine>& lines, const Fits& fits);
    /// Takes out every line that is no mapping that fits, the head too; answers how many.
    size_t Prune(const Fits& fits);
    void RemoveSelected();
    void Clear();
    /// Puts another line into the place of the selected one and selects it.
    void ReplaceSelected(const MapLine& line);

    /// Where a conversion's root begins, in the target's unit: as the last line that said so was read.
    const Vec3& RootPosition() const { return m_kRootPosition; }
    int FrameRate() const { return m_iFrameRate; }
    /// Takes the value of a line that begins with its keyword.
    void TakeValue(const MapLine& line);

private:
    void Append(const MapLine& line);
    void EnsureHead();

    std::vector<MapLine> m_kLines;
    int m_iSelected = kNone;
    Vec3 m_kRootPosition = kVec3Zero;
    int m_iFrameRate = kDefaultFrameRate;

    static constexpr int kDefaultFrameRate = 60;
};

/// The line as the tool writes it anew from its kind, its bones and its values. A text is cut to the
/// characters that the tool's field takes.
MapLine RewrittenLine(const MapLine& line);

} // namespace gw
