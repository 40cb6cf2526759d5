#include "CCustomData.h"

#include "CFieldArchive.h"

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
    uint32_t byteCount = static_cast<uint32_t>(m_pbyData.size());
    archive.Unsigned("m_uiDataSize", byteCount);
    archive.OptionalBlock("m_pbyData", m_pbyData, byteCount);
}

uint64_t CRawData::GetMemoryUsed() const
{
    return CCustomData::GetMemoryUsed() + 8 + m_pbyData.size();
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
