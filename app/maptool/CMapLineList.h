#pragma once

#include "MapLines.h"

#include <cstddef>
#include <functional>
#include <string_view>
#include <vector>

namespace gw {

/// The map tool's list of lines, at most one of them selected, and the two values that lines set.
class CMapLineList
{
public:
    static constexpr int kNone = -1;
    /// Returns whether both bones of a mapping exist.
    using Fits = std::function<bool(const MapLine&)>;

    const std::vector<MapLine>& Lines() const { return m_kLines; }
    bool IsEmpty() const { return m_kLines.empty(); }
    /// Returns the index of the selected line, or kNone.
    int Selected() const { return m_iSelected; }
    /// Returns the selected line, or null.
    const MapLine* SelectedLine() const;
    /// Selects a line; any invalid index selects none.
    void Select(int index);

    /// Appends a mapping without rotation. If no line sets a position yet, first appends the three header
    /// lines of a map.
    void Add(std::string_view source, std::string_view target);
    /// Replaces all lines and the values that they set by those of a file. Mappings that do not fit are left
    /// out; returns their number.
    size_t Replace(const std::vector<MapLine>& lines, const Fits& fits);
    /// Removes every line except mappings that fit, including the header. Returns the number of lines
    /// removed.
    size_t Prune(const Fits& fits);
    void RemoveSelected();
    void Clear();
    /// Replaces the selected line and selects the new one.
    void ReplaceSelected(const MapLine& line);

    /// Returns the start position of a conversion's root, in the target's unit, from the last line read that
    /// sets it.
    const Vec3& RootPosition() const { return m_kRootPosition; }
    int FrameRate() const { return m_iFrameRate; }
    /// Applies the value of a line that begins with its keyword.
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

/// Returns the line as the tool writes it, from its kind, bones and values. Text is cut to the length of the
/// tool's field.
MapLine RewrittenLine(const MapLine& line);

} // namespace gw
