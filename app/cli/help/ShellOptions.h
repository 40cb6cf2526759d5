#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

namespace gw {

/// What the program answers to the shell.
enum class EExit : int
{
    Done = 0,
    Failed = 1,        ///< some work failed
    Usage = 2,         ///< the command line was wrong, and nothing was done
    Interrupted = 130, ///< an end was requested before all was done
};

/// Of a picture, as the command line says it; not yet looked at by whoever draws.
struct PixelSize
{
    int width = 640;
    int height = 480;
};

/// What a command line asks for. One record serves all commands; each reads what its row in the table of
/// commands lets through.
struct ShellOptions
{
    std::vector<std::string> files; ///< operands, in the order of the command line

    std::string output;          ///< -o
    std::string outputFolder;    ///< --out-dir
    std::string profile;         ///< a display name, or the path of a .prf file
    std::string dataFolder;      ///< replaces the folder beside the executable; empty for that
    std::string job;             ///< htr or orn
    std::string html;            ///< --html, the page to write; empty for none
    std::string fix;             ///< --fix, the mended copy to write; empty for none
    std::string filesFrom;       ///< --files-from, a list of sources; "-" for standard input, empty for none
    std::string report;          ///< --report, the file that takes a line a source; empty for none
    std::optional<int64_t> jobs; ///< worker processes; none for as many as there are cores
    std::optional<int64_t> shards; ///< parts of a plan
    std::optional<int64_t> shard;  ///< the part to run, from 0 on
    float timeLimit = 600.0f;      ///< seconds that one source may take
    int64_t frame = 0;
    std::optional<float> time; ///< --time, in place of a frame; in the unit of the file's controls
    std::string with;          ///< the motion to draw beside the first one; empty for none
    int64_t strip = 1;         ///< number of poses
    PixelSize size;
    float rate = 0.0f;       ///< frames per second
    float frameScale = 1.0f; ///< factor for the number of frames

    bool json = false;
    bool quiet = false;
    bool force = false;         ///< replace outputs that exist
    bool skipExisting = false;  ///< pass over sources whose output exists
    bool dryRun = false;        ///< say what would be done
    bool noLegs = false;        ///< leave the feet to the plain rotation transfer
    bool keepGoing = false;     ///< go on behind a source that failed
    bool resume = false;        ///< pass over sources whose output is what an earlier run made of them
    bool nullSeparated = false; ///< the list of sources has zero bytes between its names
    bool align = false;         ///< tell the source from a rest pose that suits the rules first
    bool faithful = false;      ///< let hips, knees and feet keep to the source
    bool check = false;         ///< measure each result
    bool objects = false;       ///< tell all spatial objects, not nodes alone
};

} // namespace gw
