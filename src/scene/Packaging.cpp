#include "Packaging.h"

#include "CCustomData.h"
#include "CMappedFile.h"
#include "CNode.h"
#include "COrrinStream.h"
#include "Paths.h"
#include "Text.h"

#include <cstring>

namespace gw {

namespace {

constexpr const char* kCreator = "It's me 3";

struct InfoBlock
{
    uint32_t m_uiVersion = 1;
    uint32_t m_uiFormat;
    float m_fThird;
    float m_fFourth;
};
static_assert(sizeof(InfoBlock) == 16);

uint32_t FormatCode(const std::string& path)
{
    constexpr struct
    {
        std::string_view ending;
        uint32_t code;
    } kFormats[] = {
        {".htr", 3},
        {".cha", 1},
        {".chb", 2}
    };
    const std::string lower = LowerCase(path);
    for (const auto& format : kFormats)
    {
        if (lower.ends_with(format.ending))
            return format.code;
    }
    return 0;
}

} // namespace

Ref<CRawData> LoadFileAsRawData(const std::string& path)
{
    CMappedFile file;
    if (file.Open(path) != EFailure::None)
        return nullptr;
    Ref<CRawData> data = new CRawData;
    data->SetData(file.Bytes());
    return data;
}

bool PackageMotion(const std::string& sourcePath, const std::string& targetPath, float third, float fourth,
                   CFailureRecord& record)
{
    uint64_t byteCount = 0;
    if (FileSize(sourcePath, byteCount) && byteCount > kContainerBytesLimit)
        return record.Fail(EFailure::TooLarge, 0, sourcePath);
    const Ref<CRawData> motion = LoadFileAsRawData(sourcePath);
    if (!motion)
        return record.Fail(EFailure::NotFound, 0, sourcePath);
    motion->SetName("MotionFile");
    motion->SetCreator(kCreator, 3, 0);

    const Ref<CNode> node = new CNode(1);
    const Ref<CRawData> info = new CRawData;
    info->SetCreator(kCreator, 3, 0);
    info->SetName("MotionInfo");
    const InfoBlock block{.m_uiFormat = FormatCode(sourcePath), .m_fThird = third, .m_fFourth = fourth};
    info->SetData(std::as_bytes(std::span(&block, 1)));
    info->SetNextData(motion.Get());

    COrrinStream stream;
    stream.AddRoot(node.Get());
    stream.AddRoot(info.Get());
    if (!stream.SaveFile(targetPath))
        record.Fail(stream.Record().Failure().reason, 0, targetPath);
    return true;
}

} // namespace gw
