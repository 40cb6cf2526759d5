#pragma once

#include "Vec3.h"

#include <cstddef>
#include <memory>
#include <string>
#include <string_view>
#include <unordered_map>
#include <variant>
#include <vector>

namespace gw {

/// A segment with its base pose and rows. Angles are in degrees; rows are relative to the base pose.
struct TKHTRSegment
{
    std::string parentName;
    std::string name;
    Vec3 baseTranslation = kVec3Zero;
    Vec3 baseRotation = kVec3Zero;
    float boneLength = 0.0f;
    std::vector<TKHTRSegment*> children; ///< owned by the file

    // One entry per data row.
    std::vector<Vec3> translations;
    std::vector<Vec3> rotations;
    std::vector<float> scales;

    size_t line = 0; ///< line of its name in the hierarchy

    bool MakesNode() const { return true; }
};

/// The parsed file, with the header fields.
struct TKHTRFile
{
    std::string fileType;
    std::string dataType;
    std::string eulerOrder;
    std::string calibrationUnits;
    std::string rotationUnits;
    char gravityAxis = '\0';
    char boneLengthAxis = '\0';
    int fileVersion = 1; ///< default if the key is missing
    int numSegments = 0;
    int numFrames = 0;
    int dataFrameRate = 0;
    float scaleFactor = 0.0f;

    TKHTRSegment* root = nullptr; ///< the record "GLOBAL" above the hierarchy, or null before it
    std::vector<std::unique_ptr<TKHTRSegment>> segments; ///< all records
    std::unordered_map<std::string_view, TKHTRSegment*>
        segmentOfName; ///< those under the root; the first of each name

    /// Returns the file's root segment, or null.
    TKHTRSegment* FirstRoot() const { return root && !root->children.empty() ? root->children[0] : nullptr; }
};

/// A text field of the header. The format reserves a fixed number of characters, including the terminator;
/// longer values are truncated.
struct HTRText
{
    std::string TKHTRFile::*text;
    size_t size; ///< including the terminator
};

/// A header key and the field that it sets.
struct HTRKey
{
    using Field = std::variant<HTRText, char TKHTRFile::*, int TKHTRFile::*, float TKHTRFile::*>;

    std::string_view name;
    Field field;
};

/// All keys, in writing order.
inline constexpr HTRKey kHTRKeys[] = {
    {"FileType",            HTRText{&TKHTRFile::fileType, 4}        },
    {"DataType",            HTRText{&TKHTRFile::dataType, 8}        },
    {"FileVersion",         &TKHTRFile::fileVersion                 },
    {"NumSegments",         &TKHTRFile::numSegments                 },
    {"NumFrames",           &TKHTRFile::numFrames                   },
    {"DataFrameRate",       &TKHTRFile::dataFrameRate               },
    {"EulerRotationOrder",  HTRText{&TKHTRFile::eulerOrder, 4}      },
    {"CalibrationUnits",    HTRText{&TKHTRFile::calibrationUnits, 4}},
    {"RotationUnits",       HTRText{&TKHTRFile::rotationUnits, 8}   },
    {"GlobalAxisofGravity", &TKHTRFile::gravityAxis                 },
    {"BoneLengthAxis",      &TKHTRFile::boneLengthAxis              },
    {"ScaleFactor",         &TKHTRFile::scaleFactor                 },
};

} // namespace gw
