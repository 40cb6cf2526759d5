// The older map syntax: the text of a line must not change, except for a carriage return at its end.

#include "MapLines.h"
#include "CMapLineList.h"
#include "FuzzTarget.h"
#include "ProfileFile.h"

#include <algorithm>

namespace gw {

namespace {

std::string_view WithoutReturns(std::string_view text)
{
    return text.substr(0, text.find_last_not_of('\r') + 1);
}

bool SayTheSame(const MapLine& a, const MapLine& b)
{
    return a.kind == b.kind && a.source == b.source && a.target == b.target &&
           WithoutReturns(a.text) == WithoutReturns(b.text);
}

} // namespace

void FuzzOne(std::span<const std::byte> input)
{
    std::vector<MapLine> lines, again;
    if (!ReadMapLines(ScratchFile("in.map", input), lines))
        return Require(input.size() > kProfileByteLimit, "every text is a map");
    const std::string out = ScratchPath("out.map");
    Require(WriteMapLines(out, lines), "what was read can be written");
    if (!ReadMapLines(out, again)) // line ends may have pushed it over the limit
        return;
    Require(std::ranges::equal(lines, again, SayTheSame), "lines survive a save");

    CMapLineList list;
    list.Replace(lines, [](const MapLine&) { return true; });
    for (const MapLine& line : list.Lines())
        RewrittenLine(line);
}

} // namespace gw
