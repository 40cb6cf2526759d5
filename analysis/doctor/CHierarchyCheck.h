#pragma once

#include "BVHOutline.h"
#include "CLineCursor.h"

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

class CFindings;
class CTextEdits;

/// Reads the hierarchy of a BVH text as a person would: anything the strict reader refuses is understood if
/// possible, reported as a finding, and repaired by an edit of the text.
class CHierarchyCheck
{
public:
    CHierarchyCheck(CLineCursor& lines, CFindings& findings, CTextEdits& edits)
        : lines_(lines), findings_(findings), edits_(edits)
    {
    }

    /// Fills the outline's joints and leaves the cursor on the line "MOTION". Returns false if that line is
    /// missing.
    bool Read(BVHOutline& outline);

private:
    struct KeywordRow;
    struct Block
    {
        size_t joint; // kNoParent if it creates no joint
        bool braced = false;
    };
    struct SharedLine
    {
        size_t line;
        size_t offset; // of the words that need their own line
    };
    static const KeywordRow kKeywords[];

    void ReadLine();
    void PartLines();
    void ReadWords(std::string_view words);
    void BeginHierarchy(std::string_view) { m_bHierarchy = true; }
    void BeginMotion(std::string_view) { m_bMotion = m_bHierarchy; }
    void OpenRoot(std::string_view name);
    void OpenJoint(std::string_view name);
    void OpenEndSite(std::string_view) { m_kOpen.push_back({OutlineJoint::kNoParent}); }
    void OpenBlock(std::string_view);
    void CloseBlock(std::string_view);
    void ReadOffset(std::string_view numbers);
    void ReadChannels(std::string_view rest);
    void CheckChannel(std::string_view word, int channel);

    void Add(std::string_view name, size_t parent);
    std::string ReadName(std::string_view name);
    void CheckSpelling(std::string_view word, std::string_view wanted);
    void PlanColumns(BVHOutline& outline);
    OutlineJoint* Joint();

    CLineCursor& lines_;
    CFindings& findings_;
    CTextEdits& edits_;
    std::vector<OutlineJoint> m_kJoints;
    std::vector<Block> m_kOpen;
    std::vector<SharedLine> m_kShared;
    bool m_bBracesFit = true;
    size_t m_uiRoots = 0;
    bool m_bHierarchy = false;
    bool m_bMotion = false;
};

} // namespace gw
