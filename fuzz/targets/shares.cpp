// Reads the share file for a skeleton that has some of the bones.

#include "CRetargeter.h"
#include "FuzzTarget.h"

void gw::FuzzOne(std::span<const std::byte> input)
{
    const Ref<CNode> root = new CNode(1);
    root->SetName("LowerTorso");
    const Ref<CNode> thigh = new CNode(1);
    thigh->SetName("LThigh");
    root->AttachChild(thigh.Get());
    CRetargeter retargeter;
    retargeter.SetScenes(root.Get(), root.Get());
    Require(retargeter.LoadShares(ScratchFile("in.bsm", input)), "every text is a share file");
}
