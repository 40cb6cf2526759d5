#pragma once

#include "CMaterialBase.h"

#include <vector>

namespace gw {

/// A list of materials, for meshes with a material per triangle.
class CMultiMaterial : public CMaterial
{
public:
    static const CRTTI ms_kRTTI;

    CMultiMaterial();
    CMultiMaterial(const CMultiMaterial& source);
    ~CMultiMaterial() override;
    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override;
    void Fields(CFieldArchive& archive) override;
    void DumpTable(CHTMLTables& tables) override;
    uint64_t GetMemoryUsed() const override;

    /// Discards all entries and creates that many null ones.
    void SetSubMaterialCount(size_t count);

    std::vector<Held<CMaterialBase>> m_kSubMaterials; ///< entries may be null
};

} // namespace gw
