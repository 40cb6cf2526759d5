#pragma once

#include "CMaterialBase.h"

#include <vector>

namespace gw {

/// A list of materials, for meshes whose triangles name one each.
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

    /// Drops every entry; as many null ones stand then.
    void SetSubMaterialCount(size_t count);

    std::vector<Held<CMaterialBase>> m_kSubMaterials; ///< entries may be null
};

} // namespace gw
