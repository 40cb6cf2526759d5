#include "CJsonWriter.h"
#include "CSceneFile.h"
#include "CommandTable.h"
#include "PosedObject.h"
#include "Words.h"

namespace gw {

namespace {

void WriteNode(CJsonWriter& json, const FoundNode& found)
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

void WriteNodes(CJsonWriter& json, const CSceneFile& file)
{
    json.Key("nodes").BeginArray();
    for (const FoundNode& found : file.Nodes())
    {
        json.BreakLine();
        WriteNode(json, found);
    }
    json.EndArray();
}

void WriteObjects(CJsonWriter& json, CSceneFile& file)
{
    json.Key("objects").BeginArray();
    for (CObject* object : file.Objects())
    {
        CSpatial* spatial = RecordCast<CSpatial>(object);
        if (!spatial)
            continue;
        json.BreakLine();
        WritePosedObject(json, *spatial);
    }
    json.EndArray();
}

} // namespace

EExit RunPose(const ShellOptions& options)
{
    const std::string& path = options.files[0];
    CSceneFile file;
    if (!file.LoadWhole(path))
        return EExit::Failed;
    SayWarnings(options, path, file.Record());
    const float time = options.time ? *options.time : file.TimeOf(options.frame);
    file.Update(time);

    CJsonWriter json(stdout);
    json.BeginObject();
    if (options.time)
        json.Key("time").Number(time);
    else
        json.Key("frame").Integer(options.frame);
    if (options.objects)
        WriteObjects(json, file);
    else
        WriteNodes(json, file);
    json.EndObject();
    json.EndDocument();
    return EExit::Done;
}

} // namespace gw
