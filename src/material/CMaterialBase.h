#pragma once

#include "CObject.h"

namespace gw {

/// The appearance of a mesh. Nothing is shaded here: materials are only stored and copied.
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

/// Base of the materials that are not textures.
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
