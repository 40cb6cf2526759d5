#pragma once

#include "CFailure.h"
#include "Mat3.h"
#include "Vec3.h"

#include <cstddef>
#include <memory>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace gw {

/// The size of the work array: files of more segments, or of more rows in a frame, are refused.
inline constexpr int kSegmentLimit = 100;

/// A segment with its frames. Matrices are local and act on row vectors, lengths stay in units of the file.
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

/// The parse context of CHA and CHB files: the header's numbers and the hierarchy.
struct TKCHFile
{
    int versionNumber = 0;
    int dataFrameRate = 0;
    int beginFrame = 0;
    int endFrame = 0;
    int numSegments = 0;
    int frameCount = 0;
    std::unique_ptr<TKCHSegment> root;                  ///< the record "Global", or null before a hierarchy
    std::vector<std::unique_ptr<TKCHSegment>> segments; ///< those that count, in the order of the file
    std::vector<std::pair<std::string_view, float>> lengths; ///< bone lengths by name, views into the text

    /// Sets frameCount to the frames from beginFrame to endFrame.
    void CountFrames();
    /// Begins a hierarchy anew.
    void MakeRoot();
    /// Adds a record to the hierarchy, of the first length of its name. It hangs nowhere yet.
    void AddSegment(std::string_view name, std::string_view parentName);
    /// Hangs every record under its parent, of equal names the first. Records without a known parent are left
    /// out with all below them, and noted as warnings at a line.
    void LinkSegments(CFailureRecord& record, size_t line);
    /// The file's root segment, or null.
    TKCHSegment* FirstRoot() const { return root && !root->children.empty() ? root->children[0] : nullptr; }
    /// The first record of a name under the root, depth first, or null.
    TKCHSegment* FindSegment(std::string_view name) const;
};

} // namespace gw
