#include "MeshSamples.h"

namespace gw {
namespace {

void AddControls(CTriMesh& mesh, CNode& bone)
{
    CBoneSkinControl* skin = new CBoneSkinControl;
    mesh.AttachControl(skin);
    skin->AddInfluence(bone, 1, 0.75f, Moved(1, 2, 3));
    skin->AddInfluence(bone, 0, 0.0f, kMat4Identity);
    skin->RebuildSkinTables();

    CSkinBoneControl* byPoint = new CSkinBoneControl;
    mesh.AttachControl(byPoint);
    byPoint->m_bActive = false;
    byPoint->AddInfluence(bone, 7, 0.5f, Moved(4, 5, 6));
    byPoint->AddInfluence(bone, 7, 0.25f, kMat4Identity);
    byPoint->AddInfluence(bone, 2, 1.0f, kMat4Identity);

    CMorphControl* morph = new CMorphControl;
    mesh.AttachControl(morph);
    morph->m_fEndTime = 9.0f;
    morph->m_kDeltas = {kVec3UnitX, kVec3UnitY};
    morph->m_kWeights = {0.0f, 0.5f, 1.0f};
    morph->m_kKeyTimes = {1.0f, 2.0f};

    CMeshSelControl* selection = new CMeshSelControl;
    mesh.AttachControl(selection);
    selection->m_kSelection = CBitArray(33);
    selection->m_kSelection.Set(32);
}

void AddMapControl(CTriMesh& mesh)
{
    CTriMeshUVWMapControl* frames = new CTriMeshUVWMapControl;
    mesh.m_apkUVWMap[0]->AttachControl(frames);
    frames->m_fEndTime = 9.0f;
    frames->m_kFrames = {kVec3UnitX, kVec3UnitY, kVec3UnitZ, kVec3One, kVec3One, kVec3Zero};
    frames->m_kKeyTimes = {0.0f, 3.0f};
}

void AddSeam(CTriMesh& first, CTriMesh& second)
{
    const Ref<CConnectData> seam = new CConnectData;
    seam->m_kFirst.m_pkMesh.Set(&first);
    seam->m_kFirst.m_kPoints = {1, 3};
    seam->m_kFirst.m_kGroups = {{0, 1}, {}};
    seam->m_kSecond.m_pkMesh.Set(&second);
    seam->m_kSecond.m_kPoints = {0, 2};
    seam->m_kSecond.m_kGroups = {{5}};

    const Ref<CEditNormalData> smoothing = new CEditNormalData;
    smoothing->m_kMeshes.resize(2);
    smoothing->m_kMeshes[0].m_pkMesh.Set(&first);
    smoothing->m_kMeshes[0].m_kNormals = CBitArray(24);
    smoothing->m_kMeshes[0].m_kNormals.Set(5);
    smoothing->m_kMeshes[1].m_pkMesh.Set(&second);
    smoothing->m_bEnabled = false;
    smoothing->m_fThreshold = 0.125f;

    for (CTriMesh* mesh : {&first, &second})
    {
        CConnectControl* connect = new CConnectControl;
        connect->m_spkConnectData = seam.Get();
        mesh->AttachControl(connect);
        CEditNormalControl* smooth = new CEditNormalControl;
        smooth->m_spkEditNormalData = smoothing.Get();
        mesh->AttachControl(smooth);
    }
}

CParticles* MakeParticles()
{
    CParticles* particles = new CParticles;
    particles->m_iParticleCount = 20;
    particles->m_uiStoredValue = 7;
    CParticleControl* control = new CParticleControl;
    particles->AttachControl(control);
    control->m_uiCapacity = 12;
    control->m_fRate = 2.0f;
    control->m_kPlace.Set({-1, 1, 0}, {1, -1, 2});
    control->m_fLife = 11.0f;
    return particles;
}

} // namespace

Ref<CNode> ControlledScene()
{
    Ref<CNode> root = new CNode;
    const Ref<CTriMesh> first = FullMesh();
    const Ref<CTriMesh> second = Cube();
    const Ref<CNode> bone = new CNode;
    bone->SetName("bone");
    for (const Ref<CSpatial>& child : {Ref<CSpatial>(first), Ref<CSpatial>(second), Ref<CSpatial>(bone)})
        root->AttachChild(child.Get());
    AddControls(*first, *bone);
    AddMapControl(*first);
    AddSeam(*first, *second);
    root->AttachChild(MakeParticles());
    CCircle* circle = new CCircle;
    circle->m_fRadius = 2.5f;
    root->AttachChild(circle);
    root->AttachChild(new CLine);
    root->AttachChild(new CRectangle);
    root->AttachChild(new CNode); // no slot stays empty, because a clone's children are packed
    return root;
}

} // namespace gw
