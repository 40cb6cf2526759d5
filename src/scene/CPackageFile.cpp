// The motion is last in a package, so everything before it, the head, is written before the motion is known.
// The head contains the motion's size, which is filled in at the end.

#include "CPackageFile.h"

#include "CCustomData.h"
#include "CNode.h"
#include "COrrinStream.h"
#include "Text.h"

#include <cstring>
#include <string_view>
#include <utility>

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

// The end of the head. If a block has no bytes, this part is missing.
struct MotionSize
{
    uint32_t m_uiByteCount;
    uint32_t m_uiPresent;
};
static_assert(sizeof(MotionSize) == 8);

std::string_view TextOf(std::span<const std::byte> bytes)
{
    return {reinterpret_cast<const char*>(bytes.data()), bytes.size()};
}

Ref<CRawData> MakeBlock(const char* name, std::span<const std::byte> bytes)
{
    Ref<CRawData> block = new CRawData;
    block->SetName(name);
    block->SetCreator(kCreator, 3, 0);
    block->SetData(bytes);
    return block;
}

// Returns a package with an empty motion.
std::string EmptyPackage(const PackageInfo& info)
{
    const InfoBlock block{.m_uiFormat = info.format, .m_fThird = info.third, .m_fFourth = info.fourth};
    const Ref<CNode> node = new CNode(1);
    const Ref<CRawData> facts = MakeBlock("MotionInfo", std::as_bytes(std::span(&block, 1)));
    const Ref<CRawData> motion = MakeBlock("MotionFile", {});
    facts->SetNextData(motion.Get());

    COrrinStream stream;
    stream.AddRoot(node.Get());
    stream.AddRoot(facts.Get());
    std::vector<std::byte> objects;
    stream.SaveBuffer(objects);
    std::string package(TextOf(COrrinStream::FileHeader()));
    return package += TextOf(objects);
}

} // namespace

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

bool CPackageFile::Keep(bool written)
{
    if (!written && m_eFailure == EFailure::None)
        m_eFailure = m_kFile.Failure() == EFailure::None ? EFailure::WriteError : m_kFile.Failure();
    return m_eFailure == EFailure::None;
}

bool CPackageFile::Open(const std::string& path, const PackageInfo& info)
{
    m_eFailure = EFailure::None;
    m_uiBytes = 0;
    m_kHead = EmptyPackage(info);
    m_uiHeadBytes = m_kHead.size();
    return Keep(m_kFile.Open(path));
}

std::string CPackageFile::TakeHead()
{
    return std::exchange(m_kHead, {});
}

bool CPackageFile::Append(std::span<const std::byte> bytes)
{
    m_uiBytes += bytes.size();
    if (m_uiBytes > kContainerBytesLimit && m_eFailure == EFailure::None)
        m_eFailure = EFailure::TooLarge;
    return m_eFailure == EFailure::None && Keep(m_kFile.Write(bytes));
}

bool CPackageFile::Write(std::span<const std::byte> motion)
{
    const std::string head = TakeHead();
    return (head.empty() || Append(std::as_bytes(std::span(head)))) && Append(motion);
}

bool CPackageFile::Commit()
{
    if (!m_kHead.empty() && !Write({}))
        return false;
    const uint64_t motionBytes = m_uiBytes - m_uiHeadBytes;
    const MotionSize size{static_cast<uint32_t>(motionBytes), motionBytes > 0 ? 1u : 0u};
    return m_eFailure == EFailure::None &&
           Keep(m_kFile.Rewrite(m_uiHeadBytes - sizeof size, std::as_bytes(std::span(&size, 1))) &&
                m_kFile.Commit());
}

} // namespace gw
