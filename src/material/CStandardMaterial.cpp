#include "CStandardMaterial.h"

#include "CFieldArchive.h"
#include "CHTMLTables.h"

#include <algorithm>
#include <span>

namespace gw {

const CRTTI CStandardMaterial::ms_kRTTI{"CStandardMaterial", &CMaterial::ms_kRTTI};

CStandardMaterial::CStandardMaterial() = default;
CStandardMaterial::CStandardMaterial(const CStandardMaterial& source) = default;
CStandardMaterial::~CStandardMaterial() = default;

CObject* CStandardMaterial::CreateClone() const
{
    return new CStandardMaterial(*this);
}

void CStandardMaterial::Fields(CFieldArchive& archive)
{
    CMaterial::Fields(archive);
    archive.Vector("m_kAmbient", m_kAmbient);
    archive.Vector("m_kDiffuse", m_kDiffuse);
    archive.Vector("m_kSpecular", m_kSpecular);
    archive.Vector("m_kFilter", m_kFilter);
    archive.Float("m_fShininess", m_fShininess);
    archive.Float("m_fShineStrength", m_fShineStrength);
    archive.Float("m_fSelfIllum", m_fSelfIllum);
    archive.Float("m_fOpacity", m_fOpacity);
    archive.Float("m_fOpfall", m_fOpfall);
    archive.Float("m_fWireSize", m_fWireSize);
    archive.Float("m_fIORefract", m_fIORefract);
    archive.Float("m_fDimIntens", m_fDimIntens);
    archive.Float("m_fDimMult", m_fDimMult);
    archive.Float("m_fSoftThresh", m_fSoftThresh);

    // A file can store another count: all ids are read, and excess ones are dropped.
    const size_t count = archive.Count("m_aspkTexture", kTextureChannels, 4);
    auto stored = std::span(m_aspkTexture).first(std::min(count, kTextureChannels));
    archive.LinkRow("m_aspkTexture", stored);
    std::vector<Held<CTexture>> surplus(count - stored.size());
    if (!surplus.empty())
        archive.LinkRow("surplus", surplus);
}

void CStandardMaterial::DumpTable(CHTMLTables& tables)
{
    CMaterial::DumpTable(tables);
    tables.OwnFields<CStandardMaterial, CMaterial>(*this);
}

uint64_t CStandardMaterial::GetMemoryUsed() const
{
    return CMaterial::GetMemoryUsed() + 4 * sizeof(Vec3) + 10 * sizeof(float) + 4 + 4 * kTextureChannels;
}

} // namespace gw
