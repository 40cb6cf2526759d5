#pragma once

#include "CFactoryMap.h"
#include "CFailureRecord.h"
#include "CObject.h"
#include "COrrinThumbnail.h"
#include "CVersion.h"

#include <cstddef>
#include <functional>
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

/// The link ids that an object has read, in order, while a file is loading.
struct CLinkRecord
{
    uint32_t m_uiCursor = 0;    ///< next id to resolve
    Ref<CObject> m_spkObject;   ///< kept alive until the links are resolved
    bool m_bSubstitute = false; ///< an existing object replaces the one in the file
    std::vector<uint32_t> m_kLinkID;
};

/// How much memory the linked pictures of a scene take, and may take.
struct PictureMemory
{
    /// Enough for one picture of 64 megapixels, the largest that the codec reads, or four of 4096 x 4096.
    /// Without a limit, a scene of a few KB could take 256 MiB for each picture file of 200 KB that it names.
    static constexpr uint64_t kByteLimit = uint64_t{256} << 20;

    uint64_t m_uiByteLimit = kByteLimit;
    uint64_t m_uiBytesUsed = 0;
    bool m_bFull = false; ///< a picture did not fit; the scene's remaining pictures are not tried
};

/// The maximum size of a container, read or written, because its offsets are signed 32-bit.
inline constexpr uint64_t kContainerBytesLimit = 0x7fffffff;

/// Reads and writes scene containers (.orn, .Kinetra): a flat sequence of object records that refer to each
/// other by link ids. Reading takes two passes, build and link; so does writing, register and save. A stream
/// keeps its roots and can be reused. The bool results are kept for compatibility; Record() contains the
/// actual failure.
class COrrinStream
{
public:
    COrrinStream();
    virtual ~COrrinStream();
    COrrinStream(const COrrinStream&) = delete;
    COrrinStream& operator=(const COrrinStream&) = delete;

    /// Reads a file. Returns false, with roots and version unchanged, if it cannot be read, is too short, or
    /// has an unsupported header or version. Otherwise returns true whatever happened to the objects: see
    /// Record() and GetRoot.
    bool LoadFile(const std::string& path, bool thumbnailOnly);
    /// Reads a buffer. Position 0 means that it has no header and is in the newest version. Returns false if
    /// reading ended early.
    bool LoadBuffer(std::span<const std::byte> bytes, size_t position);
    bool LoadThumbnailOnly(std::span<const std::byte> bytes, size_t position);
    /// Writes a file, replacing an old one atomically. Returns false if it cannot be written or the scene is
    /// too large.
    bool SaveFile(const std::string& path);
    /// Writes the object part of a file, without the header. Returns false if the scene is too large.
    bool SaveBuffer(std::vector<std::byte>& out);
    /// Returns the bytes that precede the object part of a file in the newest version.
    static std::span<const std::byte> FileHeader();

    /// Adds a root. Returns false for null and for an existing root.
    bool AddRoot(CObject* object);
    /// Returns a root, or null if the index is out of range. No reference is counted.
    CObject* GetRoot(size_t index) const;
    size_t GetRootCount() const { return m_kRoots.size(); }
    bool IsRoot(const CObject* object) const;
    void RemoveAllRoots();

    CVersion GetVersion() const { return m_kVersion; }
    COrrinThumbnail& Thumbnail() { return m_kThumbnail; }
    /// Returns the folder of the last file read or written, without the last separator.
    const std::string& GetBaseDirectory() const { return m_kBaseDirectory; }
    /// Returns false if the stream has only read from memory, so file names in the scene cannot be resolved.
    bool HasBaseDirectory() const { return m_bHasBaseDirectory; }
    /// Returns the failure of the last load or save, with byte position and class.
    const CFailureRecord& Record() const { return m_kRecord; }

    /// Sets a function that a load calls for each object with the number of bytes read and the total. If it
    /// throws, the stream can only be destroyed.
    void SetProgress(std::function<void(size_t, size_t)> progress) { progress_ = std::move(progress); }

    /// Limits the bytes that the linked pictures of each scene may take. 0 decodes no pictures and reports
    /// none.
    void SetPictureLimit(uint64_t bytes) { m_kLinkedPictures.m_uiByteLimit = bytes; }

    /// Returns all objects that the roots hold, in save order, for reports. Leaves the save list empty.
    std::vector<CObject*> ObjectsInSaveOrder();

    // For use by the objects' Load, Link, Register and Save.

    /// Reads the id and fields of an object. The record keeps the object alive until its links are resolved.
    void ReadObject(CObject& object, CLinkRecord& record);
    void ResolveLinks(CObject& object, CLinkRecord& record);
    /// Returns false if the object is already in the list.
    bool AppendToSaveList(CObject& object);
    void WriteObject(CObject& object);
    /// Registers a record under an id. Returns false if the id is taken; the first record keeps it.
    bool AddLink(uint32_t id, CLinkRecord& record);
    /// Returns the object with an id, or null for 0 or an unknown id.
    CObject* FindLinkedObject(uint32_t id) const;
    /// Returns an object's id in the file being written; 0 for null or an object that is not written.
    uint32_t LinkID(const CObject* object) const;
    /// Replaces the record's object by an existing one, which is not modified. The replaced object is
    /// deleted.
    void Substitute(CLinkRecord& record, CObject& object);
    /// Returns a new record for an object about to be read; owned by the stream.
    CLinkRecord& NewLinkRecord(CObject& object);
    /// Returns the memory use of the linked pictures in the current load.
    PictureMemory& LinkedPictures() { return m_kLinkedPictures; }
    /// Records a warning about the current load.
    void Warn(EFailure reason, std::string name) { m_kRecord.Warn(reason, 0, std::move(name)); }

private:
    bool ReadObjects(size_t byteCount);
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
    PictureMemory m_kLinkedPictures;    // of the current or last load
    CMappedFile* m_pkFile = nullptr;    // while reading a file
    CFieldReader* m_pkReader = nullptr; // while reading
    CFieldWriter* m_pkWriter = nullptr; // while writing
    CFailureRecord m_kRecord;
    std::function<void(size_t, size_t)> progress_;
};

/// Returns the factory of a concrete class.
template <class T>
CObject* MakeObject(COrrinStream& stream)
{
    CObject* object = new T;
    CLinkRecord& record = stream.NewLinkRecord(*object);
    object->Load(stream, record);
    return record.m_spkObject.Get();
}

} // namespace gw
