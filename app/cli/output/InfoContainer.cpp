// The container part of `info`: roots, objects and package blocks, as text or JSON.

#include "InfoContainer.h"

#include "CCustomData.h"
#include "CFieldDescriber.h"
#include "CJsonWriter.h"
#include "COrrinStream.h"
#include "PackageBlocks.h"
#include "Text.h"
#include "Words.h"

#include <algorithm>
#include <cstdio>
#include <vector>

namespace gw {

namespace {

std::string VersionText(CVersion version)
{
    char text[32];
    std::snprintf(text, sizeof text, "%d.%02d", version.m_iMajor, version.m_iMinor);
    return text;
}

std::string FormatName(uint32_t format)
{
    const std::string extension = FormatExtension(format);
    return extension.empty() ? "unknown" : extension.substr(1);
}

void PrintPackage(const PackageBlocks& blocks)
{
    PackageFacts facts;
    if (blocks.info && ReadPackageFacts(*blocks.info, facts))
        std::printf("MotionInfo: version %u, format %s, rate %g, %g\n", facts.version,
                    FormatName(facts.format).c_str(), facts.rate, facts.sixty);
    if (blocks.file)
        std::printf("MotionFile: %zu bytes\n", blocks.file->Data().size());
}

void WritePackage(CJsonWriter& json, const PackageBlocks& blocks)
{
    PackageFacts facts;
    json.Key("package");
    if (!blocks.info || !ReadPackageFacts(*blocks.info, facts))
        return json.Null();
    json.BeginObject();
    json.Key("version").Integer(facts.version);
    json.Key("format").Text(FormatName(facts.format));
    json.Key("rate").Number(facts.rate);
    json.Key("sixty").Number(facts.sixty);
    json.Key("fileBytes").Integer(blocks.file ? static_cast<int64_t>(blocks.file->Data().size()) : 0);
    json.EndObject();
}

void WriteMembers(CJsonWriter& json, CObject& object, EDescribe what, const CObjectNumbers& numbers)
{
    json.BeginObject();
    {
        CFieldDescriber describer(what, json, numbers);
        object.Fields(describer);
    }
    json.EndObject();
}

void WriteObject(CJsonWriter& json, CObject& object, bool isRoot, const CObjectNumbers& numbers)
{
    json.BeginObject();
    json.Key("id").Integer(static_cast<int64_t>(numbers.at(&object)));
    json.Key("class").Text(object.GetRTTI()->m_pcName);
    json.Key("name").Text(object.NameView());
    json.Key("root").Bool(isRoot);
    json.Key("links");
    WriteMembers(json, object, EDescribe::Links, numbers);
    json.Key("fields");
    WriteMembers(json, object, EDescribe::Fields, numbers);
    json.EndObject();
}

} // namespace

void PrintIndented(size_t depth, const std::string& line)
{
    constexpr size_t kDeepest = 60; // lines are for reading, and a hostile file nests thousands of levels
    std::printf("%*s%s\n", static_cast<int>(2 * std::min(depth, kDeepest)), "", line.c_str());
}

void PrintContainer(COrrinStream& scene)
{
    std::printf("version: %s\nroots:   %zu\nobjects: %zu\n", VersionText(scene.GetVersion()).c_str(),
                scene.GetRootCount(), scene.ObjectsInSaveOrder().size());
    PrintPackage(FindPackage(scene));
}

void PrintObjects(COrrinStream& scene)
{
    struct Place
    {
        CObject* object;
        size_t depth;
    };
    std::vector<Place> open;
    for (size_t i = scene.GetRootCount(); i-- > 0;)
        open.push_back({scene.GetRoot(i), 1});
    CObjectNumbers seen;
    std::puts("tree:");
    while (!open.empty())
    {
        const Place place = open.back();
        open.pop_back();
        if (!seen.try_emplace(place.object, seen.size()).second)
            continue;
        const std::string_view name = place.object->NameView();
        PrintIndented(place.depth,
                      place.object->GetRTTI()->m_pcName + (name.empty() ? "" : ' ' + Quoted(name)));
        const std::vector<CObject*> held = place.object->HeldObjects();
        for (auto below = held.rbegin(); below != held.rend(); ++below)
            open.push_back({*below, place.depth + 1});
    }
}

void WriteContainer(CJsonWriter& json, COrrinStream& scene)
{
    const std::vector<CObject*> objects = scene.ObjectsInSaveOrder();
    CObjectNumbers numbers;
    for (const CObject* object : objects)
        numbers.emplace(object, numbers.size() + 1);
    json.Key("version").Text(VersionText(scene.GetVersion()));
    WritePackage(json, FindPackage(scene));
    json.Key("roots").BeginArray();
    for (size_t i = 0; i < scene.GetRootCount(); ++i)
        json.Integer(static_cast<int64_t>(numbers.at(scene.GetRoot(i))));
    json.EndArray();
    json.Key("objects").BeginArray();
    for (CObject* object : objects)
        WriteObject(json, *object, scene.IsRoot(object), numbers);
    json.EndArray();
}

} // namespace gw
