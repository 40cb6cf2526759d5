// Object ids, attachment chains, cloning and search.
//
// Cloning runs in two steps: every held object is copied, recursively, and entered in a map from source id to
// copy; then plain links in the copies are redirected to the copies of what they pointed to. A link to an
// object outside the cloned part keeps pointing to the original.

#include "CObject.h"

#include "CControl.h"
#include "CCustomData.h"
#include "CFieldArchive.h"
#include "CHTMLDump.h"
#include "CHTMLTables.h"
#include "COrrinStream.h"
#include "HTMLMarkup.h"
#include "HTMLText.h"

#include <algorithm>
#include <cstring>
#include <unordered_set>

namespace gw {

std::atomic<uint8_t> g_abObjectIDInUse[kObjectIDCount];
std::atomic<uint32_t> g_uiNextObjectID = 0;
std::atomic<uint32_t> g_uiObjectCount = 0;

const CRTTI CObject::ms_kRTTI{"CObject", nullptr};

namespace {

constexpr size_t kChainCount = 3;

std::vector<CLinkSlot> LinkSlots(CObject& object)
{
    std::vector<CLinkSlot> slots;
    CLinkVisitor visitor([&](const CLinkSlot& slot) { slots.push_back(slot); });
    object.Fields(visitor);
    return slots;
}

// Redirects plain links in a copy to the copies of their targets. Links to objects that were not cloned stay
// as they are.
void FollowCopies(CObject& copy, const CCloneMap& map)
{
    CLinkVisitor visitor([&](const CLinkSlot& slot) {
        const CObject* object = slot.IsCounted() ? nullptr : slot.Get();
        const auto found = object ? map.find(object->GetID()) : map.end();
        if (found != map.end())
            slot.Set(found->second);
    });
    copy.Fields(visitor);
}

CObject* CloneOf(CCloneMap& map, CObject* object)
{
    return object ? object->Clone(map) : nullptr;
}

// Modifier chains follow a control's next link and end at the first object that is not a modifier.
template <class F>
void ForEachModifier(CObject* head, F visit)
{
    for (CModifier* modifier = RecordCast<CModifier>(head); modifier;
         modifier = RecordCast<CModifier>(modifier->GetNext()))
        visit(*modifier);
}

// Appends the objects that an object keeps alive, in field order.
void AppendHeld(CObject& object, std::vector<CObject*>& held)
{
    CHeldCollector collector(held);
    object.Fields(collector);
}

// Returns the first match among an object and everything it keeps alive: each object before the ones it
// holds, once per place. Uses an explicit list instead of recursion, because deep graphs could exhaust the
// stack.
template <class F>
CObject* FindHeld(CObject& start, F fits)
{
    std::vector<CObject*> ahead{&start};
    while (!ahead.empty())
    {
        CObject* const object = ahead.back();
        ahead.pop_back();
        if (fits(*object))
            return object;
        const auto end = static_cast<std::ptrdiff_t>(ahead.size());
        AppendHeld(*object, ahead);
        std::reverse(ahead.begin() + end, ahead.end());
    }
    return nullptr;
}

template <class F>
void UpdateChains(CObject& object, F update)
{
    for (CControl* control = object.GetControl(); control; control = control->GetNext())
        update(*control);
    ForEachModifier(object.GetModifier(), update);
    for (CCustomData* data = object.GetCustomData(); data; data = data->GetNextData())
        update(*data);
}

} // namespace

bool IsDerivedFrom(const CObject& object, const CRTTI* record)
{
    for (const CRTTI* own = object.GetRTTI(); own; own = own->m_pkBase)
    {
        if (own == record)
            return true;
    }
    return false;
}

CObject* DynamicCast(CObject& object, const CRTTI* record)
{
    return record && IsDerivedFrom(object, record) ? &object : nullptr;
}

CObject::CObject()
{
    TakeID();
}

CObject::CObject(const CObject& source) : m_pcName(source.m_pcName)
{
    TakeID();
}

CObject::~CObject()
{
    while (m_pkWatchers)
        m_pkWatchers->Watch(nullptr);
    g_abObjectIDInUse[m_uiID].store(0, std::memory_order_relaxed);
    g_uiObjectCount.fetch_sub(1, std::memory_order_relaxed);
    m_spkCustomData = nullptr;
    m_spkModifier = nullptr;
    m_spkControl = nullptr;
}

// The cursor stays on the id just assigned: the next allocation finds it in use and skips it. If it is freed
// meanwhile, it is reused immediately.
void CObject::TakeID()
{
    constexpr auto kOrder = std::memory_order_relaxed; // ids order nothing else
    uint32_t id = g_uiNextObjectID.load(kOrder);
    while (g_abObjectIDInUse[id].load(kOrder) || g_abObjectIDInUse[id].exchange(1, kOrder))
        id = (id + 1) & (kObjectIDCount - 1);
    g_uiNextObjectID.store(id, kOrder);
    m_uiID = id;
    g_uiObjectCount.fetch_add(1, kOrder);
}

void CObject::Release()
{
    if (--m_uiRefCount == 0)
        delete this;
}

CObject* CObject::Clone(CCloneMap& map)
{
    const auto known = map.find(m_uiID);
    if (known != map.end())
        return known->second;
    CObject* copy = CreateClone();
    if (!copy)
        return nullptr;
    const bool isOutermost = map.empty();
    map[m_uiID] = copy;
    CloneHeld(map, *copy);
    // The target of a plain link can be cloned long after the link itself.
    for (auto entry = map.begin(); isOutermost && entry != map.end(); ++entry)
        FollowCopies(*entry->second, map);
    return copy;
}

void CObject::CloneHeld(CCloneMap& map, CObject& copy)
{
    copy.AttachControl(static_cast<CControl*>(CloneOf(map, m_spkControl.Get())));
    // A file can put any object at the head of the modifiers, but only a control can be attached.
    CObject* modifier = CloneOf(map, m_spkModifier.Get());
    if (!copy.AttachModifier(RecordCast<CControl>(modifier)))
        copy.m_spkModifier = modifier;
    copy.AttachCustomData(static_cast<CCustomData*>(CloneOf(map, m_spkCustomData.Get())));

    // The fields after the chains have the same position in both lists. A class whose copy starts with fewer
    // slots (a node without children) fills in the rest itself.
    const std::vector<CLinkSlot> from = LinkSlots(*this);
    const std::vector<CLinkSlot> to = LinkSlots(copy);
    for (size_t i = kChainCount; i < to.size() && i < from.size(); ++i)
        to[i].Set(from[i].IsCounted() ? CloneOf(map, from[i].Get()) : from[i].Get());
}

void CObject::Fields(CFieldArchive& archive)
{
    archive.Text("m_pcName", m_pcName);
    archive.Link("m_spkControl", m_spkControl);
    if (archive.AtLeast({1, 1}))
    {
        archive.Link("m_spkModifier", m_spkModifier);
        archive.Link("m_spkCustomData", m_spkCustomData);
    }
}

void CObject::Load(COrrinStream& stream, CLinkRecord& record)
{
    stream.ReadObject(*this, record);
}

void CObject::Link(COrrinStream& stream, CLinkRecord& record)
{
    stream.ResolveLinks(*this, record);
}

bool CObject::Register(COrrinStream& stream)
{
    if (!stream.AppendToSaveList(*this))
        return false;
    for (CObject* held : HeldObjects())
        held->Register(stream);
    return true;
}

void CObject::Save(COrrinStream& stream)
{
    stream.WriteObject(*this);
}

void CObject::DumpHTML(const std::string& folder, COrnHTMLWriter& page)
{
    CHTMLDump::AddObject(folder, page, *this);
}

void CObject::DumpTable(CHTMLTables& tables)
{
    std::string controls;
    std::unordered_set<const CControl*> shown; // chains built by hand can contain cycles
    for (CControl* control = GetControl(); control && shown.insert(control).second;
         control = control->GetNext())
    {
        controls += HTMLLineBreak() +
                    HTMLAnchor(GetHTMLFileName(*control, EHTMLPath::Relative), control->GetRTTI()->m_pcName);
        tables.Follow(*control);
    }
    tables.Begin(ms_kRTTI);
    tables.Row(kHTMLObjectName, m_pcName.IsNull() ? "NoName" : HTMLText(NameView()));
    tables.Row(kHTMLControls, controls);
    tables.Row(kHTMLObjectID, HTMLUnsigned(m_uiID));
}

uint64_t CObject::GetMemoryUsed() const
{
    return 32 + m_pcName.MemoryUsed();
}

uint64_t CObject::GetDiskUsed() const
{
    CFieldCounter counter;
    const_cast<CObject*>(this)->Fields(counter); // counting modifies nothing
    return 4 + std::strlen(GetRTTI()->m_pcName) + 4 + counter.ByteCount();
}

bool CObject::Update(float time)
{
    UpdateChains(*this, [=](CObject& object) { object.Update(time); });
    return true;
}

bool CObject::UpdateRange(uint32_t range, float time)
{
    UpdateChains(*this, [=](CObject& object) { object.UpdateRange(range, time); });
    return true;
}

bool CObject::Fits(const char* name, const CRTTI* record, bool derived) const
{
    if (record && !(derived ? IsDerivedFrom(*this, record) : GetRTTI() == record))
        return false;
    return !name || (!m_pcName.IsNull() && m_pcName.View() == name);
}

std::vector<CObject*> CObject::HeldObjects()
{
    std::vector<CObject*> held;
    AppendHeld(*this, held);
    return held;
}

CObject* CObject::FindObject(const char* name, const CRTTI* record, bool derived)
{
    return FindHeld(*this, [=](const CObject& object) { return object.Fits(name, record, derived); });
}

void CObject::FindObjects(std::vector<CObject*>& found, const char* name, const CRTTI* record, bool derived)
{
    FindHeld(*this, [&](CObject& object) {
        if (object.Fits(name, record, derived))
            found.push_back(&object);
        return false;
    });
}

void CObject::AppendBindOrder(std::vector<CObject*>& order)
{
    const std::vector<CObject*> held = HeldObjects();
    order.insert(order.end(), held.begin(), held.end());
}

std::vector<CObject*> CObject::BindOrder()
{
    std::vector<CObject*> order;
    AppendBindOrder(order);
    std::erase(order, nullptr);
    return order;
}

bool CObject::Bind(CObject& root)
{
    for (CObject* held : BindOrder())
        held->Bind(root);
    return true;
}

bool CObject::Rebind(const CCloneMap& map)
{
    for (CObject* held : BindOrder())
        held->Rebind(map);
    FollowCopies(*this, map);
    return true;
}

bool CObject::AttachControl(CControl* control)
{
    if (!control || control->GetTarget())
        return false;
    for (CControl* link = control; link; link = link->GetNext())
        link->SetTarget(this);
    if (!m_spkControl)
        m_spkControl = control;
    else if (CControl* last = m_spkControl->GetLast(); last != control)
        last->SetNext(control);
    return true;
}

bool CObject::AttachModifier(CControl* modifier)
{
    CModifier* last = nullptr;
    ForEachModifier(m_spkModifier.Get(), [&](CModifier& link) { last = &link; });
    // A file can put any object at the head, and not every object can have a successor.
    if (!modifier || modifier->GetTarget() || (m_spkModifier && !last))
        return false;
    for (CControl* link = modifier; link; link = link->GetNext())
        link->SetTarget(this);
    if (!m_spkModifier)
        m_spkModifier = modifier;
    else if (last && last != modifier)
        last->SetNext(modifier);
    return true;
}

bool CObject::AttachCustomData(CCustomData* data)
{
    if (!data)
        return false;
    if (!m_spkCustomData)
    {
        m_spkCustomData = data;
        return true;
    }
    CCustomData* last =
        dynamic_cast<CCustomData*>(m_spkControl ? static_cast<CObject*>(m_spkControl->GetLast()) : nullptr);
    if (!last)
        return false;
    last->SetNextData(data);
    return true;
}

void CObject::DetachControls()
{
    for (CControl* control = m_spkControl.Get(); control; control = control->GetNext())
        control->SetTarget(nullptr);
    m_spkControl = nullptr;
}

void CWatcher::Watch(CObject* object)
{
    if (object == m_pkObject)
        return;
    if (m_pkObject)
    {
        (m_pkPrevious ? m_pkPrevious->m_pkNext : m_pkObject->m_pkWatchers) = m_pkNext;
        if (m_pkNext)
            m_pkNext->m_pkPrevious = m_pkPrevious;
    }
    m_pkObject = object;
    m_pkPrevious = nullptr;
    m_pkNext = nullptr;
    if (!object)
        return;
    m_pkNext = object->m_pkWatchers;
    if (m_pkNext)
        m_pkNext->m_pkPrevious = this;
    object->m_pkWatchers = this;
}

} // namespace gw
