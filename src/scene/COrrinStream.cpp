// The container reader and writer.
//
// A scene is a graph: objects share children, controls point back at their targets. A file is flat: one
// record per object, in which a reference is the id in the other object's record. Ids mean nothing outside
// their file, and a record can refer to one that comes later. So reading takes two passes. The first creates
// an object per record, by class name, lets it read its fields, and collects the ids it read in a
// CLinkRecord. The second replaces the ids by references, in the same field order. An unknown id becomes
// null, and so does an object of the wrong class; the first record with an id wins.
//
// Nothing in a file is trusted. Each count is checked against the bytes that are left before memory is
// allocated, so the objects cannot take more than a fixed multiple of the file size, and reading ends because
// every record consumes bytes. Unknown classes end the file, since the length of their record is not stored.
// The finished graph is checked once more before anybody walks it: a file can make objects hold each other in
// a cycle, nest them deeper than the stack allows, or share them so often that a walk never ends. Such a
// graph is unlinked object by object, because even deleting it recursively could overflow the stack.
//
// Writing collects every object that the roots hold, each once and in field order, numbers them from 1, and
// writes the records in that order. Roots are marked by a name in front of their class name. The size is
// computed first, so a scene that is too large leaves the old file alone.
//
// Numbers: the header is 21 bytes with its zero byte, and its first 16 are compared; the digits of the
// version follow. Offsets are signed 32-bit, hence the limit of 2 GiB. Loading stops when half of all object
// ids are in use; the rest is left for clones and for objects that are built outside a file.

#include "COrrinStream.h"

#include "CFieldReader.h"
#include "CFieldWriter.h"
#include "CGraphCheck.h"
#include "CMappedFile.h"
#include "CSafeFile.h"

#include <cstring>

namespace gw {

namespace {

constexpr char kHeaderText[] = "TKOrrin Version 1.20";
constexpr std::string_view kHeader(kHeaderText, sizeof kHeaderText); // with its zero byte
constexpr size_t kHeaderCompared = 16;                               // the version digits can differ
constexpr size_t kLeastFileBytes = 21;
constexpr std::string_view kRootMarker = "_OrrinRoot";
constexpr std::string_view kThumbnailTag = "_OrrinThumbnail";
// The other half of the ids is for clones and objects created besides a file.
constexpr uint32_t kObjectLimit = kObjectIDCount / 2;

// Reads "%1d.%2d" as sscanf does: blanks and a sign may precede either number, and only digits count for the
// width, so " 1. 2" is accepted.
bool ScanDigits(const char*& text, int width, int& value)
{
    while (*text == ' ' || (*text >= '\t' && *text <= '\r'))
        ++text;
    bool negative = false;
    if (*text == '-' || *text == '+')
    {
        negative = *text++ == '-';
        --width;
    }
    if (width < 1 || *text < '0' || *text > '9')
        return false;
    for (value = 0; width > 0 && *text >= '0' && *text <= '9'; --width)
        value = value * 10 + (*text++ - '0');
    if (negative)
        value = -value;
    return true;
}

CVersion ParseHeader(std::span<const std::byte> bytes)
{
    if (bytes.size() < kHeader.size() || bytes[kHeader.size() - 1] != std::byte{0})
        return {};
    const char* text = reinterpret_cast<const char*>(bytes.data());
    if (std::strlen(text) < kHeader.size() - 1 || std::memcmp(text, kHeader.data(), kHeaderCompared) != 0)
        return {};
    const char* digits = text + kHeaderCompared;
    CVersion version;
    if (!ScanDigits(digits, 1, version.m_iMajor) || *digits++ != '.' ||
        !ScanDigits(digits, 2, version.m_iMinor))
        return {};
    return version;
}

// Replaces ids by references in an object's slots: skips plain values and consumes the record's ids in order.
class CLinkResolver : public CFieldArchive
{
public:
    CLinkResolver(const COrrinStream& stream, CLinkRecord& record)
        : CFieldArchive(stream.GetVersion()), stream_(stream), m_kRecord(record)
    {
    }

    void Text(const char*, CText&) override {}
    bool Presence(const char*, bool present) override { return present; }
    size_t Count(const char*, size_t count, size_t) override { return count; }

protected:
    void Values(const char*, EFieldKind, void*, size_t) override {}
    void Slot(const char*, const CLinkSlot& slot) override
    {
        if (m_kRecord.m_uiCursor < m_kRecord.m_kLinkID.size())
            slot.Set(stream_.FindLinkedObject(m_kRecord.m_kLinkID[m_kRecord.m_uiCursor++]));
    }

private:
    const COrrinStream& stream_;
    CLinkRecord& m_kRecord;
};

// Clears every counted slot of an object, so that a rejected graph can be deleted without recursion.
void Unlink(CObject& object)
{
    CLinkVisitor visitor([](const CLinkSlot& slot) {
        if (slot.IsCounted())
            slot.Set(nullptr);
    });
    object.Fields(visitor);
}

} // namespace

COrrinStream::COrrinStream() = default;

COrrinStream::~COrrinStream()
{
    RemoveAllRoots();
}

void COrrinStream::RemoveAllRoots()
{
    m_kIsRoot.clear();
    m_kRoots.clear();
}

bool COrrinStream::AddRoot(CObject* object)
{
    if (!object || !m_kIsRoot.insert(object).second)
        return false;
    m_kRoots.emplace_back(object);
    return true;
}

CObject* COrrinStream::GetRoot(size_t index) const
{
    return index < m_kRoots.size() ? m_kRoots[index].Get() : nullptr;
}

bool COrrinStream::IsRoot(const CObject* object) const
{
    return m_kIsRoot.contains(object);
}

void COrrinStream::SetBaseDirectory(const std::string& path)
{
    const size_t separator = path.find_last_of("/\\");
    m_kBaseDirectory = separator == std::string::npos ? "" : path.substr(0, separator);
    m_bHasBaseDirectory = true;
}

bool COrrinStream::LoadFile(const std::string& path, bool thumbnailOnly)
{
    m_kRecord.Clear();
    CMappedFile file;
    const EFailure reason = file.Open(path);
    if (reason != EFailure::None)
        return m_kRecord.Fail(reason);
    const std::span<const std::byte> bytes = file.Bytes();
    if (bytes.size() < kLeastFileBytes)
        return m_kRecord.Fail(EFailure::Truncated, bytes.size());
    if (bytes.size() > kContainerBytesLimit)
        return m_kRecord.Fail(EFailure::TooLarge);
    const CVersion version = ParseHeader(bytes);
    if (version.m_iMajor < 0)
        return m_kRecord.Fail(EFailure::BadHeader);
    if (!version.IsSupported())
        return m_kRecord.Fail(EFailure::BadVersion, kHeaderCompared);
    m_kVersion = version;
    SetBaseDirectory(path);
    if (thumbnailOnly)
        LoadThumbnailOnly(bytes, kHeader.size());
    else
    {
        m_pkFile = &file;
        LoadBuffer(bytes, kHeader.size());
        m_pkFile = nullptr;
    }
    if (file.IsWhole())
        return true;
    RemoveAllRoots();
    m_kRecord.Clear(); // discard failures caused by the missing bytes
    return m_kRecord.Fail(EFailure::Changed);
}

bool COrrinStream::LoadThumbnailOnly(std::span<const std::byte> bytes, size_t position)
{
    m_kRecord.Clear();
    if (position == 0)
        m_kVersion = kNewestVersion;
    CFieldReader reader(bytes, position, m_kVersion, m_kRecord);
    reader.ReadString(); // the tag, which is not checked
    m_kThumbnail = {};
    m_kThumbnail.Fields(reader);
    return true;
}

bool COrrinStream::LoadBuffer(std::span<const std::byte> bytes, size_t position)
{
    m_kRecord.Clear();
    m_kLinkedPictures = {.m_uiByteLimit = m_kLinkedPictures.m_uiByteLimit};
    RemoveAllRoots();
    if (position == 0)
        m_kVersion = kNewestVersion;
    CFieldReader reader(bytes, position, m_kVersion, m_kRecord);
    reader.ReadString(); // the tag, which is not checked
    m_kThumbnail = {};
    m_kThumbnail.Fields(reader);

    reader.SetSource(m_pkFile);
    m_pkReader = &reader;
    const bool whole = ReadObjects(bytes.size());
    m_pkReader = nullptr;
    if (whole)
        LinkObjects();
    const bool sound = whole && CheckGraph();
    if (!sound && whole)
        DropGraph();
    m_kLinkTable.clear();
    // Deletes the objects without counted references. Records go in file order; objects that no link holds go
    // one by one, so recursion is never deeper than the graph that was checked.
    m_kRecords.clear();
    return sound;
}

bool COrrinStream::ReadObjects(size_t byteCount)
{
    while (!m_pkReader->AtEnd() && !m_pkReader->IsDamaged())
    {
        bool marked = false;
        CObject* object = ReadNextObject(marked);
        if (!object)
            return false;
        if (m_pkReader->IsDamaged())
        {
            // Discard the incomplete last record.
            const CLinkRecord* last = m_kRecords.back().get();
            std::erase_if(m_kLinkTable, [=](const auto& entry) { return entry.second == last; });
            m_kRecords.pop_back();
            return false;
        }
        if (marked)
            AddRoot(object);
        if (progress_)
            progress_(m_pkReader->Position(), byteCount);
    }
    return !m_pkReader->IsDamaged();
}

CObject* COrrinStream::ReadNextObject(bool& marked)
{
    const size_t start = m_pkReader->Position();
    std::string_view className = m_pkReader->ReadString();
    marked = className == kRootMarker;
    if (marked)
        className = m_pkReader->ReadString();
    if (m_pkReader->IsDamaged())
        return nullptr;
    // A class name is a C string: a zero byte ends it.
    const std::string name(className.substr(0, className.find('\0')));
    // Each object needs an id, and the search for a free one ends only if there is one.
    if (g_uiObjectCount >= kObjectLimit)
    {
        m_kRecord.Fail(EFailure::TooLarge, start, name);
        return nullptr;
    }
    const CObjectFactory factory = CFactoryMap::Instance().Find(name);
    CObject* object = factory ? factory(*this) : nullptr;
    if (!object)
        m_kRecord.Fail(EFailure::UnknownClass, start, name);
    return object;
}

CLinkRecord& COrrinStream::NewLinkRecord(CObject& object)
{
    CLinkRecord& record = *m_kRecords.emplace_back(std::make_unique<CLinkRecord>());
    record.m_spkObject = &object;
    return record;
}

void COrrinStream::Substitute(CLinkRecord& record, CObject& object)
{
    record.m_kLinkID.clear();
    record.m_bSubstitute = true;
    record.m_spkObject = &object;
}

void COrrinStream::ReadObject(CObject& object, CLinkRecord& record)
{
    m_pkReader->BeginObject(record.m_kLinkID, object.GetRTTI()->m_pcName);
    AddLink(m_pkReader->ReadUnsigned(), record);
    object.Fields(*m_pkReader);
}

void COrrinStream::ResolveLinks(CObject& object, CLinkRecord& record)
{
    CLinkResolver resolver(*this, record);
    object.Fields(resolver);
}

bool COrrinStream::AddLink(uint32_t id, CLinkRecord& record)
{
    return m_kLinkTable.emplace(id, &record).second;
}

CObject* COrrinStream::FindLinkedObject(uint32_t id) const
{
    const auto entry = id == 0 ? m_kLinkTable.end() : m_kLinkTable.find(id);
    return entry == m_kLinkTable.end() ? nullptr : entry->second->m_spkObject.Get();
}

void COrrinStream::LinkObjects()
{
    for (const auto& [id, record] : m_kLinkTable)
        record->m_spkObject->Link(*this, *record);
}

bool COrrinStream::CheckGraph()
{
    std::vector<CObject*> objects;
    objects.reserve(m_kRecords.size());
    for (const auto& record : m_kRecords)
        objects.push_back(record->m_spkObject.Get());
    const EFailure reason = CGraphCheck().Check(objects, m_kRoots);
    return reason == EFailure::None || m_kRecord.Fail(reason);
}

void COrrinStream::DropGraph()
{
    for (const auto& record : m_kRecords)
    {
        if (!record->m_bSubstitute)
            Unlink(*record->m_spkObject);
    }
    RemoveAllRoots();
}

std::vector<CObject*> COrrinStream::ObjectsInSaveOrder()
{
    RegisterRoots();
    std::vector<CObject*> objects = std::move(m_kSaveList);
    ClearSaveList();
    return objects;
}

void COrrinStream::ClearSaveList()
{
    m_kSaveList.clear();
    m_kSaveID.clear();
}

bool COrrinStream::AppendToSaveList(CObject& object)
{
    if (!m_kSaveID.emplace(&object, static_cast<uint32_t>(m_kSaveList.size() + 1)).second)
        return false;
    m_kSaveList.push_back(&object);
    return true;
}

uint32_t COrrinStream::LinkID(const CObject* object) const
{
    const auto entry = m_kSaveID.find(object);
    return entry == m_kSaveID.end() ? 0 : entry->second;
}

void COrrinStream::RegisterRoots()
{
    for (const Ref<CObject>& root : m_kRoots)
        root->Register(*this);
}

// Returns the number of bytes after the header, or nothing and a failure if it exceeds the limit.
std::optional<size_t> COrrinStream::PlanBuffer()
{
    m_kRecord.Clear();
    RegisterRoots();
    const uint64_t bytes = BufferBytes();
    if (bytes + kHeader.size() <= kContainerBytesLimit)
        return static_cast<size_t>(bytes);
    ClearSaveList();
    m_kRecord.Fail(EFailure::TooLarge);
    return std::nullopt;
}

uint64_t COrrinStream::BufferBytes()
{
    CFieldCounter counter;
    m_kThumbnail.Fields(counter);
    uint64_t bytes =
        4 + kThumbnailTag.size() + counter.ByteCount() + m_kRoots.size() * (4 + kRootMarker.size());
    for (const CObject* object : m_kSaveList)
        bytes += object->GetDiskUsed();
    return bytes;
}

void COrrinStream::WriteObjects(CFieldWriter& writer)
{
    m_pkWriter = &writer;
    writer.WriteString(kThumbnailTag);
    m_kThumbnail.Fields(writer);
    for (CObject* object : m_kSaveList)
    {
        if (IsRoot(object))
            writer.WriteString(kRootMarker);
        object->Save(*this);
    }
    m_pkWriter = nullptr;
    ClearSaveList();
}

void COrrinStream::WriteObject(CObject& object)
{
    m_pkWriter->WriteString(object.GetRTTI()->m_pcName);
    m_pkWriter->WriteUnsigned(LinkID(&object));
    object.Fields(*m_pkWriter);
}

bool COrrinStream::SaveBuffer(std::vector<std::byte>& out)
{
    out.clear();
    const std::optional<size_t> byteCount = PlanBuffer();
    if (!byteCount)
        return false;
    out.reserve(*byteCount);
    const auto append = [&](std::span<const std::byte> bytes) {
        out.insert(out.end(), bytes.begin(), bytes.end());
        return true;
    };
    CFieldWriter writer(append, [this](const CObject* object) { return LinkID(object); });
    WriteObjects(writer);
    return writer.Flush();
}

std::span<const std::byte> COrrinStream::FileHeader()
{
    return std::as_bytes(std::span(kHeader));
}

bool COrrinStream::SaveFile(const std::string& path)
{
    SetBaseDirectory(path);
    if (!PlanBuffer())
        return false;
    CSafeFile file;
    if (!file.Open(path))
    {
        ClearSaveList();
        return m_kRecord.Fail(file.Failure());
    }
    CFieldWriter writer([&](std::span<const std::byte> bytes) { return file.Write(bytes); },
                        [this](const CObject* object) { return LinkID(object); });
    writer.WriteBytes(FileHeader());
    WriteObjects(writer);
    if (!writer.Flush())
        return m_kRecord.Fail(EFailure::WriteError);
    return file.Commit() || m_kRecord.Fail(file.Failure());
}

} // namespace gw
