// Reads every row of a BMP file in both forms, and writes a copy that must have the same pixels.

#include "FuzzTarget.h"
#include "PicturePromises.h"

void gw::FuzzOne(std::span<const std::byte> input)
{
    const auto picture = OpenPicture(ScratchFile("in.bmp", input), "r");
    if (picture && ReadsWhole(*picture))
        RequireSameCopy(*picture, ScratchPath("out.bmp"));
}
