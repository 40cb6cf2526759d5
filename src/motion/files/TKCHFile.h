#pragma once

#include "CFailureRecord.h"
#include "Mat3.h"
#include "Vec3.h"

#include <cstddef>
#include <memory>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace gw {

/// The size of the work array: files with more segments, or more rows per frame, are refused.
inline constexpr int kSegmentLimit = 100;

/// A segment with its frames. Matrices are local and apply to row vectors; lengths are in file units.
struct TKCHSegment
{
    std::string parentName;
    std::string name;
    float length = 0.0f;
    std::vector<TKCHSegment*> children; ///< owned by the file
    std::vector<Vec3> positions;
    std::vector<Mat3> matrices;

    bool MakesNode() const { return true; }
};

/// The parsed CHA or CHB file: the header's numbers and the hierarchy.
struct TKCHFile
{
    int versionNumber = 0;
    int dataFrameRate = 0;
    int beginFrame = 0;
    int endFrame = 0;
    int numSegments = 0;
    int frameCount = 0;
    std::unique_ptr<TKCHSegment> root;                  ///< the record "Global", or null before the hierarchy
    std::vector<std::unique_ptr<TKCHSegment>> segments; ///< the counted segments, in file order
    std::vector<std::pair<std::string_view, float>> lengths; ///< bone lengths by name, views into the text

    /// Sets frameCount to the number of frames from beginFrame to endFrame.
    void CountFrames();
    /// Starts a new hierarchy.
    void MakeRoot();
    /// Adds a record to the hierarchy, with the first length stored for its name. It is not attached yet.
    void AddSegment(std::string_view name, std::string_view parentName);
    /// Attaches every record to its parent; for equal names, the first one. Records without a known parent
    /// are left out with their subtrees, and warned about at a line.
    void LinkSegments(CFailureRecord& record, size_t line);
    /// Returns the file's root segment, or null.
    TKCHSegment* FirstRoot() const { return root && !root->children.empty() ? root->children[0] : nullptr; }
    /// Returns the first record with a name under the root, depth first, or null.
    TKCHSegment* FindSegment(std::string_view name) const;
};

} // namespace gw
