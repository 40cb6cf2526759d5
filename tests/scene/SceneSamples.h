#pragma once

#include "CControl.h"
#include "CCustomData.h"
#include "CKeyframeClipControl.h"
#include "CNode.h"
#include "CRenderState.h"

#include <vector>

namespace gw {

/// A control with a configurable result that counts its updates.
class CTestControl : public CControl
{
public:
    explicit CTestControl(bool answer = true) : m_bAnswer(answer) {}
    CObject* CreateClone() const override { return new CTestControl(*this); }
    bool Update(float time) override
    {
        m_kUpdates.push_back(time);
        return m_bAnswer;
    }
    bool UpdateTransform(float) override
    {
        ++m_iTransforms;
        return m_bAnswer;
    }

    bool m_bAnswer;
    int m_iTransforms = 0;
    std::vector<float> m_kUpdates;
};

class CTestModifier : public CModifier
{
public:
    CObject* CreateClone() const override { return new CTestModifier(*this); }
    bool Update(float) override
    {
        ++m_iUpdates;
        return true;
    }
    bool UpdateTransform(float) override { return true; }

    int m_iUpdates = 0;
};

class CTestState : public CRenderState
{
public:
    explicit CTestState(size_t type) : m_uiType(type) {}
    CObject* CreateClone() const override { return new CTestState(*this); }
    size_t GetType() const override { return m_uiType; }

private:
    size_t m_uiType;
};

/// Returns a graph with one object of each class of the room: two tracks that share nothing, a custom data
/// object shared by two nodes, an empty slot, and a target that is not the holder.
Ref<CNode> SampleGraph();

/// Returns a node with a track whose keys have the given times and positions (time, 0, 0).
Ref<CNode> TrackedNode(const std::vector<float>& times);

} // namespace gw
