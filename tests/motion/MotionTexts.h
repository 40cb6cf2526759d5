#pragma once

#include "CMotionFile.h"
#include "TempFolder.h"

#include <span>
#include <string>
#include <string_view>

namespace gw {

class CKeyframeControl;

/// A motion that was loaded from a text through a file of its own.
struct CLoadedMotion
{
    CLoadedMotion(std::string_view text, const std::string& fileName);

    CTempFolder folder;
    std::string path;
    CMotionFile motion;
    bool loaded;
};

/// A tree of nodes as text, children in brackets: "Hips(Spine(Head) Leg)". Empty for null.
std::string TreeText(CNode* root);
/// The failure and the warnings of a record as text, one a line: reason, line and name.
std::string RecordText(const CFailureRecord& record);
/// Brings a motion to a frame; the node must exist.
const CNode& PosedNode(CMotionFile& motion, const char* name, int frame);
/// The track of a node that must exist.
const CKeyframeControl& TrackOf(const CMotionFile& motion, const char* name);
/// Whether all matrices of a tree hold finite numbers.
bool IsFinite(CNode& root);

/// A text with its lines' ends changed to CR LF.
std::string WithCarriageReturns(std::string_view text);

/// A row of a table that replaces one piece of a text. An empty `from` stands for the whole text.
struct Change
{
    const char* what;
    std::string from;
    std::string to;
    std::string record{};       ///< as RecordText gives it; of a text that is refused, its first line
    int keys = -1;              ///< rotations of the tree's last node; below 0 as many as without the change
    const char* tree = nullptr; ///< null for the tree without the change
};

std::string Changed(std::string_view text, const Change& change);
/// Expects that no change affects the motion or the record.
void ExpectSame(std::string_view text, const char* fileName, std::span<const Change> rows);
void ExpectRead(std::string_view text, const char* fileName, std::span<const Change> rows);
void ExpectRefused(std::string_view text, const char* fileName, std::span<const Change> rows);

/// Two joints of three frames: rotation orders of their own, an end site.
inline constexpr std::string_view kSmallBVH = R"(HIERARCHY
ROOT Hips
{
	OFFSET 1 2 3
	CHANNELS 6 Xposition Yposition Zposition Zrotation Xrotation Yrotation
	JOINT Chest
	{
		OFFSET 0 10 0
		CHANNELS 3 Xrotation Yrotation Zrotation
		End Site
		{
			OFFSET 0 0 5
		}
	}
}
MOTION
Frames: 3
Frame Time: 0.04
10 20 30 0 0 0 0 0 0
11 21 31 10 20 30 40 50 60
12 22 32 -90 45 0 0 0 90
)";

/// Two segments of two frames.
inline constexpr std::string_view kSmallHTR = R"([Header]
FileType htr
DataType HTRS
FileVersion 3
NumSegments 2
NumFrames 2
DataFrameRate 25
EulerRotationOrder ZYX
CalibrationUnits mm
RotationUnits Degrees
GlobalAxisofGravity Y
BoneLengthAxis Y
ScaleFactor 1.000000
[SegmentNames&Hierarchy]
#CHILD	PARENT
Torso GLOBAL
Head Torso
[BasePosition]
#SegmentName Tx, Ty, Tz, Rx, Ry, Rz, BoneLength
Torso 0 100 0 0 0 90 50
Head 0 50 0 10 20 30 20
#Beginning of Data. Separated by tabs
[Torso]
#Fr	Tx	Ty	Tz	Rx	Ry	Rz	SF
1 1 2 3 0 0 0 1
2 4 5 6 10 20 30 2
[Head]
#Fr	Tx	Ty	Tz	Rx	Ry	Rz	SF
1 0 0 0 0 0 0 1
2 0 0 0 -5 15 25 1
)";

/// Two segments of three frames. The first is turned by 0, 90 and 180 degrees about Z.
inline constexpr std::string_view kSmallCHA = R"([HEADER]
VersionNumber 100
DataFrameRate 25
BeginFrame 0
EndFrame 2
NumSegments 2

[LENGTH]
Torso 50
Head 20.5
[HIERARCHY]
Torso Global
Head Torso
[MOTION]
Frame 0
Torso 1, 0, 0, 0, 1, 0, 0, 0, 1, 1, 2, 3
Head 1, 0, 0, 0, 1, 0, 0, 0, 1, 0, 50, 0
Frame 1
Torso 0, 1, 0, -1, 0, 0, 0, 0, 1, 4, 5, 6
Head 0, 0, -1, 0, 1, 0, 1, 0, 0, 0, 51, 0
Frame 2
Torso -1, 0, 0, 0, -1, 0, 0, 0, 1, 7, 8, 9
Head 1, 0, 0, 0, 0, 1, 0, -1, 0, 0, 52, 0
)";

} // namespace gw
