#pragma once

#include <cstdint>

namespace gw {

class COrrinStream;
class CRawData;

/// The info block of a Kinetra file, which describes the motion file after it.
struct PackageFacts
{
    uint32_t version = 0;
    uint32_t format = 0; ///< 1 .cha, 2 .chb, 3 .htr, 0 other
    float rate = 0.0f;   ///< frames per second
    float sixty = 0.0f;  ///< always 60
};

/// The two data blocks of a Kinetra file; null if missing.
struct PackageBlocks
{
    CRawData* info = nullptr;
    CRawData* file = nullptr;
};

/// Finds the blocks by name among the roots and their chains.
PackageBlocks FindPackage(const COrrinStream& scene);
/// Returns false if the block is not an info block.
bool ReadPackageFacts(const CRawData& info, PackageFacts& facts);
/// Returns the extension for a format code, or empty.
const char* FormatExtension(uint32_t format);

} // namespace gw
