// Bone maps: loading, choosing and drafting them.

#include "MapContent.h"

#include "CMapRowTable.h"
#include "DoubtWords.h"
#include "DraftedProfile.h"
#include "FindingWords.h"
#include "Paths.h"
#include "ProfileFile.h"
#include "SuggestProfile.h"
#include "SystemError.h"
#include "Writing.h"

#include <algorithm>
#include <span>

namespace gaitwright {

namespace {

MapRow RowOf(const gw::CMapRowTable& rows, int row)
{
    const gw::RowNumbers numbers = rows.Numbers(row);
    MapRow result;
    result.target = rows.Text(row, gw::kTargetColumn);
    if (rows.IsFixed(row))
        return result;
    result.source = rows.Text(row, gw::kSourceColumn);
    result.rotation = numbers.rotation;
    std::ranges::copy(numbers.axes, result.axes.begin());
    return result;
}

Failure BadMap(const std::string& path)
{
    return FailureOf(
        gw::MakeNotice(path, {.reason = gw::EFailure::BadProfile, .systemError = gw::TakeSystemError()}));
}

// Runs a function with the conversion of a motion that a map is wanted for.
template <class Value, class Function>
Outcome<Value> WithConversion(const Motion& motion, const std::string& dataFolder, Function run) noexcept
{
    return Guarded([&]() -> Outcome<Value> {
        const std::lock_guard lock(Access::Of(motion).mutex);
        CMotionConversion conversion(dataFolder, {}, {}, false);
        if (!conversion.Open(motion))
            return conversion.Notices().FirstError();
        return run(conversion);
    });
}

SuggestedRow RowOf(const gw::SuggestedRow& row)
{
    SuggestedRow result;
    result.row.target = row.target;
    result.kind = gw::RowKindCode(row.kind);
    if (row.kind != gw::ESuggestedRow::Fixed)
        result.joint = gw::PlaceWords(row.place);
    if (row.source)
        result.row.source = row.source->NameView();
    if (!row.IsMapping())
        return result;
    result.row.rotation = row.numbers.rotation;
    std::ranges::copy(row.numbers.axes, result.row.axes.begin());
    result.sureness = gw::RowSurenessName(row.sureness);
    result.evidence = gw::EvidenceCode(row.evidence);
    for (const gw::EDoubt doubt : row.doubts)
        result.doubts.emplace_back(gw::DoubtCode(doubt));
    result.restError = row.restError;
    return result;
}

Outcome<Suggestion> SuggestFor(CMotionConversion& conversion, const std::string& path)
{
    const gw::SuggestedProfile draft =
        gw::SuggestProfile(*conversion.SourceRoot(), *conversion.Result().motionRoot);
    std::string why = gw::WhyNotSure(draft);
    if (!draft.missing.empty())
        return FailureOf(gw::MakeNotice(path, "no-body", why));
    const std::string text = gw::DraftText(draft, gw::SplitPath(path).stem, conversion.SourceRoot());
    Suggestion suggestion{.map = MapOf({}, gw::RowsOfText(text)),
                          .rows = {},
                          .sure = why.empty(),
                          .whyNotSure = why,
                          .sidesAreSure = draft.sidesAreSure,
                          .restIsStance = draft.restIsStance};
    for (const gw::SuggestedRow& row : draft.rows)
        suggestion.rows.push_back(RowOf(row));
    return suggestion;
}

} // namespace

BoneMap MapOf(const std::string& path, gw::ProfileRows profile)
{
    auto content = std::make_shared<Access::MapContent>();
    content->path = path;
    content->profile = std::move(profile);
    for (int row = 0; row < content->profile.rows.RowCount(); ++row)
        content->rows.push_back(RowOf(content->profile.rows, row));
    return Access::Make(std::shared_ptr<const Access::MapContent>(std::move(content)));
}

MapChoice ChoiceOf(const gw::ProfileChoice& choice)
{
    static_assert(static_cast<int>(Sureness::Doubtful) == static_cast<int>(gw::ESureness::Doubtful));
    const bool fits = choice.match.IsWhole();
    return {.map = MapOf(choice.path, choice.profile),
            .fits = fits,
            .rowCount = static_cast<size_t>(choice.match.rowCount),
            .foundCount = static_cast<size_t>(choice.match.foundCount),
            .adapted = choice.adapted,
            .sureness = fits ? static_cast<Sureness>(choice.verdict.sureness) : Sureness::Doubtful,
            .doubts = gw::DoubtWords(choice.verdict)};
}

CMotionConversion::CMotionConversion(const std::string& dataFolder, const std::string& mapName,
                                     const gw::ConversionChoices& choices, bool mayDraft)
    : CChoosingConversion(dataFolder, mapName, choices,
                          [this](const gw::Notice& notice) { m_kNotices.Add(notice); }),
      m_bMayDraft(mayDraft)
{
}

bool CMotionConversion::Open(const Motion& motion)
{
    UseSource(motion.Path(), Access::Of(motion).source);
    return LoadTarget();
}

bool CMotionConversion::ChooseMap()
{
    PickStockProfile();
    return SelectProfile();
}

void CMotionConversion::UseMap(const BoneMap& map)
{
    UseProfile(map.Path().empty() ? map.Name() : map.Path(), Access::Of(map).profile);
}

MapChoice CMotionConversion::Choice()
{
    if (Chosen())
        return ChoiceOf(*Chosen());
    const std::string text = gw::TextOf(Profile());
    const gw::LoadedProfile loaded[] = {
        {ProfilePath(), text}
    };
    const std::vector<gw::ProfileChoice> choices = gw::ChooseProfile(loaded, SourceNames(), TargetNames());
    MapChoice choice = choices.empty() ? MapChoice{.map = MapOf({}, {})} : ChoiceOf(choices.front());
    choice.map = MapOf(ProfilePath(), Profile());
    return choice;
}

// In memory: the draft belongs to this conversion.
bool CMotionConversion::UseDraft()
{
    if (!m_bMayDraft)
        return false;
    const Outcome<Suggestion> draft = SuggestFor(*this, SourcePath());
    m_kWhyNoDraft = draft ? draft->whyNotSure : draft.Error().words;
    m_bDrafted = m_kWhyNoDraft.empty();
    if (!m_bDrafted)
        return false;
    UseMap(draft->map);
    if (const std::optional<gw::Notice> warning = gw::RateWarning(SourcePath(), SourceRoot()))
        Notify(*warning);
    return true;
}

void CMotionConversion::NotifyOfNone(const gw::Notice& notice) const
{
    gw::Notice full = notice;
    if (!m_kWhyNoDraft.empty())
        full.words += "\n  no draft was used: " + m_kWhyNoDraft;
    Notify(full);
}

BoneMap::BoneMap(std::shared_ptr<const Content> content) noexcept : m_spContent(std::move(content)) {}
BoneMap::BoneMap(const BoneMap& other) noexcept = default;
BoneMap& BoneMap::operator=(const BoneMap& other) noexcept = default;
BoneMap::~BoneMap() = default;

const std::string& BoneMap::Name() const noexcept
{
    return m_spContent->profile.name;
}

const std::string& BoneMap::Path() const noexcept
{
    return m_spContent->path;
}

int BoneMap::FrameRate() const noexcept
{
    return m_spContent->profile.frameRate;
}

std::span<const MapRow> BoneMap::Rows() const noexcept
{
    return m_spContent->rows;
}

Outcome<std::string> BoneMap::Text() const noexcept
{
    return Guarded([&]() -> Outcome<std::string> { return gw::TextOf(m_spContent->profile); });
}

Outcome<void> BoneMap::Save(const std::string& path, Existing existing) const noexcept
{
    return Guarded([&] {
        return WriteFile(path, existing, [&](const std::string& to) {
            return WriteText(
                to, [&](const gw::CTextSink& send) { return send(gw::TextOf(m_spContent->profile)); });
        });
    });
}

Outcome<BoneMap> LoadMap(const std::string& nameOrPath, const std::string& dataFolder) noexcept
{
    return Guarded([&]() -> Outcome<BoneMap> {
        CMotionConversion conversion(dataFolder, {}, {}, false);
        const std::string path = conversion.ResolveProfile(nameOrPath);
        if (path.empty())
            return conversion.Notices().FirstError();
        gw::ProfileRows profile;
        if (!gw::ReadProfileRows(path, profile))
            return BadMap(path);
        return MapOf(path, std::move(profile));
    });
}

Outcome<BoneMap> ParseMap(std::string_view text) noexcept
{
    return Guarded([&]() -> Outcome<BoneMap> {
        if (text.size() > gw::kProfileByteLimit)
            return BadMap({});
        return MapOf({}, gw::RowsOfText(text));
    });
}

Outcome<std::vector<BoneMap>> InstalledMaps(const std::string& dataFolder) noexcept
{
    return Guarded([&]() -> Outcome<std::vector<BoneMap>> {
        CMotionConversion conversion(dataFolder, {}, {}, false);
        std::vector<BoneMap> maps;
        for (const gw::InstalledProfile& profile : conversion.InstalledProfiles())
        {
            if (profile.text)
                maps.push_back(MapOf(profile.path, gw::RowsOfText(*profile.text)));
        }
        return maps;
    });
}

Outcome<std::vector<MapChoice>> RankMaps(const Motion& motion, const std::string& dataFolder) noexcept
{
    return WithConversion<std::vector<MapChoice>>(motion, dataFolder, [](CMotionConversion& conversion) {
        conversion.PickStockProfile();
        std::vector<MapChoice> choices;
        for (const gw::ProfileChoice& choice : conversion.Choices())
            choices.push_back(ChoiceOf(choice));
        return Outcome<std::vector<MapChoice>>(std::move(choices));
    });
}

Outcome<MapChoice> ChooseMap(const Motion& motion, const std::string& dataFolder) noexcept
{
    return WithConversion<MapChoice>(motion, dataFolder, [](CMotionConversion& conversion) {
        return conversion.ChooseMap() ? Outcome<MapChoice>(conversion.Choice())
                                      : Outcome<MapChoice>(conversion.Notices().FirstError());
    });
}

Outcome<Suggestion> Suggest(const Motion& motion, const std::string& dataFolder) noexcept
{
    return WithConversion<Suggestion>(motion, dataFolder, [&](CMotionConversion& conversion) {
        return SuggestFor(conversion, motion.Path());
    });
}

const char* SurenessName(Sureness sureness) noexcept
{
    return gw::SurenessName(static_cast<gw::ESureness>(sureness));
}

} // namespace gaitwright
