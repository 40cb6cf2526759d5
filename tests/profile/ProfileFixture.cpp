#include "ProfileFixture.h"

#include "Paths.h"
#include "Text.h"

#include <filesystem>

namespace gw {

EAnswer CScriptedOwner::ShowMessage(int id, EButtons, std::span<const int> numbers)
{
    std::string message = std::to_string(id);
    for (const int number : numbers)
        message += ' ' + std::to_string(number);
    m_kMessages.push_back(message);
    return m_eAnswer;
}

std::string CScriptedOwner::FindProfilePath(const std::string& name)
{
    for (const std::string& file : FilesInFolder(ProfileFile(""), ".prf"))
    {
        if (EqualNoCase(ReadProfileName(ProfileFile(file)), name))
            return ProfileFile(file);
    }
    return {};
}

bool CScriptedOwner::RunBoneOffset(CBoneOffsetDialog& dialog)
{
    return boneOffset && boneOffset(dialog);
}

Ref<CNode> MakeChain(const std::vector<std::string>& names)
{
    Ref<CNode> root;
    CNode* parent = nullptr;
    for (const std::string& name : names)
    {
        Ref<CNode> bone(new CNode);
        bone->SetName(name.c_str());
        if (parent)
            parent->AttachChild(bone.Get());
        else
            root = bone;
        parent = bone.Get();
    }
    return root;
}

std::string RowText(const CMapRowTable& rows, int row)
{
    std::string text = rows.Text(row, 0);
    for (int column = 1; column < kMapColumnCount; ++column)
        text += '|' + rows.Text(row, column);
    return text;
}

std::vector<std::string> RowTexts(const CMapRowTable& rows)
{
    std::vector<std::string> texts;
    texts.reserve(size_t(rows.RowCount()));
    for (int row = 0; row < rows.RowCount(); ++row)
        texts.push_back(RowText(rows, row));
    return texts;
}

namespace {

std::string Verdict(bool fits, int matched, int total)
{
    return std::to_string(matched) + " of " + std::to_string(total) + (fits ? ", fits" : ", misfit");
}

} // namespace

ProfileEditor::ProfileEditor()
    : m_spkSource(MakeChain({"A", "B", "C"})),
      m_spkTarget(MakeChain({"LowerTorso", "Waist", "Head", "LPelvis", "RPelvis"}))
{
    m_kEditor.SetSourceScene(m_spkSource.Get());
    m_kEditor.SetTargetScene(m_spkTarget.Get());
    m_kEditor.SetResultScene(m_spkTarget.Get());
    m_kEditor.SetNamesInUse(&m_kNamesInUse);
}

std::string ProfileEditor::MakeProfile(const std::string& text, const std::string& name)
{
    std::string path = m_kOwner.ProfileFile(name);
    WriteBytes(path, text);
    return path;
}

void ProfileEditor::MakeReadOnly(const std::string& path)
{
    namespace fs = std::filesystem;
    fs::permissions(path, fs::perms::owner_read);
}

void ProfileEditor::SetField(int field, const std::string& text)
{
    m_kEditor.EditField(field, text);
    m_kEditor.LeaveField();
}

void ProfileEditor::SelectBones(const std::string& source, const std::string& target)
{
    m_kEditor.SelectSourceItem(m_kEditor.FindSourceItem(source));
    m_kEditor.SelectTargetItem(m_kEditor.FindTargetItem(target));
}

std::string ProfileEditor::Count(const std::string& path)
{
    int matched = -1;
    int total = -1;
    const bool fits = m_kEditor.CountMatches(path, &matched, &total);
    return Verdict(fits, matched, total);
}

std::string ProfileEditor::Apply()
{
    int matched = -1;
    int total = -1;
    const bool fits = m_kEditor.ApplyProfile(nullptr, &matched, &total);
    return Verdict(fits, matched, total);
}

std::string ProfileEditor::Name() const
{
    std::string name;
    m_kEditor.GetProfileName(name);
    return name;
}

} // namespace gw
