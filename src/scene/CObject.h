#pragma once

#include "CRTTI.h"
#include "CText.h"
#include "Ref.h"

#include <atomic>
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

/// Maps the id of a source object to its copy, for one clone operation.
using CCloneMap = std::map<uint32_t, CObject*>;

/// The limit for the nesting of counted references: updates, searches and destructors recurse once per level.
/// With sanitizers, the largest of them takes about 1.3 KiB of stack per level.
inline constexpr size_t kNestingLimit = 4000;

/// The number of possible object ids.
inline constexpr uint32_t kObjectIDCount = 8'388'608;

// Threads may create and delete objects at the same time. One object, with all that it holds, belongs to one
// thread at a time: its reference count is a plain number.
extern std::atomic<uint8_t> g_abObjectIDInUse[kObjectIDCount]; ///< one byte per id, nonzero while in use
extern std::atomic<uint32_t> g_uiNextObjectID;                 ///< where the search for a free id starts
extern std::atomic<uint32_t> g_uiObjectCount;                  ///< number of live objects

/// Base of all scene objects: class record, reference count, id, name and three chains of attached objects. A
/// new object has count 0; it deletes itself when a release brings the count back to 0. Copying copies the
/// class's own values and assigns a new id, but does not copy attachments.
class CObject
{
public:
    static const CRTTI ms_kRTTI;

    CObject();
    CObject(const CObject& source);
    CObject& operator=(const CObject&) = delete;
    virtual ~CObject();

    virtual const CRTTI* GetRTTI() const { return &ms_kRTTI; }
    /// Returns a copy-constructed object with count 0; null for abstract classes.
    virtual CObject* CreateClone() const { return nullptr; }
    /// Copies the object with everything it holds. If the map already contains it, returns the earlier copy.
    /// Plain links in the copies refer to other copies if they exist.
    virtual CObject* Clone(CCloneMap& map);

    /// Lists the class's stored fields, base class first, in file order. This is the only place that defines
    /// the file layout.
    virtual void Fields(CFieldArchive& archive);

    /// Reads the fields and collects link ids in the record.
    virtual void Load(COrrinStream& stream, CLinkRecord& record);
    /// Resolves the record's link ids to references; other objects need not be linked yet.
    virtual void Link(COrrinStream& stream, CLinkRecord& record);
    /// Adds the object and everything it holds to the stream's save list; false if it was already there.
    virtual bool Register(COrrinStream& stream);
    virtual void Save(COrrinStream& stream);

    /// Writes a small web site about this object and everything below it, for developers. Only nodes do this.
    /// File names are appended to the folder, so it must end with a separator.
    virtual void WriteHTMLFrames(const std::string&) {}
    /// Adds the object's tables to a page and saves the pages of everything it links to, each once. If a
    /// larger dump is running, that dump saves the other pages.
    virtual void DumpHTML(const std::string& folder, COrnHTMLWriter& page);
    /// Adds the tables of the object's classes, base class first.
    virtual void DumpTable(CHTMLTables& tables);

    /// Returns the bytes in memory, by the fixed sizes of the object model.
    virtual uint64_t GetMemoryUsed() const;
    /// Returns the exact number of bytes that Save writes.
    virtual uint64_t GetDiskUsed() const;

    /// Updates the object and its chains to a time. Returns true unless a class documents otherwise.
    virtual bool Update(float time);
    virtual bool UpdateRange(uint32_t range, float time);

    /// Returns the first object, starting with this one, with this name and class. A null name or record
    /// matches everything. With `derived`, derived classes match too. Depth first, attachments before
    /// children.
    virtual CObject* FindObject(const char* name, const CRTTI* record, bool derived);
    /// Appends all matching objects.
    virtual void FindObjects(std::vector<CObject*>& found, const char* name, const CRTTI* record,
                             bool derived);
    /// Returns the objects that this one keeps alive, in search order, which is file order.
    std::vector<CObject*> HeldObjects();
    /// Resolves references by name under a root.
    virtual bool Bind(CObject& root);
    /// Redirects plain links of a finished copy to copies that a later clone with the same map has made.
    virtual bool Rebind(const CCloneMap& map);

    const char* GetName() const { return m_pcName.Get(); }
    /// Returns the name; empty for a null name.
    std::string_view NameView() const { return m_pcName.View(); }
    /// Stores a copy of the name, or null.
    void SetName(const char* name) { m_pcName.Set(name); }
    uint32_t GetID() const { return m_uiID; }

    CControl* GetControl() const { return m_spkControl.Get(); }
    CObject* GetModifier() const { return m_spkModifier.Get(); }
    CCustomData* GetCustomData() const { return m_spkCustomData.Get(); }
    /// Appends a control and its chain to the control chain and sets its target. Returns false for null or if
    /// the control already has a target.
    bool AttachControl(CControl* control);
    /// Same for the modifier chain, which ends at the first object that is not a modifier. If the head itself
    /// is not one, returns false and changes nothing.
    bool AttachModifier(CControl* modifier);
    /// Makes a custom data object the head of its chain. If there is already a head, the end is searched in
    /// the control chain, as it always was; if that is not custom data, returns false and changes nothing.
    bool AttachCustomData(CCustomData* data);
    /// Releases the control chain; its controls lose their target.
    void DetachControls();

    void Retain() { ++m_uiRefCount; }
    void Release();
    uint32_t GetRefCount() const { return m_uiRefCount; }

    uint32_t m_uiChangeStamp = 0; ///< incremented by a control whenever it changes this object; not copied

protected:
    /// Appends the objects that Bind and Rebind call, in order; entries may be null. Spatials append their
    /// own before the inherited ones.
    virtual void AppendBindOrder(std::vector<CObject*>& order);
    /// Clones the objects that this one holds into its copy.
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

/// An entry in an object's list of plain pointers to it.
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
