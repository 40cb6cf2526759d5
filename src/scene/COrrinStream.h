#pragma once

#include "CFactoryMap.h"
#include "CFailure.h"
#include "CObject.h"
#include "COrrinThumbnail.h"
#include "CVersion.h"

#include <cstddef>
#include <map>
#include <memory>
#include <optional>
#include <span>
#include <string>
#include <unordered_map>
#include <unordered_set>
#include <utility>
#include <vector>

namespace gw {

class CFieldReader;
class CFieldWriter;
class CMappedFile;

/// What an object left behind while a file is loading: the link ids that it read, in its own order.
struct CLinkRecord
{
    uint32_t m_uiCursor = 0;    ///< next id to resolve
    Ref<CObject> m_spkObject;   ///< kept alive until the links stand
    bool m_bSubstitute = false; ///< an object that was there before stands for the one in the file
    std::vector<uint32_t> m_kLinkID;
};

/// How much memory the linked pictures of one scene take, of how much they may.
struct PictureMemory
{
    /// Room for one picture of 64 megapixels, the largest that the codec reads, or for four of 4096 x 4096.
    /// Without a limit, a scene of a few KB could take 256 MiB for each picture file of 200 KB that it names.
    static constexpr uint64_t kByteLimit = uint64_t{256} << 20;

    uint64_t m_uiByteLimit = kByteLimit;
    uint64_t m_uiBytesUsed = 0;
    bool m_bFull = false; ///< one picture did not fit; the rest of the scene's pictures are not tried
};

/// Containers are at most this large, read or written: offsets in them are signed 32-bit.
inline constexpr uint64_t kContainerBytesLimit = 0x7fffffff;

/// Reads and writes scene containers (.orn, .Kinetra): a flat sequence of object records that refer to each
/// other by link ids. Reading and writing take two passes each: build and link, register and save. A stream
/// keeps its roots; it can be used again. The bool answers are those of old; what really happened stands in
/// Record().
class COrrinStream
{
public:
    COrrinStream();
    virtual ~COrrinStream();
    COrrinStream(const COrrinStream&) = delete;
    COrrinStream& operator=(const COrrinStream&) = delete;

    /// False, with roots and version as they were, for a file that cannot be read, is too short, or whose
    /// header or version is not supported. Otherwise true whatever reading the objects did: see Record() and
    /// GetRoot.
    bool LoadFile(const std::string& path, bool thumbnailOnly);
    /// The same from memory. Position 0 means a buffer without the header, in the newest version. True unless
    /// reading ended early.
    bool LoadBuffer(std::span<const std::byte> bytes, size_t position);
    bool LoadThumbnailOnly(std::span<const std::byte> bytes, size_t position);
    /// Replaces the file in one step. False when it cannot be written or the scene is too large.
    bool SaveFile(const std::string& path);
    /// The object part of a file, without the header. False when the scene is too large.
    bool SaveBuffer(std::vector<std::byte>& out);
    /// What stands before the object part of a file in the newest version.
    static std::span<const std::byte> FileHeader();

    /// False for null and for an object that is a root already.
    bool AddRoot(CObject* object);
    /// The root, or null for an index out of range. No count is taken.
    CObject* GetRoot(size_t index) const;
    size_t GetRootCount() const { return m_kRoots.size(); }
    bool IsRoot(const CObject* object) const;
    void RemoveAllRoots();

    CVersion GetVersion() const { return m_kVersion; }
    COrrinThumbnail& Thumbnail() { return m_kThumbnail; }
    /// The folder of the file last read or written, without the last separator.
    const std::string& GetBaseDirectory() const { return m_kBaseDirectory; }
    /// False for a stream that has seen no file but only memory: names in it lead nowhere.
    bool HasBaseDirectory() const { return m_bHasBaseDirectory; }
    /// What the last load or save failed on, with the byte and the class.
    const CFailureRecord& Record() const { return m_kRecord; }

    /// Sets how many bytes the linked pictures of each scene may take. 0 decodes none and reports none.
    void SetPictureLimit(uint64_t bytes) { m_kLinkedPictures.m_uiByteLimit = bytes; }

    /// All objects that the roots hold, in save order, for reports. Empty between operations otherwise.
    std::vector<CObject*> ObjectsInSaveOrder();

    // For the objects' own Load, Link, Register and Save.

    /// Reads id and fields of an object; the record's reference keeps the object until the links stand.
    void ReadObject(CObject& object, CLinkRecord& record);
    void ResolveLinks(CObject& object, CLinkRecord& record);
    /// False when the object is in the list already.
    bool AppendToSaveList(CObject& object);
    void WriteObject(CObject& object);
    /// Enters a record under an id; false when the id is taken: the first keeps it.
    bool AddLink(uint32_t id, CLinkRecord& record);
    /// The object of an id, or null for an unknown one and for 0.
    CObject* FindLinkedObject(uint32_t id) const;
    /// The id that an object has in the file being written; 0 for null and for what is not written.
    uint32_t LinkID(const CObject* object) const;
    /// Lets an object that is there already take the place of the one that the record was made for, which
    /// lives no longer than that. What the other holds stays as it is.
    void Substitute(CLinkRecord& record, CObject& object);
    /// A fresh record for an object that is about to read itself; the stream owns it.
    CLinkRecord& NewLinkRecord(CObject& object);
    /// The memory of the linked pictures that the load in progress has read.
    PictureMemory& LinkedPictures() { return m_kLinkedPictures; }
    /// Keeps a warning about the load in progress.
    void Warn(EFailure reason, std::string name) { m_kRecord.Warn(reason, 0, std::move(name)); }

private:
    bool ReadObjects();
    CObject* ReadNextObject(bool& marked);
    void LinkObjects();
    bool CheckGraph();
    void DropGraph();
    void RegisterRoots();
    std::optional<size_t> PlanBuffer();
    void ClearSaveList();
    uint64_t BufferBytes();
    void WriteObjects(CFieldWriter& writer);
    void SetBaseDirectory(const std::string& path);

    CVersion m_kVersion;
    COrrinThumbnail m_kThumbnail;
    std::vector<Ref<CObject>> m_kRoots;
    std::unordered_set<const CObject*> m_kIsRoot;
    std::map<uint32_t, CLinkRecord*> m_kLinkTable;
    std::vector<std::unique_ptr<CLinkRecord>> m_kRecords; // in file order
    std::vector<CObject*> m_kSaveList;
    std::unordered_map<const CObject*, uint32_t> m_kSaveID;
    std::string m_kBaseDirectory;
    bool m_bHasBaseDirectory = false;
    PictureMemory m_kLinkedPictures;    // of the load in progress or the last one
    CMappedFile* m_pkFile = nullptr;    // while reading one
    CFieldReader* m_pkReader = nullptr; // while reading
    CFieldWriter* m_pkWriter = nullptr; // while writing
    CFailureRecord m_kRecord;
};

/// The factory of a concrete class.
template <class T>
CObject* MakeObject(COrrinStream& stream)
{
    CObject* object = new T;
    CLinkRecord& record = stream.NewLinkRecord(*object);
    object->Load(stream, record);
    return record.m_spkObject.Get();
}

} // namespace gw
