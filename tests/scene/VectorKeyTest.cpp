#include "CCamera.h"
#include "CCameraControl.h"
#include "CLight.h"
#include "CLightControl.h"
#include "SceneBytes.h"
#include "SceneSamples.h"

#include <gtest/gtest.h>

namespace gw {
namespace {

void FillKeys(CVectorKeyControl& control)
{
    control.m_fEndTime = 10.0f;
    control.m_kKeys = {kVec3UnitX, kVec3UnitY, kVec3UnitZ};
    control.m_kKeyTimes = {0.0f, 4.0f, 6.0f};
}

} // namespace

TEST(CCameraControl, WritesTheVectorBetweenKeysAndPointsAheadWithout)
{
    const Ref<CCamera> camera = new CCamera;
    CCameraControl* control = new CCameraControl;
    camera->AttachControl(control);
    EXPECT_FALSE(control->Update(1.0f));
    EXPECT_EQ(camera->m_kControlVector, kVec3UnitZ);
    FillKeys(*control);
    camera->UpdateScene(3.0f, false);
    EXPECT_EQ(camera->m_kControlVector, (Vec3{0.25f, 0.75f, 0}));
    EXPECT_EQ(camera->m_uiChangeStamp, 2u);
    control->m_kKeyTimes.clear();
    camera->UpdateScene(3.0f, false);
    EXPECT_EQ(camera->m_kControlVector, kVec3UnitZ) << "keys without times";
    control->m_bActive = false;
    camera->m_kControlVector = kVec3One;
    camera->UpdateScene(3.0f, false);
    EXPECT_EQ(camera->m_kControlVector, kVec3One);
    EXPECT_EQ(camera->m_uiChangeStamp, 3u);
}

TEST(CLightControl, WritesTheColourBetweenKeysAndNothingWithout)
{
    const Ref<CPointLight> light = new CPointLight;
    light->m_kRGB = kVec3One;
    CLightControl* control = new CLightControl;
    light->AttachControl(control);
    EXPECT_FALSE(control->Update(1.0f));
    EXPECT_EQ(light->m_kRGB, kVec3One);
    FillKeys(*control);
    light->UpdateScene(5.0f, false);
    EXPECT_EQ(light->m_kRGB, (Vec3{0, 0.5f, 0.5f}));
    EXPECT_EQ(light->m_uiChangeStamp, 2u);

    const Ref<CCamera> camera = new CCamera;
    const Ref<CLightControl> strange = new CLightControl;
    camera->AttachControl(strange.Get());
    EXPECT_FALSE(strange->Update(5.0f)) << "a target of another class";
}

TEST(VectorKeys, StandBeforeTheirTimesInAFile)
{
    for (const char* className : {"CCameraControl", "CLightControl"})
    {
        SCOPED_TRACE(className);
        CSceneBytes bytes = Scene();
        bytes.Root().Object(className, 1).Word(0).Float(1).Float(2).Float(3).Float(4).Byte(1);
        bytes.Words({0, 0, 1}).Add(kVec3UnitY).Word(2).Float(5).Float(6);
        COrrinStream stream;
        ASSERT_TRUE(LoadBytes(stream, bytes.Bytes()));
        EXPECT_EQ(SaveBytes(stream), bytes.Bytes());
        const auto& control = static_cast<const CVectorKeyControl&>(*stream.GetRoot(0));
        EXPECT_EQ(control.m_kKeys, std::vector{kVec3UnitY});
        EXPECT_EQ(control.m_kKeyTimes, (std::vector{5.0f, 6.0f}));
    }
}

} // namespace gw
