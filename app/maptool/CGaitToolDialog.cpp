// The map tool's state machine, without its window. Each operation either succeeds completely or leaves
// motions, trees and lines as they were, and ends by setting the status line.

#include "CGaitToolDialog.h"

#include "CPlatform.h"
#include "CProfileEditorDialog.h"
#include "CRetargeter.h"
#include "CWaitCursor.h"
#include "FindBone.h"
#include "HostBones.h"
#include "Paths.h"
#include "ProfileFile.h"
#include "SourceTiming.h"
#include "Text.h"
#include "ToolStatus.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

constexpr const char* kBaseFile = "base.htr";
// One frame in sixty is saved, as the tool has always done; the user is told.
constexpr float kSavedScale = 0.016667f;
constexpr const char* kSavedNote = ", every sixtieth frame";
constexpr const char* kPelvisNote =
    "; the pelvis bones take a share of the legs' rotation, because the map has "
    "no lines \"* LPelvis\" and \"* RPelvis\"";

const FileDialogSetup kOpenMotion{"htr", "Anm Files (*.bvh;*.htr) |*.bvh;*.htr||", {}};
const FileDialogSetup kSaveMotion{"htr", "Anm Files (*.htr;*.bvh) |*.htr;*.bvh||", {}};

constexpr void (CMotionView::*kTransport[])() = {
    &CMotionView::SeekStart, &CMotionView::StepBack,    &CMotionView::Stop,
    &CMotionView::Play,      &CMotionView::StepForward,
};

// Shows the tree of another skeleton, keeping the selected bone if one with that name exists.
void Rebuild(CBoneTree& tree, CNode* root)
{
    const std::string selected = tree.SelectedText();
    tree.Rebuild(root);
    tree.Select(tree.Find(selected));
}

} // namespace

struct CGaitToolDialog::Command
{
    int m_iControl;
    void (CGaitToolDialog::*m_pkRun)();
    bool (CGaitToolDialog::*m_pkEnabled)() const;
};

const CGaitToolDialog::Command* CGaitToolDialog::FindCommand(int id)
{
    using Tool = CGaitToolDialog;
    static constexpr Command kCommands[] = {
        {kToolClose,      &Tool::Close,          &Tool::Always         },
        {kToolLoadSource, &Tool::AskSource,      &Tool::Always         },
        {kToolLoadTarget, &Tool::AskTarget,      &Tool::Always         },
        {kToolAddToMap,   &Tool::AddToMap,       &Tool::HasBothTrees   },
        {kToolLoadMap,    &Tool::AskMap,         &Tool::HasBothTrees   },
        {kToolDelete,     &Tool::RemoveLine,     &Tool::HasLines       },
        {kToolDeleteAll,  &Tool::RemoveAllLines, &Tool::HasLines       },
        {kToolSaveMap,    &Tool::AskMapPath,     &Tool::HasLines       },
        {kToolConvert,    &Tool::Convert,        &Tool::HasLines       },
        {kToolDetail,     &Tool::EditDetail,     &Tool::HasSelectedLine},
        {kToolSaveResult, &Tool::AskResultPath,  &Tool::HasTarget      },
    };
    const auto* const found = std::ranges::find(kCommands, id, &Command::m_iControl);
    return found == std::end(kCommands) ? nullptr : found;
}

CGaitToolDialog::CGaitToolDialog(CToolWindow& window, const CPlatform& platform)
    : window_(window), platform_(platform), m_kSourceTree(CProfileEditorDialog::kMappedSourceImage),
      m_kTargetTree(CProfileEditorDialog::kMappedTargetImage)
{
}

CGaitToolDialog::~CGaitToolDialog() = default;

void CGaitToolDialog::OnInitDialog()
{
    for (const EToolMotion motion : kToolMotions)
        m_kViews[Index(motion)] = window_.CreateView(motion);
}

// ---- buttons

void CGaitToolDialog::ClickButton(int id)
{
    const Command* const command = FindCommand(id);
    if (command && IsEnabled(id))
        (this->*command->m_pkRun)();
    else if (!command)
        ClickTransport(id);
}

bool CGaitToolDialog::IsEnabled(int id) const
{
    const Command* const command = FindCommand(id);
    return !command || (this->*command->m_pkEnabled)();
}

void CGaitToolDialog::ClickTransport(int id)
{
    for (const EToolMotion motion : kToolMotions)
    {
        const auto& ids = kTransportIds[Index(motion)];
        const auto* const found = std::ranges::find(ids, id);
        if (found != std::end(ids) && View(motion))
            (View(motion)->*kTransport[found - ids])();
    }
}

bool CGaitToolDialog::Advance()
{
    for (const auto& view : m_kViews)
    {
        if (view)
            view->Advance();
    }
    return IsPlaying();
}

bool CGaitToolDialog::IsPlaying() const
{
    return std::ranges::any_of(m_kViews, [](const auto& view) { return view && view->IsPlaying(); });
}

int CGaitToolDialog::FrameOf(EToolMotion motion) const
{
    const CMotionView* const view = View(motion);
    if (!view || !(view->GetFrameStep() > 0.0f))
        return 0;
    return CutToInteger(std::round(view->GetTime() / view->GetFrameStep()));
}

int CGaitToolDialog::LastFrameOf(EToolMotion motion) const
{
    return View(motion) ? std::max(CutToInteger(View(motion)->GetLastFrame()), 0) : 0;
}

// ---- motions

void CGaitToolDialog::AskSource()
{
    if (const auto path = window_.AskOpenFile(kOpenMotion))
        LoadSource(*path);
}

void CGaitToolDialog::AskTarget()
{
    if (const auto path = window_.AskOpenFile(kOpenMotion))
        LoadTarget(*path);
}

bool CGaitToolDialog::TakesFile(const std::string& path)
{
    return HasExtension(path, ".bvh") || HasExtension(path, ".htr");
}

bool CGaitToolDialog::DropFile(EToolMotion motion, const std::string& path)
{
    switch (motion)
    {
    case EToolMotion::Source:
        return LoadSource(path);
    case EToolMotion::Target:
        return LoadTarget(path);
    case EToolMotion::Result:
        break;
    }
    return false;
}

bool CGaitToolDialog::LoadSource(const std::string& path)
{
    const CWaitCursor wait(window_);
    if (!Load(EToolMotion::Source, path))
        return false;
    // The target is loaded from now on. If it cannot be read, that is the first thing the user must know.
    const std::string loaded = m_kStatus;
    if (LoadTargetMotions(platform_.DataFolder() + kBaseFile))
        m_kStatus = loaded;
    TakeSkeletons();
    return true;
}

bool CGaitToolDialog::LoadTarget(const std::string& path)
{
    const CWaitCursor wait(window_);
    if (!LoadTargetMotions(path))
        return false;
    TakeSkeletons();
    return true;
}

bool CGaitToolDialog::LoadTargetMotions(const std::string& path)
{
    if (!Load(EToolMotion::Result, path) || !Load(EToolMotion::Target, path))
        return false;
    m_kTargetPath = path;
    return true;
}

// Reads into a new motion file: an existing one would keep its previous rest pose if the new file has none.
bool CGaitToolDialog::Load(EToolMotion motion, const std::string& path)
{
    CMotionFile file;
    if (!file.Load(path))
    {
        m_kStatus = FailedWords(path, file.Record().Failure());
        return false;
    }
    CMotionFile& taken = m_kMotions[Index(motion)];
    taken.restRoot = file.restRoot;
    taken.motionRoot = file.motionRoot;
    taken.fileVersion = file.fileVersion;
    m_bConverted = m_bConverted && motion != EToolMotion::Result;
    m_kStatus = LoadedWords(path, file, file.Record());
    ShowMotion(motion);
    return true;
}

void CGaitToolDialog::ShowMotion(EToolMotion motion)
{
    const SourceTiming timing = TimingOf(Motion(motion));
    if (View(motion))
        View(motion)->SetScene(Root(motion), timing.FrameStep(), timing.lastFrame);
}

// Shows the new skeletons' trees, and removes lines that no longer fit.
void CGaitToolDialog::TakeSkeletons()
{
    Rebuild(m_kSourceTree, Root(EToolMotion::Source));
    Rebuild(m_kTargetTree, Root(EToolMotion::Target));
    m_kStatus += PrunedWords(m_kMap.Prune([this](const MapLine& line) { return IsMappable(line); }));
    MarkBones();
}

void CGaitToolDialog::Convert()
{
    const CWaitCursor wait(window_);
    for (const EToolMotion motion : kToolMotions)
    {
        if (View(motion))
            View(motion)->Stop();
    }
    // A conversion leaves its own rest pose behind, which the next one must not use.
    if (m_bConverted && !Load(EToolMotion::Result, m_kTargetPath))
        return;
    CRetargeter retargeter;
    retargeter.SetScenes(Root(EToolMotion::Source), Root(EToolMotion::Result));
    const CBoneNames sources(Root(EToolMotion::Source));
    const CBoneNames targets(Root(EToolMotion::Result));
    for (const MapLine& line : m_kMap.Lines())
        ApplyLine(retargeter, line, sources, targets);
    const SourceTiming timing = TimingOf(Motion(EToolMotion::Source));
    retargeter.Retarget(0.0f, timing.lastFrame, 0.0f, timing.frequency, m_kMap.RootPosition(), false, false);
    ShowMotion(EToolMotion::Result);
    m_bConverted = true;
    m_kStatus = ConvertedWords(Motion(EToolMotion::Result), retargeter.Record());
    if (IsPelvisFree(targets))
        m_kStatus += kPelvisNote;
}

// Bone maps of the editor fix both pelvis bones; maps that are made here need not.
bool CGaitToolDialog::IsPelvisFree(const CBoneNames& targets) const
{
    return std::ranges::any_of(kPelvisBones, [&](std::string_view bone) {
        const auto fixes = [&](const MapLine& line) {
            return line.kind == EMapLine::Fixed && EqualNoCase(line.target, bone);
        };
        return targets.Find(bone) && std::ranges::none_of(m_kMap.Lines(), fixes);
    });
}

// A missing bone is null, which the retargeter treats as no bone.
void CGaitToolDialog::ApplyLine(CRetargeter& retargeter, const MapLine& line, const CBoneNames& sources,
                                const CBoneNames& targets)
{
    m_kMap.TakeValue(line);
    if (line.kind == EMapLine::Fixed)
        retargeter.SetFixed(targets.Find(line.target), true);
    if (line.kind != EMapLine::Mapping)
        return;
    CNode* const target = targets.Find(line.target);
    retargeter.SetSourceOf(target, sources.Find(line.source));
    if (line.hasRotation)
        retargeter.SetOffsetAngles(target, line.numbers);
}

void CGaitToolDialog::AskResultPath()
{
    if (const auto path = window_.AskSaveFile(kSaveMotion))
        SaveResult(*path);
}

bool CGaitToolDialog::SaveResult(const std::string& path)
{
    const CWaitCursor wait(window_);
    CMotionFile& result = m_kMotions[Index(EToolMotion::Result)];
    const bool saved = result.Save(path, kSavedScale);
    m_kStatus = saved ? SavedWords(path) + kSavedNote : NotSavedWords(path, result.Record().Failure());
    return saved;
}

} // namespace gw
