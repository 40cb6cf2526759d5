// The state of earlier runs: whatever a file contains, a run can add to it and find what it added.

#include "CResumeState.h"
#include "FuzzTarget.h"
#include "Text.h"

namespace gw {

void FuzzOne(std::span<const std::byte> input)
{
    const std::string file = ScratchFile(".gaitwright.resume.fuzz.jsonl", input);
    const std::string folder = file.substr(0, file.rfind('/'));
    CResumeState first;
    first.Read(folder);
    Require(first.Open(folder, "fuzz"), "every state can be continued");
    Require(first.AddReady("begun", "digits", "1.5") &&
                first.AddMade("made", "a key", "digits", "1.5", "told"),
            "lines are added");
    CResumeState next;
    next.Read(folder);
    Require(next.Knows("begun") && next.Knows("made"), "an output is known again");
    Require(next.FindTold("made", "a key", "digits") != nullptr, "what was made is found");
    // Names from the input: each line is also looked up as a name.
    std::string_view rest = TextOf(input);
    for (std::string_view line; NextLine(rest, line);)
        Require(!first.Knows(std::string(line)) || next.Knows(std::string(line)), "nothing is forgotten");
}

} // namespace gw
