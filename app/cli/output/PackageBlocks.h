#pragma once

#include <cstdint>

namespace gw {

class COrrinStream;
class CRawData;

/// What the small block of a Kinetra file says about the motion file behind it.
struct PackageFacts
{
    uint32_t version = 0;
    uint32_t format = 0; ///< 1 .cha, 2 .chb, 3 .htr, 0 another
    float rate = 0.0f;   ///< frames per second
    float sixty = 0.0f;  ///< always 60
};

/// The two data blocks of a Kinetra file; null for what is not there.
struct PackageBlocks
{
    CRawData* info = nullptr;
    CRawData* file = nullptr;
};

/// Looks for the blocks by name among the roots and along the chain behind them.
PackageBlocks FindPackage(const COrrinStream& scene);
/// False for a block that is no info block.
bool ReadPackageFacts(const CRawData& info, PackageFacts& facts);
/// The extension of the motion file that a format code names, or empty.
const char* FormatExtension(uint32_t format);

} // namespace gw
