#pragma once

#include "CRTTI.h"
#include "CText.h"
#include "Ref.h"

#include <cstdint>
#include <map>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

class CControl;
class CCustomData;
class CFieldArchive;
class CHTMLTables;
class COrnHTMLWriter;
class COrrinStream;
class CWatcher;
struct CLinkRecord;

/// From the id of a source object to its copy, alive for one clone operation.
using CCloneMap = std::map<uint32_t, CObject*>;

/// How deep objects may be nested by counted references: updates, searches and destructors recurse once per
/// level. With the sanitizers on, the longest walk takes about 1.3 KiB of stack for each.
inline constexpr size_t kNestingLimit = 4000;

/// The number of ids that objects can have.
inline constexpr uint32_t kObjectIDCount = 8'388'608;

extern uint8_t g_abObjectIDInUse[kObjectIDCount]; ///< one byte per possible id, non-zero while it is taken
extern uint32_t g_uiNextObjectID;                 ///< where the search for a free id begins
extern uint32_t g_uiObjectCount;                  ///< live objects

/// The base of every scene thing: class record, reference count, id, name and three chains of attached
/// objects. Born with count 0 and belonging to nobody; deletes itself when a release brings the count back to
/// 0. Copying copies the class's own values under a fresh id, never the attachments.
class CObject
{
public:
    static const CRTTI ms_kRTTI;

    CObject();
    CObject(const CObject& source);
    CObject& operator=(const CObject&) = delete;
    virtual ~CObject();

    virtual const CRTTI* GetRTTI() const { return &ms_kRTTI; }
    /// A new object by the copy constructor, with count 0; null for abstract classes.
    virtual CObject* CreateClone() const { return nullptr; }
    /// Copies the object together with everything it holds. An object that the map already knows returns the
    /// copy made before. Plain links of the copies point to other copies if there are any.
    virtual CObject* Clone(CCloneMap& map);

    /// The class's stored fields, base first, in file order: the one place that says what a file holds.
    virtual void Fields(CFieldArchive& archive);

    /// Reads the fields, collecting link ids in the record.
    virtual void Load(COrrinStream& stream, CLinkRecord& record);
    /// Turns the record's link ids into references; no other object need be linked already.
    virtual void Link(COrrinStream& stream, CLinkRecord& record);
    /// Enters the object and all that it holds in the stream's save list; false when it was known already.
    virtual bool Register(COrrinStream& stream);
    virtual void Save(COrrinStream& stream);

    /// Writes a small web site about this object and all below it, for developers. Only nodes do. The folder
    /// stands straight before each file name, so it ends in a separator.
    virtual void WriteHTMLFrames(const std::string&) {}
    /// Adds the object's tables to a page and saves the pages of everything it links to, each once. While a
    /// larger dump is running, that dump saves the other pages.
    virtual void DumpHTML(const std::string& folder, COrnHTMLWriter& page);
    /// Adds the tables of the object's classes, base first.
    virtual void DumpTable(CHTMLTables& tables);

    /// Bytes in memory, by the fixed sizes of the object model.
    virtual uint64_t GetMemoryUsed() const;
    /// The bytes that Save writes, exactly.
    virtual uint64_t GetDiskUsed() const;

    /// Brings the object and its chains up to a time. Always true unless a class says otherwise.
    virtual bool Update(float time);
    virtual bool UpdateRange(uint32_t range, float time);

    /// The first object, this one included, that has the name and the class; null name or record match
    /// everything. With `derived` a class derived from the record's fits too. Depth first, attachments before
    /// children.
    virtual CObject* FindObject(const char* name, const CRTTI* record, bool derived);
    /// Appends all such objects.
    virtual void FindObjects(std::vector<CObject*>& found, const char* name, const CRTTI* record,
                             bool derived);
    /// The objects that this one keeps alive, in search order, which is file order.
    std::vector<CObject*> HeldObjects();
    /// Lets references by name look up their objects under a root.
    virtual bool Bind(CObject& root);
    /// Lets plain links of a finished copy lead to copies that a later clone with the same map has made.
    virtual bool Rebind(const CCloneMap& map);

    const char* GetName() const { return m_pcName.Get(); }
    /// The name's characters; none for a null name.
    std::string_view NameView() const { return m_pcName.View(); }
    /// Stores a copy, or null.
    void SetName(const char* name) { m_pcName.Set(name); }
    uint32_t GetID() const { return m_uiID; }

    CControl* GetControl() const { return m_spkControl.Get(); }
    CObject* GetModifier() const { return m_spkModifier.Get(); }
    CCustomData* GetCustomData() const { return m_spkCustomData.Get(); }
    /// Appends a control, with the chain behind it, to the control chain and targets it here. False for null
    /// and for a control that has a target already.
    bool AttachControl(CControl* control);
    /// Does the same for the modifier chain, which ends at the first object that is not a modifier. False,
    /// with nothing changed, also if the head itself is not a modifier.
    bool AttachModifier(CControl* modifier);
    /// Makes a custom data object the head of its chain. With a head there already the end is looked for in
    /// the control chain, as it has always been, and where that is no custom data nothing changes: false.
    bool AttachCustomData(CCustomData* data);
    /// Lets go of the control chain; its controls lose their target.
    void DetachControls();

    void Retain() { ++m_uiRefCount; }
    void Release();
    uint32_t GetRefCount() const { return m_uiRefCount; }

    uint32_t m_uiChangeStamp = 0; ///< raised by a control each time it has rewritten this object; not copied

protected:
    /// What Bind and Rebind pass the call to, in their order; entries may be null. Spatials name what they
    /// add before what they inherit.
    virtual void AppendBindOrder(std::vector<CObject*>& order);
    /// Clones what this object holds into its copy.
    virtual void CloneHeld(CCloneMap& map, CObject& copy);

private:
    friend class CWatcher;

    void TakeID();
    std::vector<CObject*> BindOrder();
    bool Fits(const char* name, const CRTTI* record, bool derived) const;

    CText m_pcName;
    Held<CControl> m_spkControl;
    Held<CObject> m_spkModifier;
    Held<CCustomData> m_spkCustomData;
    uint32_t m_uiID = 0;
    uint32_t m_uiRefCount = 0;
    CWatcher* m_pkWatchers = nullptr;
};

/// One entry in an object's list of those who point at it without holding it.
class CWatcher
{
public:
    CWatcher() = default;
    CWatcher(const CWatcher&) = delete;
    CWatcher& operator=(const CWatcher&) = delete;
    ~CWatcher() { Watch(nullptr); }

    CObject* Object() const { return m_pkObject; }
    void Watch(CObject* object);

private:
    CObject* m_pkObject = nullptr;
    CWatcher* m_pkNext = nullptr;
    CWatcher* m_pkPrevious = nullptr;
};

} // namespace gw
