// Custom data. Raw data shares its bytes between copies, and can refer to a mapped file instead of memory,
// which is how large motions are packaged.

#include "CCustomData.h"

#include "CFieldArchive.h"
#include "CMappedFile.h"

#include <algorithm>

namespace gw {

const CRTTI CCustomData::ms_kRTTI{"CCustomData", &CObject::ms_kRTTI};
const CRTTI CRawData::ms_kRTTI{"CRawData", &CCustomData::ms_kRTTI};
const CRTTI CAuthorInfo::ms_kRTTI{"CAuthorInfo", &CObject::ms_kRTTI};

CCustomData::CCustomData() = default;
CCustomData::CCustomData(const CCustomData& source) = default;
CCustomData::~CCustomData() = default;

void CCustomData::Fields(CFieldArchive& archive)
{
    CObject::Fields(archive);
    archive.Text("m_pcCreator", m_pcCreator);
    archive.Unsigned("m_uiCreatorVersion", m_uiCreatorVersion);
    archive.Unsigned("m_uiUserWord", m_uiUserWord);
    archive.Link("m_spkNextData", m_spkNextData);
}

uint64_t CCustomData::GetMemoryUsed() const
{
    return CObject::GetMemoryUsed() + 16 + m_pcCreator.MemoryUsed();
}

void CCustomData::SetCreator(const char* creator, uint32_t major, uint32_t minor)
{
    m_pcCreator.Set(creator);
    m_uiCreatorVersion = major * 100 + minor;
}

CRawData::CRawData() = default;
CRawData::CRawData(const CRawData& source) = default;
CRawData::~CRawData() = default;

CObject* CRawData::CreateClone() const
{
    return new CRawData(*this);
}

void CRawData::Fields(CFieldArchive& archive)
{
    CCustomData::Fields(archive);
    archive.Unsigned("m_uiDataSize", m_uiDataSize);
    if (archive.IsReading())
    {
        std::vector<std::byte> bytes;
        archive.OptionalBlock("m_pbyData", bytes, m_uiDataSize);
        SetData(std::move(bytes)); // a size without a block becomes 0
        return;
    }
    // Only archives that read modify the bytes.
    std::span<std::byte> bytes(const_cast<std::byte*>(m_pbyData.get()), m_uiDataSize);
    if (archive.Presence("m_pbyData", !bytes.empty()))
        archive.Row("m_pbyData", bytes);
}

void CRawData::SetData(std::vector<std::byte>&& bytes)
{
    const auto block = std::make_shared<std::vector<std::byte>>(std::move(bytes));
    m_uiDataSize = static_cast<uint32_t>(block->size());
    m_pbyData = {block, block->data()};
    m_spkFile = nullptr;
}

void CRawData::SetData(CMappedFile&& file)
{
    m_spkFile = std::make_shared<CMappedFile>(std::move(file));
    m_uiDataSize = static_cast<uint32_t>(m_spkFile->Bytes().size());
    m_pbyData = {m_spkFile, m_spkFile->Bytes().data()};
}

bool CRawData::IsWhole() const
{
    return !m_spkFile || m_spkFile->IsWhole();
}

bool CRawData::WriteData(const CByteSink& sink) const
{
    constexpr size_t kPieceBytes = size_t{8} << 20;
    for (size_t done = 0; done < m_uiDataSize;)
    {
        const size_t count = std::min(m_uiDataSize - done, kPieceBytes);
        if (!sink(Data().subspan(done, count)))
            return false;
        done += count;
        if (m_spkFile)
            m_spkFile->Forget(done);
    }
    return IsWhole();
}

uint64_t CRawData::GetMemoryUsed() const
{
    return CCustomData::GetMemoryUsed() + 8 + m_uiDataSize;
}

CAuthorInfo::CAuthorInfo() = default;
CAuthorInfo::CAuthorInfo(const CAuthorInfo& source) = default;
CAuthorInfo::~CAuthorInfo() = default;

CObject* CAuthorInfo::CreateClone() const
{
    return new CAuthorInfo(*this);
}

void CAuthorInfo::Fields(CFieldArchive& archive)
{
    CCustomData::Fields(archive);
    for (CText& text : m_apcText)
        archive.Text("m_apcText", text);
}

uint64_t CAuthorInfo::GetMemoryUsed() const
{
    uint64_t bytes = CCustomData::GetMemoryUsed() + 20;
    for (const CText& text : m_apcText)
        bytes += text.MemoryUsed();
    return bytes;
}

} // namespace gw
