#pragma once

// Gaitwright as a library: reads motions, moves them onto the target skeleton with a bone map, measures the
// results and writes them. This is the only public header, and it includes nothing but the standard library.
//
// Conventions. Paths and names are UTF-8. Matrices are for row vectors: a point p of a bone is at p · M in
// world space; they are stored row by row, with the translation in the last row. Lengths are in the unit of
// the motion's file; results are in millimeters with Y up. Angles are in degrees. Frames start at 0. Numbers
// of lines and bytes in messages start at 1, and 0 means unknown.
//
// Failures. Functions that can fail return an Outcome: a value, or a Failure. They are noexcept, and so is
// everything else here except copying what they return, which can run out of memory like any copy.
//
// Threads. All functions can be called by any number of threads at the same time. Motion, BoneMap and
// Conversion are handles to a constant object: copying one is cheap, copies share the object, and threads may
// use copies, or one const handle, at the same time. Calls that pose the same motion take turns. Different
// objects never wait for each other. Assigning to a handle that another thread uses is a race, as for any
// value.
//
// Versions. The library follows semantic versioning: a program that compiles with version 2.x compiles and
// behaves the same with any later 2.y. A minor version can add members to structures, so compile again then.

#include <array>
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <memory>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <utility>
#include <variant>
#include <vector>

// The version of this header, for #if; see also LibraryVersion.
#define GAITWRIGHT_VERSION_MAJOR 2
#define GAITWRIGHT_VERSION_MINOR 0
#define GAITWRIGHT_VERSION_PATCH 0

#pragma GCC visibility push(default) // the library is built with hidden symbols

namespace gaitwright {

struct Access; // how the library itself creates and reads handles

/// Returns the version of the library that the program runs with: "2.0.0".
const char* LibraryVersion() noexcept;

// ---------------------------------------------------------------------------------------------------------
// Failures
// ---------------------------------------------------------------------------------------------------------

/// How serious a message is.
enum class Severity : uint8_t
{
    Error,   ///< the operation failed
    Warning, ///< it succeeded, but the effect is visible in the result
    Note,    ///< good to know
};

/// Returns "error", "warning" or "note".
const char* SeverityName(Severity severity) noexcept;

/// Why an operation failed, or what its user should know although it succeeded.
struct Failure
{
    Severity severity = Severity::Error;
    std::string reason = {}; ///< fixed short code for programs: "blank-line", "not-found"
    std::string path = {};   ///< the file concerned; may be empty
    size_t line = 0;         ///< line of a text file
    size_t byte = 0;         ///< same for a binary file
    std::string name = {};   ///< bone, keyword, class or text concerned, as written in the file; may be empty
    std::string words = {};  ///< sentence for people, with the remedy if there is one; safe to print
};

/// Returns a failure as one line: "walk.bvh:12: an empty line where it is not allowed". Returns an empty text
/// when memory runs out.
std::string Line(const Failure& failure) noexcept;

/// A value, or the reason why there is none.
template <class Value>
class [[nodiscard]] Outcome
{
public:
    Outcome(Value value) : m_kContent(std::in_place_index<0>, std::move(value)) {}
    Outcome(Failure failure) : m_kContent(std::in_place_index<1>, std::move(failure)) {}

    /// Returns whether there is a value.
    bool HasValue() const noexcept { return m_kContent.index() == 0; }
    explicit operator bool() const noexcept { return HasValue(); }

    /// Return the value. Without one, they end the program: check first.
    Value& operator*() & noexcept { return *Checked(std::get_if<0>(&m_kContent)); }
    const Value& operator*() const& noexcept { return *Checked(std::get_if<0>(&m_kContent)); }
    Value&& operator*() && noexcept { return std::move(*Checked(std::get_if<0>(&m_kContent))); }
    Value* operator->() noexcept { return Checked(std::get_if<0>(&m_kContent)); }
    const Value* operator->() const noexcept { return Checked(std::get_if<0>(&m_kContent)); }

    /// Returns the reason. If there is a value, it ends the program: check first.
    const Failure& Error() const noexcept { return *Checked(std::get_if<1>(&m_kContent)); }

private:
    template <class Content>
    static Content* Checked(Content* content) noexcept
    {
        if (!content)
            std::abort();
        return content;
    }

    std::variant<Value, Failure> m_kContent;
};

/// The outcome of an operation without a value.
template <>
class [[nodiscard]] Outcome<void>
{
public:
    Outcome() = default;
    Outcome(Failure failure) : failure_(std::move(failure)) {}

    /// Returns whether the operation succeeded.
    bool HasValue() const noexcept { return !failure_; }
    explicit operator bool() const noexcept { return HasValue(); }

    /// Returns the reason. If the operation succeeded, it ends the program: check first.
    const Failure& Error() const noexcept
    {
        if (!failure_)
            std::abort();
        return *failure_;
    }

private:
    std::optional<Failure> failure_;
};

// ---------------------------------------------------------------------------------------------------------
// Motions
// ---------------------------------------------------------------------------------------------------------

/// What to read of a source, and how.
struct LoadOptions
{
    std::string clip = {}; ///< the clip of a file with several, case ignored; empty for the longest
    float rate = 0.0f;     ///< frames per second in place of the file's; 0 for the file's own
    bool mend = false;     ///< read a damaged BVH file repaired, as far as that is safe
};

/// What to do if a file exists where a result is written.
enum class Existing : uint8_t
{
    Replace, ///< replaces it in one step: at any time, there is the old file or the complete new one
    Keep,    ///< fails with the reason "exists"
};

/// How to write a motion.
struct SaveOptions
{
    Existing existing = Existing::Replace;
    float frameScale = 1.0f; ///< HTR only: factor for the number of frames, over the same time
};

/// A motion: a skeleton, its rest pose, and its poses at every frame. A handle: see Threads above.
class Motion
{
public:
    Motion(const Motion& other) noexcept;
    Motion& operator=(const Motion& other) noexcept;
    ~Motion();

    /// Returns the path that was passed to Load; empty for a motion from memory, and for a result.
    const std::string& Path() const noexcept;
    /// Returns the format as a file extension in lower case without the dot: "bvh". Results are "htr", and so
    /// is what is inside a Kinetra file.
    const std::string& Format() const noexcept;
    /// Returns what the reader warned about, and what it repaired.
    std::span<const Failure> Warnings() const noexcept;
    /// Returns the names of the clips in the file, in its order; empty for formats without clips.
    std::span<const std::string> Clips() const noexcept;
    /// Returns the clip that was read; empty for formats without clips.
    const std::string& Clip() const noexcept;

    size_t FrameCount() const noexcept;
    /// Returns the time between two frames in seconds; 0 if the file does not have a usable one.
    double FrameSeconds() const noexcept;
    /// Returns the length of a unit in meters, as stored in the file; 0 if the format does not store it.
    double UnitMeters() const noexcept;
    size_t BoneCount() const noexcept;
    /// Returns the bones' names, parents before children. All arrays of this class have this order.
    std::span<const std::string> BoneNames() const noexcept;
    /// Returns the index of each bone's parent; -1 for a root.
    std::span<const int32_t> Parents() const noexcept;

    // Arrays belong to the motion and live as long as any handle to it. Those of all frames are computed by
    // the first call, and fail with the reason "out-of-memory" if they do not fit.

    /// Returns the rest pose as world matrices: bones x 4 x 4.
    Outcome<std::span<const float>> RestPose() const noexcept;
    /// Returns all poses as world matrices: frames x bones x 4 x 4.
    Outcome<std::span<const float>> Poses() const noexcept;
    /// Returns the positions of all bones' joints in world space, x, y, z: frames x bones x 3.
    Outcome<std::span<const float>> Positions() const noexcept;

    /// Writes the motion in the format of the path's extension, .bvh or .glb; a motion of the format HTR, and
    /// a result, also as .htr.
    Outcome<void> Save(const std::string& path, const SaveOptions& options = {}) const noexcept;
    /// Returns the bytes of such a file. `format` is its extension, with or without a dot.
    Outcome<std::vector<std::byte>> Bytes(std::string_view format,
                                          const SaveOptions& options = {}) const noexcept;

private:
    friend struct Access;
    struct Content;
    explicit Motion(std::shared_ptr<Content> content) noexcept;

    std::shared_ptr<Content> m_spContent;
};

/// Reads a motion. The extension selects the format: .bvh, .htr, .cha, .chb, a container with keys (.orn),
/// the motion in a Kinetra file (.kinetra), or .fbx, .gltf, .glb, .vrm, .dae, which need the package
/// gaitwright-import.
Outcome<Motion> Load(const std::string& path, const LoadOptions& options = {}) noexcept;

/// Reads a motion from memory. `format` is such an extension, with or without the dot.
Outcome<Motion> LoadBytes(std::span<const std::byte> bytes, std::string_view format,
                          const LoadOptions& options = {}) noexcept;

// ---------------------------------------------------------------------------------------------------------
// Bone maps
// ---------------------------------------------------------------------------------------------------------

/// A row of a bone map: which source bone drives a target bone.
struct MapRow
{
    std::string target = {};
    std::string source = {};       ///< empty for a fixed row, whose bone keeps its rest pose
    std::array<int, 3> rotation{}; ///< offset about X, Y and Z in degrees
    std::array<int, 3> axes{};     ///< codes of the source axes that drive X, Y and Z
};

/// How certain it is that a map names the right bones.
enum class Sureness : uint8_t
{
    Sure,     ///< nothing contradicts it
    Likely,   ///< usable; the doubts tell why it is not sure
    Doubtful, ///< the joints' positions contradict it; a conversion uses it only if it is passed
};

/// Returns "sure", "likely" or "doubtful".
const char* SurenessName(Sureness sureness) noexcept;

/// A bone map, also called profile. A handle: see Threads above.
class BoneMap
{
public:
    BoneMap(const BoneMap& other) noexcept;
    BoneMap& operator=(const BoneMap& other) noexcept;
    ~BoneMap();

    /// Returns the display name: "Poser BVH".
    const std::string& Name() const noexcept;
    /// Returns the file that it was read from; empty without one.
    const std::string& Path() const noexcept;
    /// Returns the rate of its sources in frames per second, by which results are timed.
    int FrameRate() const noexcept;
    std::span<const MapRow> Rows() const noexcept;

    /// Writes it as a .prf file.
    Outcome<void> Save(const std::string& path, Existing existing = Existing::Replace) const noexcept;
    /// Returns the bytes of that file.
    Outcome<std::string> Text() const noexcept;

private:
    friend struct Access;
    struct Content;
    explicit BoneMap(std::shared_ptr<const Content> content) noexcept;

    std::shared_ptr<const Content> m_spContent;
};

/// A bone map as it fits a motion.
struct MapChoice
{
    BoneMap map;
    bool fits = false;                      ///< all rows name bones of the motion, and one drives the root
    size_t rowCount = 0;                    ///< rows of the map
    size_t foundCount = 0;                  ///< rows whose bones exist
    bool adapted = false;                   ///< the common prefix of the motion's names was added to the rows
    Sureness sureness = Sureness::Doubtful; ///< meaningful if it fits
    std::vector<std::string> doubts = {};   ///< what speaks against it, one sentence each
};

// In the functions below, `dataFolder` is the folder with the target skeleton base.htr and the installed bone
// maps; empty for the one that was installed with the library.

/// Reads a bone map: an installed one by its display name, or a file by its path.
Outcome<BoneMap> LoadMap(const std::string& nameOrPath, const std::string& dataFolder = {}) noexcept;
/// Reads a bone map from the text of a .prf file.
Outcome<BoneMap> ParseMap(std::string_view text) noexcept;
/// Returns the installed bone maps and those in the user's own folder.
Outcome<std::vector<BoneMap>> InstalledMaps(const std::string& dataFolder = {}) noexcept;
/// Returns the same, best first, as they fit a motion.
Outcome<std::vector<MapChoice>> RankMaps(const Motion& motion, const std::string& dataFolder = {}) noexcept;
/// Returns the map that Convert uses by default. Fails if none fits, or if the best one is doubtful.
Outcome<MapChoice> ChooseMap(const Motion& motion, const std::string& dataFolder = {}) noexcept;

/// A row of a drafted map, with its evidence.
struct SuggestedRow
{
    MapRow row = {};
    std::string joint = {}; ///< what the source bone is in its body: "left upper arm"; empty for a fixed row
    std::string kind = {};  ///< "turned", "neutral", "fixed"; "no-source" and "no-name" are not in the map
    std::string sureness = {}; ///< "sure", "likely" or "unsure"; empty for rows without a source
    std::string evidence = {}; ///< "name-and-shape", "name", "shape", "shape-against-name" or "none"
    std::vector<std::string> doubts = {}; ///< codes
    /// Angle in degrees between both bones' directions in the source's rest pose; missing if one of them has
    /// no direction.
    std::optional<double> restError = {};
};

/// A map that was drafted for a skeleton.
struct Suggestion
{
    BoneMap map;
    std::vector<SuggestedRow> rows = {}; ///< also those that are not in the map
    bool sure = false;                   ///< every main row is sure; Convert uses only such a draft
    std::string whyNotSure = {};         ///< sentence; empty if sure
    bool sidesAreSure = false;           ///< names or poses show which side is left
    bool restIsStance = false;           ///< the rest pose is a standing pose
};

/// Drafts a bone map for the skeleton of a motion, by the names of its joints and their shape. Fails with the
/// reason "no-body" if no human body is found.
Outcome<Suggestion> Suggest(const Motion& motion, const std::string& dataFolder = {}) noexcept;

// ---------------------------------------------------------------------------------------------------------
// Conversions
// ---------------------------------------------------------------------------------------------------------

/// A range of frames of a result, both ends included. A last frame past the end is the end.
struct FrameRange
{
    int64_t first = 0;
    int64_t last = INT64_MAX;
};

/// How to convert. The defaults give what `gaitwright convert` gives without options.
struct ConvertOptions
{
    std::optional<BoneMap> map = {}; ///< the bone map to use
    std::string mapName = {};        ///< same by name or path, as for LoadMap; used if `map` is missing
    bool draft = false;     ///< if no installed map fits, draft one, and use it if its main rows are sure
    bool align = false;     ///< re-express the source relative to a T-pose first
    bool faithful = false;  ///< keep trunk, hips, knees and feet close to the source; pin planted feet
    bool hands = true;      ///< with `faithful`, keep hands where they touch
    bool legs = true;       ///< plant the feet where the source's feet are planted
    FrameRange frames = {}; ///< keep only these frames
    bool inPlace = false;   ///< cancel the horizontal travel; heights are kept
    bool mirror = false;    ///< exchange left and right
    std::string dataFolder = {}; ///< see above LoadMap
};

/// How far a planted joint slides more than in the source, in mm over the ground.
struct SlideFigures
{
    size_t plants = 0;    ///< unbroken runs of frames in which the source's joint is planted
    double median = 0.0;  ///< median over the plants; negative if the result slides less
    double largest = 0.0; ///< largest added slide
    int largestFrame = 0; ///< its frame
};

/// How well one mapped bone keeps its direction. Angles are in degrees.
struct BoneFigures
{
    std::string target = {};      ///< bone of the result
    std::string source = {};      ///< bone that drives it
    std::string targetChild = {}; ///< joint at the end of the direction; empty for an end joint
    std::string sourceChild = {}; ///< same in the source
    bool measured = false;        ///< both sides have a direction; otherwise the figures below are 0
    double meanError = 0.0;       ///< mean angle between the two directions over all frames
    double largestError = 0.0;    ///< largest of these angles
    int largestFrame = 0;         ///< its frame
};

/// How well the bones of a part of the body keep their directions. Angles are in degrees.
struct PartFigures
{
    std::string part = {};        ///< "upper arm"
    size_t boneCount = 0;         ///< measured bones; if 0, the figures below are 0
    double meanError = 0.0;       ///< over these bones and all frames
    double largestError = 0.0;    ///< largest error of one bone in one frame
    std::string largestBone = {}; ///< that bone
    int largestFrame = 0;         ///< that frame
};

/// What one foot does. Angles are in degrees, lengths in mm.
struct FootFigures
{
    std::string target = {};        ///< ankle of the result
    std::string source = {};        ///< ankle that drives it
    double turnMean = 0.0;          ///< signed mean angle about Y between the headings
    double turnError = 0.0;         ///< mean of its absolute value
    double turnLargest = 0.0;       ///< largest absolute value
    double turnWhileStanding = 0.0; ///< mean absolute value while the source's foot stands
    bool turnFromStart = false;     ///< a side has no toe joint, so turns are relative to frame 0
    double soleTiltMean = 0.0;    ///< angle of the result's sole to the floor, while the source's foot stands
    double soleTiltLargest = 0.0; ///< largest such angle
    double sourceSoleTiltMean = 0.0;      ///< mean of the source's sole
    SlideFigures ankleSlide = {};         ///< added slide of the ankle
    SlideFigures toeSlide = {};           ///< added slide of the toe joint, if both sides have one
    size_t sourceContacts = 0;            ///< contacts with the floor
    size_t resultContacts = 0;            ///< same in the result
    size_t sourceStanding = 0;            ///< frames in contact
    size_t resultStanding = 0;            ///< same in the result
    size_t bothStanding = 0;              ///< frames in which both are
    std::optional<double> contactF1 = {}; ///< 1 if the same frames are in contact; missing if none is
    std::optional<double> heldSole = {};  ///< distance of a standing sole from the floor, 95th percentile
    std::optional<double> heldSoleLargest = {}; ///< largest such distance
    int heldSoleFrame = 0;                      ///< its frame
    size_t kneePops = 0;                 ///< sudden changes of the knee's angle that the source does not have
    double kneePopLargest = 0.0;         ///< largest excess over the source's change
    std::vector<int> kneePopFrames = {}; ///< worst frame of each pop
};

/// What one hand does. Lengths are in mm.
struct HandFigures
{
    std::string target = {}; ///< hand of the result
    std::string source = {}; ///< bone that drives it
    size_t touchFrames =
        0; ///< frames in which the source's hand touches the body, the floor or the other hand
    std::optional<double>
        gap;                  ///< how much farther from what it touches the result's hand is, 95th percentile
    std::string gapPart = {}; ///< "thigh", "torso", "head", "other hand" or "floor"
    double gapLargest = 0.0;  ///< largest gap in one frame
    int gapFrame = 0;         ///< its frame
    double depth = 0.0;       ///< largest depth below the floor
    int depthFrame = 0;       ///< its frame
};

/// A frame that somebody should look at.
struct WorstFrame
{
    int frame = 0;           ///< of the source
    std::string fault = {};  ///< code: "direction", "trunk", "kneePop", "ankleSlide", "handGap", ...
    double amount = 0.0;     ///< degrees or mm
    std::string target = {}; ///< bone of the result
    std::string source = {}; ///< bone that drives it
    std::string part = {};   ///< for a hand: what it touches; otherwise empty
};

/// A figure that summarizes the quality of a conversion.
struct KeyFigure
{
    std::string key = {};             ///< identifier
    std::optional<double> value = {}; ///< missing if the motion does not have what is measured
};

/// How faithful a conversion is: the figures of `gaitwright convert --check`. Frames are those of the source,
/// and the result is sampled at the same times. Angles are in degrees; lengths are in mm, and the source's
/// are scaled by the ratio of the leg lengths.
struct Figures
{
    int frameCount = 0;                     ///< compared frames
    double frameScale = 1.0;                ///< result frames per source frame
    double sourceLeg = 0.0;                 ///< leg length in the source's unit; 0 without a mapped leg
    double resultLeg = 0.0;                 ///< leg length of the result
    double meanError = 0.0;                 ///< mean angle between the directions of mapped bones
    double largestError = 0.0;              ///< largest one
    std::optional<double> trunkMean = {};   ///< mean angle between the lines from hips to neck
    std::optional<double> trunkMost = {};   ///< 95th percentile of that angle
    double trunkLargest = 0.0;              ///< largest one
    int trunkFrame = 0;                     ///< its frame
    std::optional<double> jitterRatio = {}; ///< leg jitter, result / source, median over the bones
    std::optional<double> jitterRatioLargest = {}; ///< largest ratio of a bone
    SlideFigures ankleSlide = {};                  ///< over the plants of both feet
    SlideFigures toeSlide = {};                    ///< same for the toe joints
    std::optional<double> contactF1 = {};          ///< 1 if the feet stand in the same frames
    std::optional<double> heldSole = {};      ///< distance of standing soles from the floor, 95th percentile
    double sinkDepth = 0.0;                   ///< depth of the lowest sole below the floor, 95th percentile
    std::optional<double> handGap = {};       ///< larger of the two hands' gaps
    std::optional<double> handDepth = {};     ///< larger of the two depths
    double sourceTravel = 0.0;                ///< path of the hips over the ground, in leg lengths
    double resultTravel = 0.0;                ///< same for the result
    std::optional<double> travelRatio = {};   ///< result / source; missing if the source hardly moves
    std::vector<BoneFigures> bones = {};      ///< in the order of the map's rows
    std::vector<PartFigures> parts = {};      ///< main parts of the body
    std::vector<FootFigures> feet = {};       ///< left, right; only mapped ones
    std::vector<HandFigures> hands = {};      ///< left, right; only mapped ones
    std::vector<WorstFrame> worstFrames = {}; ///< worst first
    std::vector<KeyFigure> keyFigures = {};   ///< always the same ones in the same order
};

/// A finished conversion. A handle: see Threads above.
class Conversion
{
public:
    Conversion(const Conversion& other) noexcept;
    Conversion& operator=(const Conversion& other) noexcept;
    ~Conversion();

    /// Returns the motion of the target skeleton, with one frame per frame of the source, after `frames`,
    /// `inPlace` and `mirror`. Its saved form differs in rate: see Save.
    const Motion& Result() const noexcept;
    /// Returns the map that was used, and how well it fits.
    const MapChoice& Map() const noexcept;
    /// Returns whether the map was drafted for this motion.
    bool IsDrafted() const noexcept;
    /// Returns the warnings of the conversion, without those of the source's reader.
    std::span<const Failure> Warnings() const noexcept;
    /// Returns what `align` corrected, as text: "4 bones off their axes at rest"; may be empty.
    const std::string& Corrections() const noexcept;

    /// Measures the conversion, before `frames`, `inPlace` and `mirror`. The first call computes the figures,
    /// later ones copy them.
    Outcome<Figures> Check() const noexcept;

    /// Writes the result in the format of the path's extension: .Kinetra or .htr with 120 frames per second
    /// if the map's rate is that of the source, .bvh or .glb with the source's frames.
    Outcome<void> Save(const std::string& path, Existing existing = Existing::Replace) const noexcept;
    /// Returns the bytes of such a file. `format` is its extension, with or without a dot, case ignored.
    Outcome<std::vector<std::byte>> Bytes(std::string_view format) const noexcept;

private:
    friend struct Access;
    struct Content;
    explicit Conversion(std::shared_ptr<Content> content) noexcept;

    std::shared_ptr<Content> m_spContent;
};

/// Converts a motion to the target skeleton. The motion does not change.
Outcome<Conversion> Convert(const Motion& motion, const ConvertOptions& options = {}) noexcept;

// ---------------------------------------------------------------------------------------------------------
// Examination
// ---------------------------------------------------------------------------------------------------------

/// Something that is wrong with a motion file.
struct Finding
{
    Severity severity = Severity::Error;
    std::string reason = {}; ///< fixed short code
    size_t line = 0;         ///< line, or byte of a binary file
    std::string name = {};   ///< joint, keyword or text concerned; may be empty
    std::string words = {};  ///< what is wrong
    std::string remedy = {}; ///< what to do about it; may be empty
    size_t more = 0;         ///< further places with the same fault
    bool fixable = false;    ///< Mend repairs it
};

/// Facts about a valid motion.
struct MotionFacts
{
    size_t jointCount = 0;
    size_t frameCount = 0;
    double frameSeconds = 0.0; ///< time between frames
    double leg = 0.0;          ///< length of thigh and shin in the file's unit; 0 if unknown
    std::string unit = {};     ///< unit of the file, or the one that the leg suggests; empty if unknown
    std::string up = {};       ///< "Y", "-Z", ...; empty if unknown
    std::string restPose = {}; ///< "T-pose", "A-pose", "arms down", "other", "none" or "unknown"
    std::string body = {};     ///< how the body was found: "names", "shape" or "none"
};

/// The examination of a file.
struct Examination
{
    bool healthy = false;                  ///< no errors and no warnings
    std::vector<Finding> findings = {};    ///< by line; those about the whole file first
    std::optional<MotionFacts> facts = {}; ///< missing if no motion could be read
};

/// Examines a motion file as `gaitwright doctor` does. Fails only if the file cannot be examined at all; a
/// file that cannot be read as a motion is an examination with errors.
Outcome<Examination> Doctor(const std::string& path) noexcept;
/// Writes a copy of a BVH file without the faults that can be repaired without changing the motion, and
/// returns the examination of the copy. Fails with the reason "not-fixable" if there are only others.
Outcome<Examination> Mend(const std::string& path, const std::string& output,
                          Existing existing = Existing::Keep) noexcept;

} // namespace gaitwright

#pragma GCC visibility pop
