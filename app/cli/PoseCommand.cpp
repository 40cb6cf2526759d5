#include "CJsonWriter.h"
#include "CSceneFile.h"
#include "Commands.h"
#include "Words.h"

namespace gw {

namespace {

void WriteNode(CJsonWriter& json, const CFoundNode& found)
{
    json.BeginObject();
    json.Key("name").Text(found.node->NameView());
    json.Key("parent");
    if (found.parent)
        json.Text(found.parent->NameView());
    else
        json.Null();
    json.Key("local").Numbers(found.node->m_kMatrix.m);
    json.Key("world").Numbers(found.node->m_kWorldMatrix.m);
    json.EndObject();
}

} // namespace

EExit RunPose(const COptions& options)
{
    const std::string& path = options.files[0];
    CSceneFile file;
    if (!file.LoadWhole(path))
        return EExit::Failed;
    SayWarnings(options, path, file.Record());
    file.Update(options.frame);

    CJsonWriter json(stdout);
    json.BeginObject();
    json.Key("frame").Integer(options.frame);
    json.Key("nodes").BeginArray();
    for (const CFoundNode& found : file.Nodes())
    {
        json.BreakLine();
        WriteNode(json, found);
    }
    json.EndArray();
    json.EndObject();
    json.EndDocument();
    return EExit::Done;
}

} // namespace gw
