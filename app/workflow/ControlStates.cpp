// Which child is enabled when. Each condition is a bit, and a child's row lists the bits that it needs.

#include "CBoneMapProfile.h"
#include "CCntComboExControl.h"
#include "CContentWindow.h"
#include "CGaitConvertContent.h"
#include "CProfileEditorDialog.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

enum EFact : uint32_t
{
    kSource = 1 << 0, // a source with keys, or one from a container, is open
    kSourcePlays = 1 << 1,
    kSourceMoved = 1 << 2, // its view is not at the start
    kSourceAhead = 1 << 3, // its view is before the end
    kSourceLong = 1 << 4,  // it has more than one frame, or is from a container
    kBase = 1 << 5,        // the target skeleton is loaded
    kConverted = 1 << 6,
    kResult = 1 << 7, // converted, with keys
    kResultPlays = 1 << 8,
    kResultRests = 1 << 9,
    kResultMoved = 1 << 10,
    kResultAhead = 1 << 11,
    kProfilePath = 1 << 12, // the selected profile has a file
    kSelection = 1 << 13,   // the list has a selection
    kRemovable = 1 << 14,   // it is a custom profile with a listed name
};

struct ControlRow
{
    std::string_view m_kChild;
    uint32_t m_uiNeeds;
};

constexpr ControlRow kControls[] = {
    {"play",     kSource                       },
    {"stop",     kSource | kSourcePlays        },
    {"back",     kSource | kSourceMoved        },
    {"fback",    kSource | kSourceMoved        },
    {"end",      kSource | kSourceAhead        },
    {"fend",     kSource | kSourceAhead        },
    {"play1",    kResult | kResultRests        },
    {"stop1",    kResult | kResultPlays        },
    {"start1",   kResult | kResultMoved        },
    {"PreFrm1",  kResult | kResultMoved        },
    {"end1",     kResult | kResultAhead        },
    {"NextFrm1", kResult | kResultAhead        },
    {"del",      kRemovable                    },
    {"apply",    kSource | kBase | kConverted  },
    {"convert",  kSource | kBase | kProfilePath},
    {"%adv",     kSelection                    },
    {"|playbar", kSourceLong                   },
};

// A view's clock; a missing one is at the start of an empty motion.
struct Clock
{
    explicit Clock(const CMotionView* view)
    {
        if (!view)
            return;
        m_bPlays = view->IsPlaying();
        m_fTime = view->GetTime();
        m_fEnd = view->GetLastFrame() != 0.0f ? view->GetFrameStep() * view->GetLastFrame() : 0.0f;
    }

    bool m_bPlays = false;
    float m_fTime = 0.0f;
    float m_fEnd = 0.0f;
};

uint32_t When(bool holds, uint32_t fact)
{
    return holds ? fact : 0;
}

// A motion without keys can have a negative last frame.
bool HasSeveralFrames(const CMotionFile& motion)
{
    return motion.GetKeyCount() > 0 && motion.GetLastFrame() != 0.0f;
}

int ScrollValue(const Clock& clock)
{
    const float value = clock.m_fEnd != 0.0f ? clock.m_fTime * kScrollRange / clock.m_fEnd : 0.0f;
    if (!std::isfinite(value))
        return 0;
    return static_cast<int>(std::lround(std::clamp(value, 0.0f, static_cast<float>(kScrollRange))));
}

// Returns a view's position: frame, last frame and seconds. A view's step is the reciprocal of the frame
// time.
std::string PlaceText(const CMotionView* view)
{
    if (!view || !(view->GetFrameStep() > 0.0f) || !(view->GetLastFrame() > 0.0f))
        return {};
    const float frame = std::round(view->GetTime() / view->GetFrameStep());
    const long long hundredths = std::llround(100.0f * frame / view->GetFrameStep());
    std::string text = "frame ";
    text += std::to_string(std::llround(frame)) + " of " + std::to_string(std::llround(view->GetLastFrame()));
    text += "   " + std::to_string(hundredths / 100) + (hundredths % 100 < 10 ? ".0" : ".");
    return text + std::to_string(hundredths % 100) + " s";
}

} // namespace

uint32_t CGaitConvertContent::ControlFacts() const
{
    const Clock source(m_pkSourceView.get());
    const Clock result(m_pkResultView.get());
    return When(m_bSourceIsContainer || m_kSourceMotion.GetKeyCount() > 0, kSource) |
           When(source.m_bPlays, kSourcePlays) | When(source.m_fTime != 0.0f, kSourceMoved) |
           When(source.m_fTime < source.m_fEnd, kSourceAhead) |
           When(m_bSourceIsContainer || HasSeveralFrames(m_kSourceMotion), kSourceLong) |
           When(m_kBaseMotion.GetKeyCount() > 0, kBase) | When(m_bConverted, kConverted) |
           When(m_bConverted && m_kResultMotion.GetKeyCount() > 0, kResult) |
           When(result.m_bPlays, kResultPlays) | When(!result.m_bPlays, kResultRests) |
           When(result.m_fTime != 0.0f, kResultMoved) | When(result.m_fTime < result.m_fEnd, kResultAhead) |
           ProfileFacts();
}

uint32_t CGaitConvertContent::ProfileFacts() const
{
    const CCntComboExControl& list = *m_pkProfileCombo;
    const int index = list.GetCurSel();
    const std::string* const text = list.GetItemText(index);
    return When(!m_kProfilePath.empty(), kProfilePath) | When(text, kSelection) |
           When(text && list.GetItemUserData(index) == 0 && IsListed(*text), kRemovable);
}

void CGaitConvertContent::UpdateControls()
{
    const uint32_t facts = ControlFacts();
    for (const ControlRow& row : kControls)
        window_.EnableChild(row.m_kChild, (facts & row.m_uiNeeds) == row.m_uiNeeds);
    const bool plays = (facts & kSourcePlays) != 0;
    window_.SetChildFace("play", plays ? 1 : 0);
    window_.SetChildSecondState("play", plays);
    window_.SetChildButtonState("%adv", m_pkProfileDialog && m_pkProfileDialog->IsVisible());
    window_.SetChildScrollValue("|playbar", ScrollValue(Clock(m_pkSourceView.get())));
    window_.SetChildText("#frame", PlaceText(m_pkSourceView.get()));
    ShowHighlights();
    ShowChoices();
    ShowWorstFrame();
    ShowCaptions();
}

void CGaitConvertContent::SetChoices(const ConversionChoices& choices)
{
    m_kChoices = choices;
    UpdateControls();
}

// Active options are visible without opening the menu.
void CGaitConvertContent::ShowChoices()
{
    const std::string text = ChoiceWords(m_kChoices);
    window_.SetChildFace("options", text.empty() ? 0 : 1);
    window_.SetChildTip("options", "Conversion options" + (text.empty() ? "" : ": " + text));
}

void CGaitConvertContent::ShowHighlights()
{
    if (!m_pkProfile || !m_pkSourceView || !m_pkResultView)
        return;
    std::string source, target;
    m_pkProfile->GetSelectedSourceBone(source);
    m_pkProfile->GetSelectedTargetBone(target);
    m_pkSourceView->SetHighlight(source);
    m_pkResultView->SetHighlight(target);
    m_pkSourceView->Repaint();
    m_pkResultView->Repaint();
}

} // namespace gw
