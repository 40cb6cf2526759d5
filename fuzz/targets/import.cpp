// What the import program sends. It has just processed a stranger's file, so nothing in it is trusted.

#include "FuzzTarget.h"
#include "ImportedMotion.h"
#include "MotionPromises.h"
#include "TKImportStream.h"

#include <algorithm>
#include <vector>

namespace {

std::vector<std::byte> Written(const gw::ImportedMotion& motion)
{
    std::vector<std::byte> bytes;
    const gw::CByteSink sink = [&](std::span<const std::byte> piece) {
        bytes.insert(bytes.end(), piece.begin(), piece.end());
        return true;
    };
    gw::Require(gw::WriteImported(motion, sink), "a motion can be sent");
    return bytes;
}

} // namespace

void gw::FuzzOne(std::span<const std::byte> input)
{
    ImportedMotion motion, again;
    if (!ReadImported(input, motion))
        return;
    const std::vector<std::byte> written = Written(motion);
    Require(written.size() == input.size(), "what was read was all that was sent");
    Require(ReadImported(written, again) && Written(again) == written, "what is sent arrives");
    TKImportStream stream;
    if (stream.Receive(input))
        RequireSoundMotion(stream);
}
