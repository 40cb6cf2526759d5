#include "Commands.h"

namespace gw {

namespace {

constexpr size_t kAny = SIZE_MAX;

constexpr CCommand kCommands[] = {
    {"convert",   "SOURCE...",     1, kAny,
     kOutput | kOutputFolder | kProfile | kNoLegs | kForce | kSkipExisting | kDryRun | kKeepGoing, 0,
     "Convert a motion to the target skeleton and save it as a Kinetra file.\n"
     "Without --profile the stock profile that fits is taken, else the installed one that fits best.\n"
     "OUT may end in .htr for the motion file alone. Several sources, or a folder, need --out-dir.",                                                                        "gaitwright convert walk.bvh -o walk.Kinetra --profile \"Poser BVH\"", RunConvert    },
    {"batch",     "FOLDER",        1, 1,    kJob | kProfile,                                       kJob,
     "Convert every .bvh of a folder to an .htr beside it, or package every .htr as an .orn.\n"
     "Files that exist are replaced; the first failure ends the run.",                                                                                                      "gaitwright batch takes --job htr --profile \"Poser BVH\"",            RunBatchFolder},
    {"info",      "FILE",          1, 1,    0,                                                     0,
     "Show what a motion or a container holds: format, frames, rate, bones, objects.",                                                                                      "gaitwright info walk.bvh",                                            RunInfo       },
    {"pose",      "FILE",          1, 1,    kFrame,                                                kFrame,
     "Print the local and world matrix of every node at a frame, as JSON.\n"
     "Row vectors, row by row. A frame behind the end gives the pose of the end.",                                                                                          "gaitwright pose walk.bvh --frame 30",                                 RunPose       },
    {"transcode", "IN OUT",        2, 2,    kFrameScale | kForce,                                  0,
     "Write a motion in another form: an .htr as an .htr with more or fewer frames, any motion as a .bvh.",                                                                 "gaitwright transcode walk.htr slow.htr --frame-scale 2",              RunTranscode  },
    {"resave",    "IN OUT",        2, 2,    kForce,                                                0,        "Read a container and write it again, in the newest version.",
     "gaitwright resave old.orn new.orn",                                                                                                                                                                                                          RunResave     },
    {"extract",   "FILE",          1, 1,    kOutput | kForce,                                      kOutput,  "Take the motion file out of a Kinetra file.",
     "gaitwright extract walk.Kinetra -o walk.htr",                                                                                                                                                                                                RunExtract    },
    {"package",   "IN OUT",        2, 2,    kRate | kForce,                                        kRate,    "Wrap a motion file into a Kinetra file.",
     "gaitwright package walk.htr walk.Kinetra --rate 30",                                                                                                                                                                                         RunPackage    },
    {"profiles",  "[SOURCE]",      0, 1,    0,                                                     0,
     "List the installed profiles; with a source, which of them fit, and what the others miss.",                                                                            "gaitwright profiles walk.bvh",                                        RunProfiles   },
    {"compare",   "SOURCE RESULT", 2, 2,    kProfile,                                              kProfile,
     "Measure a conversion: how far the result's bones, feet and path differ from the source's.",                                                                           "gaitwright compare walk.bvh walk.htr --profile \"Poser BVH\"",        RunCompare    },
};

} // namespace

std::span<const CCommand> Commands()
{
    return kCommands;
}

} // namespace gw
