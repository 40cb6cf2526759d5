// Reads scene containers with every class. What was read is posed and cloned, and its bytes must survive
// being written and read again.

#include "COrrinStream.h"
#include "CSpatial.h"
#include "FuzzTarget.h"

#include <vector>

namespace gw {

namespace {

void Exercise(CObject& root)
{
    for (const float time : {0.0f, 0.4f, 7.0f, -1.0f})
    {
        if (auto* spatial = dynamic_cast<CSpatial*>(&root))
            spatial->UpdateScene(time, false);
        else
            root.Update(time);
    }
    CCloneMap copies;
    const Ref<CObject> copy = root.Clone(copies);
    Require(copy.Get() != nullptr, "what can stand in a file can be cloned");
}

} // namespace

void FuzzOne(std::span<const std::byte> input)
{
    COrrinStream first, second;
    if (!first.LoadFile(ScratchFile("in.orn", input), false) || first.Record().Failure())
        return;
    std::vector<std::byte> written, again;
    Require(first.SaveBuffer(written), "what was read can be written");
    Require(second.LoadBuffer(written, 0), "what was written can be read");
    Require(second.SaveBuffer(again) && again == written, "a scene survives a save byte for byte");
    for (size_t i = 0; i < first.GetRootCount(); ++i)
        Exercise(*first.GetRoot(i));
}

} // namespace gw
