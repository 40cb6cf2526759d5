#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

/// Exit codes.
enum class EExit : int
{
    Done = 0,
    Failed = 1,        ///< some work failed
    Usage = 2,         ///< wrong command line; nothing was done
    Interrupted = 130, ///< interrupted before everything was done
};

/// A picture size from the command line, not yet checked.
struct PixelSize
{
    int width = 640;
    int height = 480;
};

/// The parsed command line. All commands share this record; each reads the options that its row in the
/// command table allows.
struct ShellOptions
{
    std::vector<std::string> files; ///< operands, in order

    std::string output;       ///< -o
    std::string outputFolder; ///< --out-dir
    std::string profile;      ///< display name, or path of a .prf file
    std::string drafts;       ///< --drafts, the folder that keeps drafted profiles; empty to keep none
    std::string dataFolder;   ///< replaces the folder next to the executable; empty for that folder
    std::string job;          ///< htr or orn
    std::string format;       ///< --format, of a result; empty if the name of the output decides
    std::string frames;       ///< --frames, "A-B"; empty for all
    std::string clip;         ///< --clip, in a file with several; empty for the longest
    std::string html;         ///< --html, the page to write; empty for no page
    std::string fix;          ///< --fix, the repaired copy to write; empty for no copy
    /// --files-from, a list of sources; "-" for standard input, empty for no list
    std::string filesFrom;
    std::string report;            ///< --report, the file that gets one line per source; empty for no report
    std::optional<int64_t> jobs;   ///< worker processes; default: one per core
    std::optional<int64_t> shards; ///< parts of a plan
    std::optional<int64_t> shard;  ///< the part to run, starting at 0
    float timeLimit = 600.0f;      ///< seconds per source
    int64_t frame = 0;
    std::optional<float> time; ///< --time, instead of a frame; in the unit of the file's controls
    std::string with;          ///< the motion to draw next to the first one; empty for none
    int64_t strip = 1;         ///< number of poses
    PixelSize size;
    std::string view = "front";       ///< direction of a picture: front, side, three-quarter or top
    std::string background = "light"; ///< of a picture: light or dark
    std::string animate;              ///< --animate, the animated picture to write; empty for none
    float rate = 0.0f;                ///< frames per second; 0 for those of the source
    float frameScale = 1.0f;          ///< factor for the number of frames

    bool json = false;
    bool quiet = false;
    bool verbose = false;       ///< one line per source of a run
    bool force = false;         ///< replace existing outputs
    bool skipExisting = false;  ///< skip sources whose output exists
    bool dryRun = false;        ///< only print what would be done
    bool noLegs = false;        ///< transfer rotations only, without planting feet
    bool keepGoing = false;     ///< continue after a source that failed
    bool resume = false;        ///< skip sources whose output is already up to date
    bool nullSeparated = false; ///< the names in the list of sources are separated by zero bytes
    bool align = false;         ///< first re-express the source relative to a T-pose
    bool faithful = false;      ///< keep trunk, hips, knees, feet and hands close to the source
    bool noHands = false;       ///< but not the hands
    bool draft = false;         ///< draft a profile if none fits; set by --drafts too
    bool mend = false;          ///< read sources repaired, if that is safe
    bool check = false;         ///< measure each result
    bool upright = false;       ///< turn a motion whose up axis is not Y in a picture
    bool axes = false;          ///< draw the axes of every bone
    bool objects = false;       ///< print all spatial objects, not only nodes
    bool all = false;           ///< write all frames
    bool inPlace = false;       ///< cancel the horizontal travel of a result
    bool mirror = false;        ///< exchange left and right in a result
    bool listClips = false;     ///< print only the names of clips
};

/// Reads a range of frames, "A-B" or "A". Returns false if the text is not one.
bool ReadFrames(std::string_view text, int64_t& first, int64_t& last);

} // namespace gw
