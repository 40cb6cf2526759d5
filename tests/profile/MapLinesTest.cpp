// The older map lines.
#include "MapLines.h"

#include "TempFolder.h"

#include <gtest/gtest.h>
#include <tuple>

namespace gw {
namespace {

std::string Describe(const MapLine& line)
{
    const std::string three = PositionLine(line.numbers).substr(9);
    switch (line.kind)
    {
    case EMapLine::Text:
        return "text";
    case EMapLine::Position:
        return "at " + three;
    case EMapLine::FrameRate:
        return "rate " + std::to_string(line.frameRate);
    case EMapLine::Fixed:
        return "fixed " + line.target;
    case EMapLine::Mapping:
        break;
    }
    return line.source + '>' + line.target + (line.hasRotation ? ' ' + three : "");
}

} // namespace

TEST(MapLines, LinesSayWhatTheirKeySays)
{
    const std::tuple<const char*, const char*, const char*> rows[] = {
        {"free text", "Unknown Source", "text"},
        {"empty", "", "text"},
        {"position, commas", "Position 1,-2,3", "at 1,-2,3"},
        {"position, blanks", "POSITION 1 -2 3.5", "at 1,-2,3"},
        {"position, cut", "Position 5", "at 5,0,0"},
        {"frame rate", "FrameRate 60", "rate 60"},
        {"as first added", "A <---> Head .", "A>Head"},
        {"with rotation", "A <---> Head 1,-2,3", "A>Head 1,-2,3"},
        {"rotation, blanks", "A <---> Head 1 -2 3", "A>Head 1,-2,3"},
        {"a profile's row", "A <---> Head 1,2,3,3,2,1", "A>Head 1,2,3"},
        {"the arrow wins", "Position <---> Head .", "Position>Head"},
        {"cut mapping", "A <--->", "A>"},
        {"fixed row", "* Head . .1,2,3", "fixed Head"},
    };
    for (const auto& [what, text, says] : rows)
    {
        const MapLine line = ParseMapLine(text);
        EXPECT_EQ(line.text, text);
        EXPECT_EQ(Describe(line), says) << what;
    }
}

} // namespace gw
