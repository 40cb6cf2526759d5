#pragma once

#include "CObject.h"

namespace gw {

/// What a mesh points at for its looks. No shading is computed here: materials are stored, copied and handed
/// on.
class CMaterialBase : public CObject
{
public:
    static const CRTTI ms_kRTTI;

    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    void Fields(CFieldArchive& archive) override;
    void DumpTable(CHTMLTables& tables) override;
    uint64_t GetMemoryUsed() const override;

    bool m_bTwoSided = false; ///< stored and copied only

protected:
    CMaterialBase() = default;
    CMaterialBase(const CMaterialBase& source) = default;
};

/// The base of the materials that are no textures.
class CMaterial : public CMaterialBase
{
public:
    static const CRTTI ms_kRTTI;

    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }

protected:
    CMaterial() = default;
    CMaterial(const CMaterial& source) = default;
};

} // namespace gw
