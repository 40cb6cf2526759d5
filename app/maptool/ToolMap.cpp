// The map tool's buttons that change the list of lines.

#include "CGaitToolDialog.h"

#include "SystemError.h"
#include "ToolStatus.h"

namespace gw {

namespace {

const FileDialogSetup kOpenMap{{}, "Map Files |*.prf;|Nap Files |*.txt;||", {}};
const FileDialogSetup kSaveMap{"txt", "Map Files |*.txt;||", {}};

void UnmarkAll(CBoneTree& tree)
{
    for (size_t item = 0; item < tree.Items().size(); ++item)
        tree.Mark(static_cast<int>(item), false);
}

} // namespace

bool CGaitToolDialog::IsMappable(const MapLine& line) const
{
    return m_kSourceTree.Find(line.source) != CBoneTree::kNone &&
           m_kTargetTree.Find(line.target) != CBoneTree::kNone;
}

// Markers are derived from the lines, so a bone loses its marker with the last line that names it.
void CGaitToolDialog::MarkBones()
{
    UnmarkAll(m_kSourceTree);
    UnmarkAll(m_kTargetTree);
    for (const MapLine& line : m_kMap.Lines())
    {
        if (line.kind != EMapLine::Mapping)
            continue;
        m_kSourceTree.Mark(m_kSourceTree.Find(line.source), true);
        m_kTargetTree.Mark(m_kTargetTree.Find(line.target), true);
    }
}

void CGaitToolDialog::SelectLine(int index)
{
    m_kMap.Select(index);
    const MapLine* const line = m_kMap.SelectedLine();
    if (!line || line->kind != EMapLine::Mapping)
        return;
    m_kSourceTree.Select(m_kSourceTree.Find(line->source));
    m_kTargetTree.Select(m_kTargetTree.Find(line->target));
}

void CGaitToolDialog::AddToMap()
{
    const std::string& source = m_kSourceTree.SelectedText();
    const std::string& target = m_kTargetTree.SelectedText();
    m_kStatus.clear();
    if (source.empty() || target.empty())
        m_kStatus = "Select a bone in both trees first";
    else
        m_kMap.Add(source, target);
    MarkBones();
}

void CGaitToolDialog::RemoveLine()
{
    m_kMap.RemoveSelected();
    SelectLine(m_kMap.Selected());
    MarkBones();
}

void CGaitToolDialog::RemoveAllLines()
{
    m_kMap.Clear();
    MarkBones();
}

void CGaitToolDialog::EditDetail()
{
    MapLine line = *m_kMap.SelectedLine();
    if (!window_.EditLine(line))
        return;
    m_kMap.ReplaceSelected(RewrittenLine(line));
    MarkBones();
}

void CGaitToolDialog::AskMap()
{
    if (const auto path = window_.AskOpenFile(kOpenMap))
        LoadMap(*path);
}

bool CGaitToolDialog::LoadMap(const std::string& path)
{
    std::vector<MapLine> lines;
    if (!ReadMapLines(path, lines))
    {
        m_kStatus = NoMapWords(path);
        return false;
    }
    const size_t leftOut = m_kMap.Replace(lines, [this](const MapLine& line) { return IsMappable(line); });
    MarkBones();
    m_kStatus = MapWords(path, m_kMap.Lines().size(), leftOut);
    return true;
}

void CGaitToolDialog::AskMapPath()
{
    if (const auto path = window_.AskSaveFile(kSaveMap))
        SaveMap(*path);
}

bool CGaitToolDialog::SaveMap(const std::string& path)
{
    const bool written = WriteMapLines(path, m_kMap.Lines());
    const Finding failure{.reason = EFailure::WriteError, .systemError = written ? 0 : TakeSystemError()};
    m_kStatus = written ? SavedWords(path) : NotSavedWords(path, failure);
    return written;
}

} // namespace gw
