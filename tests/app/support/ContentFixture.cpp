#include "ContentFixture.h"

#include "CKeyframeControl.h"
#include "COrrinStream.h"
#include "MadeText.h"
#include "Paths.h"
#include "Text.h"

#include <algorithm>

namespace gw {

// ---- window

EAnswer CScriptedWindow::ShowMessageBox(int id, const std::string& text, EButtons)
{
    m_kCalls.push_back("box " + std::to_string(id));
    m_kBoxes.push_back(text);
    onBox();
    const auto answer = m_kAnswers.find(id);
    return answer == m_kAnswers.end() ? EAnswer::OK : answer->second;
}

void CScriptedWindow::Notify(const Notice& notice)
{
    m_kNotices.push_back(notice);
    m_kCalls.push_back("notice " + notice.code + (notice.name.empty() ? "" : ' ' + notice.name));
}

void CScriptedWindow::SetChildText(std::string_view child, const std::string& text)
{
    m_kTexts[std::string(child)] = text;
    if (child == "#title")
        m_kTitles.push_back(text);
}

std::string CScriptedWindow::TakeWords()
{
    std::string words;
    for (const std::string& call : TakeCalls())
    {
        std::string_view rest = call;
        const std::string_view verb = NextWord(rest);
        if (verb == "notice" || verb == "box")
            words.append(words.empty() ? "" : ", ").append(rest.substr(1));
    }
    return words;
}

std::optional<std::string> CScriptedWindow::AskOpenFile(const FileDialogSetup& setup)
{
    m_kCalls.push_back("open *." + setup.defaultExtension + " in " + setup.initialFolder);
    return openAnswer;
}

std::optional<std::string> CScriptedWindow::AskSaveFile(const FileDialogSetup& setup)
{
    m_kCalls.push_back("save *." + setup.defaultExtension);
    m_kAsked = setup;
    return saveAnswer;
}

std::optional<FolderChoice> CScriptedWindow::AskFolder(const FileDialogSetup& setup)
{
    m_kCalls.push_back("folder in " + setup.initialFolder);
    m_kAsked = setup;
    return folderAnswer;
}

std::unique_ptr<CMotionView> CScriptedWindow::CreateView(std::string_view child)
{
    auto view = std::make_unique<CWatchedView>();
    (child == "#cnt1" ? m_pkSource : m_pkResult) = view.get();
    return view;
}

void CScriptedWindow::SetTimer(int id, int milliseconds)
{
    m_kCalls.push_back("timer " + std::to_string(id) + ' ' + std::to_string(milliseconds));
}

bool CScriptedWindow::OpenWebPage(const std::string& address)
{
    m_kCalls.push_back("web " + address);
    return true;
}

std::set<std::string> CScriptedWindow::Enabled() const
{
    std::set<std::string> names;
    for (const auto& [name, on] : m_kEnabled)
    {
        if (on)
            names.insert(name);
    }
    return names;
}

// ---- platform

std::string CScriptedPlatform::ReadSetting(const std::string& key) const
{
    const auto found = m_kSettings.find(key);
    return found == m_kSettings.end() ? std::string() : found->second;
}

bool CScriptedPlatform::WriteSetting(const std::string& key, const std::string& value)
{
    m_kSettings[key] = value;
    return true;
}

std::string CScriptedPlatform::ReadHostKey(const std::string& keyPath, const std::string& valueName) const
{
    const auto found = m_kHostKeys.find(keyPath + '/' + valueName);
    return found == m_kHostKeys.end() ? std::string() : found->second;
}

bool CScriptedPlatform::MakeFolder(const std::string& path)
{
    return CreateFolder(path);
}

// ---- files

const SourceBones kPoserBones{"hip", "lThigh", "lShin", "lFoot", "rThigh", "rShin", "rFoot"};
const SourceBones kMaxBones{"Bip01", "L_Thigh", "L_Calf", "L_Foot", "R_Thigh", "R_Calf", "R_Foot"};

namespace {

constexpr const char* kTargetBones[][2] = {
    {"LowerTorso", "GLOBAL"}, {"Waist", "LowerTorso"}, {"LPelvis", "LowerTorso"}, {"LThigh", "LPelvis"},
    {"LCalf", "LThigh"},      {"LFoot", "LCalf"},      {"RPelvis", "LowerTorso"}, {"RThigh", "RPelvis"},
    {"RCalf", "RThigh"},      {"RFoot", "RCalf"},
};

// A hip, a waist and two legs pointing down; one frame.
std::string TargetText()
{
    std::string text =
        "[Header]\nFileType htr\nDataType HTRS\nFileVersion 1\nNumSegments 10\nNumFrames 1\n"
        "DataFrameRate 30\nEulerRotationOrder ZYX\nCalibrationUnits mm\nRotationUnits Degrees\n"
        "GlobalAxisofGravity Y\nBoneLengthAxis Y\nScaleFactor 1.000000\n"
        "[SegmentNames&Hierarchy]\n#CHILD\tPARENT\n";
    std::string rest = "[BasePosition]\n#SegmentName Tx, Ty, Tz, Rx, Ry, Rz, BoneLength\n";
    std::string data;
    for (const auto& [bone, parent] : kTargetBones)
    {
        const std::string_view name = bone;
        const bool isThigh = name.ends_with("Thigh");
        const char* const place = isThigh ? (*bone == 'L' ? " 95 -40 0" : " -95 -40 0") : " 0 -400 0";
        text.append(bone).append(" ").append(parent).append("\n");
        rest.append(bone).append(name == "LowerTorso" ? " 0 920 0" : place).append(" 0 0 0 400\n");
        data.append("[").append(bone).append("]\n1 0 0 0 0 0 0 1\n");
    }
    return text + rest + data + "[EndOfFile]\n";
}

} // namespace

std::string BvhText(const SourceBones& bones, int frameCount)
{
    const Vec3 toe{0.0f, -4.0f, 12.0f};
    const std::vector<TextJoint> joints{{bones[0], -1, kVec3Zero},      {bones[1], 0, {9, -4, 0}},
                                        {bones[2], 1, {0, -40, 0}},     {bones[3], 2, {0, -38, 0}, toe},
                                        {bones[4], 0, {-9, -4, 0}},     {bones[5], 4, {0, -40, 0}},
                                        {bones[6], 5, {0, -38, 0}, toe}};
    return MadeText(joints, frameCount, 0.033334, [](size_t joint, int frame) {
        const auto n = static_cast<float>(5 * frame);
        return joint == 0 ? TextKey{{0, 80, n}, {0, n, 0}}
                          : TextKey{kVec3Zero, {joint % 2 == 0 ? n : -n, 0, 0}};
    });
}

std::string BoneMapText(const std::string& name, const SourceBones& bones)
{
    const char* const targets[] = {"LowerTorso", "LThigh", "LCalf", "LFoot", "RThigh", "RCalf", "RFoot"};
    std::string text = name + "\nFrameRate 30\nPosition 0 0 0\n";
    for (size_t i = 0; i < bones.size(); ++i)
        text.append(bones[i]).append(" <---> ").append(targets[i]).append(" 0,0,0,1,2,3\n");
    return text;
}

std::set<std::string> Words(std::string_view text)
{
    std::set<std::string> words;
    for (std::string_view word = NextWord(text); !word.empty(); word = NextWord(text))
        words.emplace(word);
    return words;
}

// ---- fixture

ContentTest::ContentTest()
{
    Write("data/base.htr", TargetText());
    Write("data/PoserBVH.prf", BoneMapText("Poser", kPoserBones));
    Write("data/MaxBVH.prf", BoneMapText("3DS MAX", kMaxBones));
    Write("docs/BVH Profile/Custom0.prf", BoneMapText("Mine", kPoserBones));
    m_kContent.OnInitContent();
}

std::string ContentTest::Write(const std::string& name, const std::string& text) const
{
    std::string path = m_kFolder.Path(name);
    CreateFolder(SplitPath(path).folder);
    WriteBytes(path, text);
    return path;
}

std::string ContentTest::Read(const std::string& name) const
{
    return ReadBytes(m_kFolder.Path(name));
}

bool ContentTest::Exists(const std::string& name) const
{
    return FileExists(m_kFolder.Path(name));
}

std::string ContentTest::WriteContainer(const std::string& name, bool withTrack) const
{
    Ref<CNode> hip = new CNode;
    hip->SetName("hip");
    if (withTrack)
    {
        Ref<CKeyframeControl> track = new CKeyframeControl;
        track->m_kKeyTimes = {0.0f, 1.0f};
        track->m_kRotationKeys.assign(2, kQuatIdentity);
        track->m_fEndTime = 1.0f;
        hip->AttachControl(track.Get());
    }
    COrrinStream stream;
    stream.AddRoot(hip.Get());
    EXPECT_TRUE(stream.SaveFile(m_kFolder.Path(name)));
    return m_kFolder.Path(name);
}

int ContentTest::Open(const std::string& path)
{
    m_kWindow.openAnswer = path;
    return m_kContent.OpenSource();
}

void ContentTest::Do(std::string_view steps)
{
    while (!steps.empty())
    {
        std::string_view step = NextToken(steps, ",");
        const std::string verb(NextWord(step));
        const std::string object(NextWord(step));
        if (verb == "open")
            Open(m_kFolder.Path(object));
        else if (verb == "click")
            m_kContent.ChildClick(object);
        else
            SelectProfile(object);
    }
}

void ContentTest::OpenAndConvert()
{
    ASSERT_EQ(Open(Write("walk.bvh", BvhText(kPoserBones))), 1);
    ASSERT_EQ(m_kContent.ConvertMotion(), 1);
    m_kWindow.TakeCalls();
}

int ContentTest::SaveAs(const std::string& name)
{
    m_kWindow.saveAnswer = m_kFolder.Path(name);
    return m_kContent.SaveResult();
}

void ContentTest::SelectProfile(const std::string& name)
{
    for (int index = 0; const std::string* text = m_kWindow.m_kList.GetItemText(index); ++index)
    {
        if (*text == name)
            m_kWindow.m_kList.SetCurSel(index);
    }
    m_kContent.OnCntCommand(9);
}

std::string ContentTest::SelectedProfile() const
{
    const std::string* text = m_kWindow.m_kList.GetItemText(m_kWindow.m_kList.GetCurSel());
    return text ? *text : std::string();
}

} // namespace gw
