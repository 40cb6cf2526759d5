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
constexpr size_t kHeaderCompared = 16;                               // the digits of the version are free
constexpr size_t kLeastFileBytes = 21;
constexpr std::string_view kRootMarker = "_OrrinRoot";
constexpr std::string_view kThumbnailTag = "_OrrinThumbnail";
// Leaves ids for clones and for what is built beside a file.
constexpr uint32_t kObjectLimit = kObjectIDCount / 2;

// "%1d.%2d" as sscanf reads it: blanks and a sign may stand before either number and count against no width
// but the digits' own, so " 1. 2" has its place here too.
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

// Resolves ids into the slots of an object: plain values are passed over, links take the record's ids in
// order.
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

// Empties every counted slot of an object, so that a graph that must not stand falls apart without recursion.
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
    m_kRecord.Clear(); // of what the missing bytes looked like
    return m_kRecord.Fail(EFailure::Changed);
}

bool COrrinStream::LoadThumbnailOnly(std::span<const std::byte> bytes, size_t position)
{
    m_kRecord.Clear();
    if (position == 0)
        m_kVersion = kNewestVersion;
    CFieldReader reader(bytes, position, m_kVersion, m_kRecord);
    reader.ReadString(); // the tag, which nobody compares
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
    reader.ReadString(); // the tag, which nobody compares
    m_kThumbnail = {};
    m_kThumbnail.Fields(reader);

    reader.SetSource(m_pkFile);
    m_pkReader = &reader;
    const bool whole = ReadObjects();
    m_pkReader = nullptr;
    if (whole)
        LinkObjects();
    const bool sound = whole && CheckGraph();
    if (!sound && whole)
        DropGraph();
    m_kLinkTable.clear();
    // Frees what no counted reference holds. Records go in file order; where links did not resolve to holders
    // the objects go one by one and nothing recurses deeper than the graph that was checked.
    m_kRecords.clear();
    return sound;
}

bool COrrinStream::ReadObjects()
{
    while (!m_pkReader->AtEnd() && !m_pkReader->IsDamaged())
    {
        bool marked = false;
        CObject* object = ReadNextObject(marked);
        if (!object)
            return false;
        if (m_pkReader->IsDamaged())
        {
            // The record in which reading stopped leaves nothing.
            const CLinkRecord* last = m_kRecords.back().get();
            std::erase_if(m_kLinkTable, [=](const auto& entry) { return entry.second == last; });
            m_kRecords.pop_back();
            return false;
        }
        if (marked)
            AddRoot(object);
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
    // A class name is a C text: a zero byte ends it.
    const std::string name(className.substr(0, className.find('\0')));
    // An object takes an id, and the search for a free one only ends where there is one.
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

// The bytes behind the header, or nothing and a failure where a file cannot be that large.
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
