#include "PosedObject.h"

#include "CCamera.h"
#include "CJsonWriter.h"
#include "CLight.h"
#include "CTriMesh.h"
#include "CTriMeshUVWMap.h"

namespace gw {

namespace {

void WriteVector(CJsonWriter& json, const Vec3& v)
{
    const float numbers[] = {v.x, v.y, v.z};
    json.Numbers(numbers);
}

void WriteVectors(CJsonWriter& json, std::span<const Vec3> vectors)
{
    json.BeginArray();
    for (const Vec3& v : vectors)
        WriteVector(json, v);
    json.EndArray();
}

void WriteGeometry(CJsonWriter& json, CGeometry& geometry)
{
    json.Key("points");
    WriteVectors(json, geometry.WorldXYZBuffer());
    json.Key("normals");
    WriteVectors(json, geometry.WorldNormalBuffer());
}

void WriteMaps(CJsonWriter& json, const CTriMesh& mesh)
{
    json.Key("uvw").BeginArray();
    for (const auto& map : mesh.m_apkUVWMap)
        WriteVectors(json, map ? map->UVWBuffer() : std::span<Vec3>());
    json.EndArray();
}

void WriteCamera(CJsonWriter& json, const CCamera& camera)
{
    json.Key("eye");
    WriteVector(json, camera.m_kWorldEye);
    json.Key("control");
    WriteVector(json, camera.m_kControlVector);
}

void WriteLocation(CJsonWriter& json, const CPointLight& light)
{
    json.Key("location");
    WriteVector(json, light.m_kWorldLocation);
}

void WriteColor(CJsonWriter& json, const CLight& light)
{
    json.Key("rgb");
    WriteVector(json, light.m_kRGB);
}

// Calls a writer if the object is of its class or a derived one.
template <class T>
void WriteAs(CJsonWriter& json, CSpatial& object, void (*write)(CJsonWriter&, T&))
{
    if (auto* own = RecordCast<std::remove_const_t<T>>(&object))
        write(json, *own);
}

} // namespace

void WritePosedObject(CJsonWriter& json, CSpatial& object)
{
    const BoundSphere& bound = object.m_kBound;
    const float sphere[] = {bound.m_kCentre.x, bound.m_kCentre.y, bound.m_kCentre.z, bound.m_fRadius};
    json.BeginObject();
    json.Key("class").Text(object.GetRTTI()->m_pcName);
    json.Key("name").Text(object.NameView());
    json.Key("local").Numbers(object.m_kMatrix.m);
    json.Key("world").Numbers(object.m_kWorldMatrix.m);
    json.Key("bound").Numbers(sphere);
    WriteAs(json, object, WriteGeometry);
    WriteAs(json, object, WriteMaps);
    WriteAs(json, object, WriteCamera);
    WriteAs(json, object, WriteLocation);
    WriteAs(json, object, WriteColor);
    json.EndObject();
}

} // namespace gw
