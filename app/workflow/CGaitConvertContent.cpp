// The states of the desktop program: nothing open, source open, converted, saved. This file has the
// transitions between them; the other sources of the class have the commands by subject.

#include "CGaitConvertContent.h"

#include "AttachBoneMeshes.h"
#include "CCntComboExControl.h"
#include "CContentWindow.h"
#include "CLongStep.h"
#include "CProfileEditorDialog.h"
#include "CWaitCursor.h"
#include "Numbers.h"
#include "Paths.h"
#include "SourceTiming.h"
#include "StringTable.h"

namespace gw {

namespace {

constexpr std::string_view kProfileExtension = ".prf";
constexpr const char* kMoreFilters =
    "Other motions (*.htr, *.cha, *.chb)|*.htr;*.cha;*.chb|"
    "Models with motions (*.fbx, *.gltf, *.glb, *.vrm, *.dae)|"
    "*.fbx;*.gltf;*.glb;*.vrm;*.dae|"
    "All of these|*.bvh;*.orn;*.htr;*.cha;*.chb;*.fbx;*.gltf;*.glb;*.vrm;*.dae||";
constexpr const char* kFolderSetting = "MotionSource";

void SetScene(CMotionView* view, CNode* root, const SourceTiming& timing)
{
    if (view)
        view->SetScene(root, timing.FrameStep(), timing.lastFrame);
}

} // namespace

CGaitConvertContent::CGaitConvertContent(CContentWindow& window, CPlatform& platform)
    : window_(window), platform_(platform)
{
    m_kResultMotion.SetProgress(ProgressOf("Saving")); // reading the base skeleton takes no time
    m_kResources.OpenLibrary(platform.DataFolder() + kResourceLibrary, platform.ThreadLocale());
}

CGaitConvertContent::~CGaitConvertContent() = default;

bool CGaitConvertContent::OnInitContent()
{
    m_pkSourceView = window_.CreateView(kSourceViewChild);
    m_pkResultView = window_.CreateView(kResultViewChild);
    const int fontSize = ParseInt(Message(kListFontSizeMessage));
    m_pkProfileCombo = &window_.CreateComboEx("#format", "pull", fontSize);
    m_pkProfileCombo->SetFont(Message(kListFontMessage), fontSize, fontSize);
    RefreshProfileList();
    m_pkProfileDialog = std::make_unique<CProfileEditorDialog>(*this);
    m_pkProfileDialog->SetNamesInUse(&m_kProfileNames);
    m_pkProfile = m_pkProfileDialog.get();
    window_.SetChildScrollRange("|playbar", 0, kScrollRange);
    RestoreFollow();
    UpdateControls();
    return m_pkSourceView && m_pkResultView;
}

bool CGaitConvertContent::ConfirmDiscard()
{
    if (!m_bConverted || m_bSaved)
        return true;
    const EAnswer answer = ShowMessage(kSaveResultMessage, EButtons::YesNoCancel);
    if (answer == EAnswer::Yes)
        return SaveResult() != 0; // always true: a user who cancels the save dialog loses the result
    return answer == EAnswer::No;
}

bool CGaitConvertContent::MayClose()
{
    if (m_pkProfile)
        m_pkProfile->PromptSaveChanges();
    return ConfirmDiscard();
}

int CGaitConvertContent::OpenSource()
{
    if (!ConfirmDiscard())
        return 0;
    const auto path = window_.AskOpenFile({.defaultExtension = "bvh",
                                           .filter = Message(kOpenFilterMessage),
                                           .initialFolder = SourceFolder(),
                                           .moreFilters = kMoreFilters,
                                           .openedLast = m_kSourcePath});
    return path ? Open(*path) : 1;
}

int CGaitConvertContent::OpenFile(const std::string& path)
{
    return ConfirmDiscard() ? Open(path) : 0;
}

const std::vector<std::string>& CGaitConvertContent::Clips() const
{
    static const std::vector<std::string> kNone;
    return m_bSourceIsContainer ? kNone : m_kSourceMotion.imported.clips;
}

int CGaitConvertContent::ChooseClip(const std::string& clip)
{
    m_kSourceMotion.importChoice.clip = clip;
    const int opened = OpenFile(m_kSourcePath);
    m_kSourceMotion.importChoice = {};
    return opened;
}

int CGaitConvertContent::OpenDropped(const std::string& path)
{
    if (FolderExists(path))
        return RunBatch(WithSeparator(path));
    if (!HasExtension(path, kProfileExtension))
        return OpenFile(path);
    UseProfileFile(path);
    UpdateControls();
    return 1;
}

int CGaitConvertContent::Open(const std::string& path)
{
    window_.RedrawFrame();
    const CWaitCursor wait(window_);
    ForgetFailedSave();
    m_kNextSteps.SetMendable({});
    if (m_pkSourceView)
        m_pkSourceView->Stop();
    bool loaded = false;
    try
    {
        const CLongStep step(*this);
        loaded = LoadSource(path);
    } catch (const CCanceled&)
    {
        return 0;
    }
    if (!loaded)
    {
        NotifyOfFindings(path);
        ShowMessage(kInvalidSourceMessage, EButtons::OK);
        return 0;
    }
    if (!m_bSourceIsContainer && !m_kSourceMotion.Record().Warnings().empty())
        NotifyOfFindings(path);
    m_kSourcePath = path;
    RememberFolder(path);
    AddRecentFile(path);
    m_kSavedPath.clear();
    m_bConversionFailed = false;
    ShowSource();
    NotifyOfUpAxis();
    MeasureFits();
    PickStockProfile();
    if (m_pkProfile)
        m_pkProfile->ApplyProfile(nullptr, nullptr, nullptr);
    UpdateControls();
    // Only here, so that "apply" keeps the previous result's state until the next update.
    m_bConverted = false;
    m_bSaved = false;
    return 1;
}

// A motion file does not reset the container flag: after a container has been opened, its scene remains the
// source.
bool CGaitConvertContent::LoadSource(const std::string& path)
{
    if (!HasExtension(path, kSceneExtension))
        return LoadMotion(m_kSourceMotion, path);
    CFailureRecord record;
    const bool loaded = LoadSourceScene(path, m_spkSourceScene, record, ProgressOf("Opening"));
    Notify(path, record);
    m_bSourceIsContainer = m_bSourceIsContainer || loaded;
    return loaded;
}

bool CGaitConvertContent::LoadMotion(CMotionFile& motion, const std::string& path)
{
    motion.SetProgress(ProgressOf("Opening"));
    const bool loaded = motion.Load(path);
    Notify(path, motion.Record());
    return loaded;
}

// Shows the loaded source, loads the target skeleton twice, and passes all three to the profile editor.
void CGaitConvertContent::ShowSource()
{
    ClearMarks();
    CNode* const root = SourceRoot();
    m_kOrigin.reset();
    m_kResultFile.clear();
    if (m_bSourceIsContainer)
        AttachBoneMeshes(root);
    m_kNextSteps.FindUp(root, Timing());
    m_kNextSteps.SetUndraftable(false);
    SetScene(m_pkSourceView.get(), root,
             m_bSourceIsContainer ? TimingOf(PreviewTrack(root)) : TimingOf(m_kSourceMotion));
    LoadMotion(m_kBaseMotion, BaseFile());
    LoadResult();
    if (m_pkProfile)
    {
        m_pkProfile->SetSourceScene(root);
        m_pkProfile->SetTargetScene(m_kBaseMotion.motionRoot.Get());
        m_pkProfile->SetResultScene(m_kResultMotion.motionRoot.Get());
    }
    SetScene(m_pkResultView.get(), nullptr, {});
}

CNode* CGaitConvertContent::SourceRoot() const
{
    return m_bSourceIsContainer ? FirstNode(m_spkSourceScene.GetRoot(0)) : m_kSourceMotion.motionRoot.Get();
}

SourceTiming CGaitConvertContent::Timing() const
{
    return m_bSourceIsContainer ? TimingOf(ConversionTrack(SourceRoot())) : TimingOf(m_kSourceMotion);
}

std::string CGaitConvertContent::SourceFolder() const
{
    return platform_.ReadSetting(kFolderSetting);
}

void CGaitConvertContent::RememberFolder(const std::string& path)
{
    platform_.WriteSetting(kFolderSetting, SplitPath(path).folder);
}

std::string CGaitConvertContent::Message(int id) const
{
    std::string text;
    m_kResources.LoadResString(id, text);
    return text;
}

EAnswer CGaitConvertContent::ShowMessage(int id, EButtons buttons, std::span<const int> numbers)
{
    std::vector<std::string> arguments;
    for (const int number : numbers)
        arguments.push_back(std::to_string(number));
    return window_.ShowMessageBox(id, FormatText(Message(id), arguments), buttons);
}

void CGaitConvertContent::SetTitle(const std::string& text)
{
    m_kTitle = text;
    ShowTitle(text);
}

void CGaitConvertContent::ShowTitle(const std::string& text)
{
    const std::string product = Message(kTitleMessage);
    window_.SetChildText("#title", text.empty() ? product : product + " - " + text);
}

void CGaitConvertContent::Notify(const std::string& path, const CFailureRecord& record)
{
    NotifyOfRecord(path, record, m_kChoices, [this](const Notice& notice) { window_.Notify(notice); });
}

} // namespace gw
