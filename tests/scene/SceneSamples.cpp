#include "SceneSamples.h"

#include "CCamera.h"
#include "CCameraControl.h"
#include "CLight.h"
#include "CLightControl.h"

namespace gw {
namespace {

// Plain values are told by the documents' test of every class; these matter to links, copies or damage.
void FillTrack(CKeyframeControl& track)
{
    track.m_iCycleType = 2;
    track.m_fEndTime = 9.0f;
    track.m_bHasRestMatrix = true;
    track.m_kRotationKeys = {kQuatIdentity, Quat{0, 1, 0, 0}};
    track.m_kPositionKeys = {kVec3One, kVec3UnitX, Vec3{7, 8, 9}};
    track.m_kPositionTimes = {1, 2, 3};
    track.m_uiParentMask = 0x155;
}

void FillKeys(CVectorKeyControl& control)
{
    control.m_kKeys = {kVec3UnitX, kVec3One};
    control.m_kKeyTimes = {3.0f};
}

CCamera* MakeCamera()
{
    CCamera* camera = new CCamera;
    camera->m_afParameter[3] = 7.0f;
    camera->m_kEye = {1, 2, 3};
    camera->m_kUp = kVec3UnitZ;
    camera->m_kLookAt = {4, 5, 6};
    camera->m_bCameraFlagB = false;
    camera->SetCameraTarget(new CCameraTarget);
    camera->GetCameraTarget()->SetName("look here");
    CCameraControl* control = new CCameraControl;
    FillKeys(*control);
    camera->AttachControl(control);
    return camera;
}

CPointLight* MakeLight()
{
    CPointLight* light = new CPointLight;
    light->m_kLocation = {9, 8, 7};
    CLightControl* control = new CLightControl;
    FillKeys(*control);
    light->AttachControl(control);
    return light;
}

CRawData* MakeData()
{
    CRawData* data = new CRawData;
    data->SetName("bytes");
    data->SetCreator("sample", 2, 5);
    data->SetUserWord(77);
    const uint8_t bytes[] = {1, 2, 3};
    data->SetData(std::as_bytes(std::span(bytes)));
    data->SetNextData(new CAuthorInfo);
    data->GetNextData()->SetCreator("author", 1, 1);
    return data;
}

CKeyframeClipControl* MakeClips()
{
    CKeyframeClipControl* clips = new CKeyframeClipControl;
    FillTrack(*clips);
    ClipRecord clip{.m_iField = 5, .m_iType = 2, .m_fBegin = 1.0f, .m_fEnd = 4.0f};
    clip.m_acText[0] = 'w';
    clips->m_kClips = {clip, ClipRecord{}};
    clips->m_kSchedule = {ClipScheduleEntry{0.5f, 1, 3}, ClipScheduleEntry{2.5f, 0, 1}};
    return clips;
}

} // namespace

Ref<CNode> SampleGraph()
{
    Ref<CNode> root = new CNode(3);
    root->SetName("root");
    root->m_kMatrix.SetTranslation({1, 2, 3});
    root->m_bStoredFlag = false;
    root->m_bNodeFlagA = false;
    CNode* billboard = new CBillboardNode(2);
    billboard->m_bNodeFlagB = false;
    root->AttachChild(MakeCamera());
    CSpatial* gap = MakeCamera();
    root->AttachChild(gap);
    root->AttachChild(billboard);
    root->AttachChild(MakeLight());
    root->DetachChild(gap);

    CKeyframeControl* track = new CKeyframeControl;
    FillTrack(*track);
    track->SetName("CKeyFrameControl");
    root->AttachControl(track);
    root->AttachControl(MakeClips());
    billboard->AttachControl(MakeClips());
    billboard->GetControl()->SetTarget(root.Get());
    root->AttachCustomData(MakeData());
    billboard->AttachCustomData(root->GetCustomData());
    return root;
}

Ref<CNode> TrackedNode(const std::vector<float>& times)
{
    Ref<CNode> node = new CNode;
    CKeyframeControl* track = new CKeyframeControl;
    node->AttachControl(track);
    track->m_kKeyTimes = times;
    track->m_fBeginTime = times.empty() ? 0.0f : times.front();
    track->m_fEndTime = times.empty() ? 0.0f : times.back();
    for (const float time : times)
        track->m_kPositionKeys.push_back({time, 0.0f, 0.0f});
    return node;
}

} // namespace gw
