#include "PackageBlocks.h"

#include "CCustomData.h"
#include "COrrinStream.h"

#include <cstring>
#include <span>

namespace gw {

namespace {

static_assert(sizeof(PackageFacts) == 16); // layout of the file

// This ends: the reader refuses cycles, so a chain has at most as many links as the file has objects.
CRawData* FindInChain(CCustomData* data, const char* name)
{
    for (; data; data = data->GetNextData())
    {
        if (data->NameView() == name && RecordCast<CRawData>(data))
            return static_cast<CRawData*>(data);
    }
    return nullptr;
}

} // namespace

PackageBlocks FindPackage(const COrrinStream& scene)
{
    PackageBlocks blocks;
    for (size_t i = 0; i < scene.GetRootCount() && !blocks.info; ++i)
        blocks.info = FindInChain(RecordCast<CRawData>(scene.GetRoot(i)), "MotionInfo");
    if (blocks.info)
        blocks.file = FindInChain(blocks.info->GetNextData(), "MotionFile");
    return blocks;
}

bool ReadPackageFacts(const CRawData& info, PackageFacts& facts)
{
    const std::span<const std::byte> bytes = info.Data();
    if (bytes.size() != sizeof facts)
        return false;
    std::memcpy(&facts, bytes.data(), sizeof facts);
    return true;
}

const char* FormatExtension(uint32_t format)
{
    constexpr const char* kExtensions[] = {"", ".cha", ".chb", ".htr"};
    return format < std::size(kExtensions) ? kExtensions[format] : "";
}

} // namespace gw
