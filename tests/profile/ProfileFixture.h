#pragma once

#include "CBoneOffsetDialog.h"
#include "CNode.h"
#include "CProfileEditorDialog.h"
#include "TempFolder.h"

#include <functional>
#include <gtest/gtest.h>
#include <string>
#include <vector>

namespace gw {

/// A scripted owner for the editor that records requests. Its two profile folders are in one temporary
/// folder.
class CScriptedOwner : public CProfileOwner
{
public:
    EAnswer ShowMessage(int id, EButtons buttons, std::span<const int> numbers) override;
    void ProfileStateChanged() override { ++m_iStateChanges; }
    void ProfileSetChanged() override { ++m_iSetChanges; }
    std::string FindProfilePath(const std::string& name) override;
    std::string ProfileFile(const std::string& name) override { return m_kFolder.Path(name); }
    std::string ExeFile(const std::string& name) override { return m_kFolder.Path(name); }
    bool RunBoneOffset(CBoneOffsetDialog& dialog) override;

    /// Returns the messages since the last call, as "157 OK -10000 10000".
    std::vector<std::string> TakeMessages() { return std::exchange(m_kMessages, {}); }

    CTempFolder m_kFolder;
    EAnswer m_eAnswer = EAnswer::OK;
    std::function<bool(CBoneOffsetDialog&)> boneOffset; ///< user actions in the offset dialog
    int m_iStateChanges = 0;
    int m_iSetChanges = 0;

private:
    std::vector<std::string> m_kMessages;
};

/// Returns a chain of bones, each the parent of the next.
Ref<CNode> MakeChain(const std::vector<std::string>& names);

/// Returns a row as "source|target|rx|ry|rz|x|y|z".
std::string RowText(const CMapRowTable& rows, int row);
std::vector<std::string> RowTexts(const CMapRowTable& rows);

/// An editor with a scripted owner, a source with bones A, B, C and a target with LowerTorso, Waist, Head and
/// the pelvis bones.
class ProfileEditor : public testing::Test
{
protected:
    ProfileEditor();
    /// Writes a profile file and returns its path.
    std::string MakeProfile(const std::string& text, const std::string& name = "Test.prf");
    /// Writes and loads a profile.
    bool Load(const std::string& text) { return m_kEditor.LoadProfile(MakeProfile(text)); }
    void MakeReadOnly(const std::string& path);
    /// Types into a field and leaves it.
    void SetField(int field, const std::string& text);
    void SelectBones(const std::string& source, const std::string& target);
    /// Returns the matches of a file, as "1 of 2, fits" or "1 of 2, misfit".
    std::string Count(const std::string& path);
    /// Applies the profile without a retargeter; returns "3 of 4, fits" or "3 of 4, misfit".
    std::string Apply();
    std::string Name() const;

    CScriptedOwner m_kOwner;
    Ref<CNode> m_spkSource;
    Ref<CNode> m_spkTarget;
    std::vector<std::string> m_kNamesInUse;
    CProfileEditorDialog m_kEditor{m_kOwner};
};

} // namespace gw
