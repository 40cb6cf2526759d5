#pragma once

#include "CFailureRecord.h"
#include "CKeyArray.h"
#include "CText.h"
#include "CVersion.h"
#include "Mat4.h"
#include "Quat.h"
#include "Ref.h"
#include "Vec3.h"
#include "Watch.h"

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <type_traits>
#include <vector>

namespace gw {

/// The type of a stored value. Names say how it is displayed; the sizes are those in the file.
enum class EFieldKind : uint8_t
{
    Bool,       ///< 1 byte, 0 or 1
    Byte,       ///< 1 byte
    Word,       ///< 2 bytes
    Unsigned,   ///< 4 bytes
    Signed,     ///< 4 bytes
    Float,      ///< 4 bytes
    Vector,     ///< 12 bytes
    Quaternion, ///< 16 bytes
    Matrix,     ///< 64 bytes
};

/// Returns the size in bytes of one value of a kind, in the file and in memory.
constexpr size_t FieldBytes(EFieldKind kind)
{
    constexpr size_t kBytes[] = {1, 1, 2, 4, 4, 4, 12, 16, 64};
    return kBytes[static_cast<size_t>(kind)];
}

/// The element type of a list.
enum class EListKind : uint8_t
{
    Links,
    Records, ///< elements with their own fields
};

/// The kind of a C++ type.
template <class T>
constexpr EFieldKind FieldKind()
{
    if constexpr (std::is_same_v<T, float>)
        return EFieldKind::Float;
    else if constexpr (std::is_same_v<T, Vec3>)
        return EFieldKind::Vector;
    else if constexpr (std::is_same_v<T, Quat>)
        return EFieldKind::Quaternion;
    else if constexpr (std::is_same_v<T, Mat4>)
        return EFieldKind::Matrix;
    else if constexpr (std::is_same_v<T, int32_t>)
        return EFieldKind::Signed;
    else if constexpr (std::is_same_v<T, uint32_t>)
        return EFieldKind::Unsigned;
    else if constexpr (std::is_same_v<T, uint16_t>)
        return EFieldKind::Word;
    else
    {
        static_assert(sizeof(T) == 1);
        return EFieldKind::Byte;
    }
}

/// A reference from one object to another, independent of its class, for archives to read, write, resolve or
/// follow.
class CLinkSlot
{
public:
    template <class T>
    static CLinkSlot Counted(Ref<T>& slot)
    {
        return {&slot, true, [](void* p) -> CObject* { return static_cast<Ref<T>*>(p)->Get(); },
                [](void* p, CObject* object) { *static_cast<Ref<T>*>(p) = dynamic_cast<T*>(object); }};
    }
    template <class T>
    static CLinkSlot Plain(Watch<T>& slot)
    {
        return {&slot, false, [](void* p) -> CObject* { return static_cast<Watch<T>*>(p)->Get(); },
                [](void* p, CObject* object) { static_cast<Watch<T>*>(p)->Set(dynamic_cast<T*>(object)); }};
    }

    CObject* Get() const { return m_pkGet(m_pkSlot); }
    /// Sets the reference. An object of a class other than the slot's sets it to null.
    void Set(CObject* object) const { m_pkSet(m_pkSlot, object); }
    /// Returns whether the slot keeps its object alive. Only such links are registered and followed.
    bool IsCounted() const { return m_bCounted; }

private:
    CLinkSlot(void* slot, bool counted, CObject* (*get)(void*), void (*set)(void*, CObject*))
        : m_pkSlot(slot), m_pkGet(get), m_pkSet(set), m_bCounted(counted)
    {
    }

    void* m_pkSlot;
    CObject* (*m_pkGet)(void*);
    void (*m_pkSet)(void*, CObject*);
    bool m_bCounted;
};

/// Visits a class's list of stored fields. Each scene class lists its fields once, base class first, in file
/// order, in CObject::Fields. Derived archives read, write, count, resolve, follow and describe them.
class CFieldArchive
{
public:
    virtual ~CFieldArchive() = default;

    /// Returns whether fields are being filled from a file. Only then can values, sizes and counts change.
    bool IsReading() const { return m_bReading; }
    /// Returns whether the file has at least this version; always true unless an old file is being read.
    bool AtLeast(CVersion version) const { return m_kVersion.AtLeast(version); }

    void Bool(const char* name, bool& value) { Plain(name, EFieldKind::Bool, &value, 1); }
    void Byte(const char* name, uint8_t& value) { Plain(name, EFieldKind::Byte, &value, 1); }
    void Word(const char* name, uint16_t& value) { Plain(name, EFieldKind::Word, &value, 1); }
    void Unsigned(const char* name, uint32_t& value) { Plain(name, EFieldKind::Unsigned, &value, 1); }
    void Signed(const char* name, int32_t& value) { Plain(name, EFieldKind::Signed, &value, 1); }
    void Float(const char* name, float& value) { Plain(name, EFieldKind::Float, &value, 1); }
    void Vector(const char* name, Vec3& value) { Plain(name, EFieldKind::Vector, &value, 1); }
    void Matrix(const char* name, Mat4& value) { Plain(name, EFieldKind::Matrix, &value, 1); }
    /// An array of values without a stored count.
    template <class R>
    void Row(const char* name, R& values)
    {
        Plain(name, FieldKind<typename R::value_type>(), values.data(), values.size());
    }

    /// A length followed by the characters.
    virtual void Text(const char* name, CText& text) = 0;

    template <class T>
    void Link(const char* name, Ref<T>& slot)
    {
        if (!m_pkHeld)
            Slot(name, CLinkSlot::Counted(slot));
        else if (slot)
            m_pkHeld->push_back(slot.Get());
    }
    template <class T>
    void PlainLink(const char* name, Watch<T>& slot)
    {
        if (!m_pkHeld)
            Slot(name, CLinkSlot::Plain(slot));
    }
    /// A count followed by one link per element. Slot is Held<T> or Watch<T>.
    template <class Slots>
    void Links(const char* name, Slots& slots)
    {
        if (m_pkHeld)
            return LinkEach(name, slots);
        slots.resize(Count(name, slots.size(), 4));
        LinkRow(name, slots);
    }
    /// An array of links without a stored count.
    template <class Slots>
    void LinkRow(const char* name, Slots& slots)
    {
        BeginArray(name, EListKind::Links);
        LinkEach(name, slots);
        EndArray();
    }

    /// A count followed by that many plain values, copied as one block.
    template <class T>
    void Block(const char* name, std::vector<T>& values)
    {
        if (m_bLinksOnly)
            return;
        Elements(name, values, Count(name, values.size(), sizeof(T)));
    }
    template <class T>
    void Block(const char* name, CKeyArray<T>& keys);
    /// Same with a signed count; a negative count means no elements.
    template <class T>
    void SignedBlock(const char* name, std::vector<T>& values)
    {
        if (m_bLinksOnly)
            return;
        int32_t stored = 0;
        if (IsReading())
            Signed(name, stored);
        Elements(name, values,
                 IsReading() ? Fitting(stored, sizeof(T)) : Count(name, values.size(), sizeof(T)));
    }
    /// A presence word, followed by `count` plain values if it is not 0. When reading, a zero word leaves the
    /// block empty whatever the count is. A negative count with a block is damage, because the block's length
    /// is unknown.
    template <class T>
    void OptionalBlock(const char* name, std::vector<T>& values, int64_t count)
    {
        if (m_bLinksOnly)
            return;
        const bool present = Presence(name, !values.empty());
        if (IsReading() && present && count < 0)
            Refuse(EFailure::BadCount);
        if (present)
            Elements(name, values, Fitting(count, sizeof(T)));
        else if (IsReading())
            values.clear();
    }

    /// A count followed by elements with their own fields: fields(archive, element).
    template <class T, class F>
    void Array(const char* name, std::vector<T>& elements, F fields);

    /// A presence word; any value but 0 means present. Returns the value from the file when reading,
    /// otherwise `present`.
    virtual bool Presence(const char* name, bool present) = 0;
    /// A 32-bit count of elements of at least `leastBytes` each. When reading, returns the count in the file,
    /// or 0 and a failure if the remaining bytes cannot hold that many. Other archives return `count`.
    virtual size_t Count(const char* name, size_t count, size_t leastBytes) = 0;
    /// Returns `count` if the rest of the file can hold that many elements of this size, otherwise 0 and a
    /// failure. Negative counts are 0.
    virtual size_t Fitting(int64_t count, size_t elementBytes);
    /// Fails the operation because of damage or lack of space. When reading, all later fields read as zero.
    virtual void Refuse(EFailure) {}

protected:
    CFieldArchive(bool reading, CVersion version) : m_kVersion(version), m_bReading(reading) {}
    /// For archives that only look at links. They are not shown plain values, because skipping each one would
    /// cost a virtual call in every search of a tree.
    explicit CFieldArchive(CVersion version) : m_kVersion(version), m_bReading(false), m_bLinksOnly(true) {}
    /// For searches of a tree, which only need the objects that each object keeps alive. They are appended to
    /// `held` in file order, without a virtual call per link.
    explicit CFieldArchive(std::vector<CObject*>& held) : CFieldArchive(kNewestVersion) { m_pkHeld = &held; }

    virtual void Values(const char* name, EFieldKind kind, void* values, size_t count) = 0;
    /// The same value repeated `count` times.
    virtual void Repeated(const char* name, EFieldKind kind, const void* value, size_t count);
    virtual void Slot(const char* name, const CLinkSlot& slot) = 0;
    virtual void BeginArray(const char*, EListKind) {}
    virtual void EndArray() {}
    virtual void BeginElement() {}
    virtual void EndElement() {}

private:
    void Plain(const char* name, EFieldKind kind, void* values, size_t count)
    {
        if (!m_bLinksOnly)
            Values(name, kind, values, count);
    }
    template <class T>
    void Elements(const char* name, std::vector<T>& values, size_t count);
    template <class Slots>
    void LinkEach(const char* name, Slots& slots)
    {
        for (auto& slot : slots)
        {
            if constexpr (requires { slot.Set(nullptr); })
                PlainLink(name, slot);
            else
                Link(name, slot);
        }
    }

    CVersion m_kVersion;
    bool m_bReading;
    bool m_bLinksOnly = false;
    std::vector<CObject*>* m_pkHeld = nullptr;
};

/// Counts the bytes that fields take in a file.
class CFieldCounter : public CFieldArchive
{
public:
    CFieldCounter() : CFieldArchive(false, kNewestVersion) {}

    uint64_t ByteCount() const { return m_uiBytes; }
    void Text(const char* name, CText& text) override;
    bool Presence(const char* name, bool present) override;
    size_t Count(const char* name, size_t count, size_t leastBytes) override;

protected:
    void Values(const char* name, EFieldKind kind, void* values, size_t count) override;
    void Repeated(const char* name, EFieldKind kind, const void* value, size_t count) override;
    void Slot(const char* name, const CLinkSlot& slot) override;

private:
    uint64_t m_uiBytes = 0;
};

// A vector zeroes the elements it gains. In small pieces, the zeros are still in the cache when they are
// overwritten, so a large block is as fast as a plain copy.
template <class T>
void CFieldArchive::Elements(const char* name, std::vector<T>& values, size_t count)
{
    constexpr size_t kPiece = (size_t{1} << 16) / sizeof(T);
    if (!IsReading())
        return Values(name, FieldKind<T>(), values.data(), values.size());
    values.clear();
    values.reserve(count);
    while (values.size() < count)
    {
        const size_t start = values.size();
        values.resize(std::min(count, start + kPiece));
        Values(name, FieldKind<T>(), values.data() + start, values.size() - start);
    }
}

template <class T>
void CFieldArchive::Block(const char* name, CKeyArray<T>& keys)
{
    if (m_bLinksOnly)
        return;
    const size_t count = Count(name, keys.size(), sizeof(T));
    if (!IsReading() && keys.Distinct().size() < count)
        return Repeated(name, FieldKind<T>(), &keys.front(), count);
    if (!IsReading())
        return Elements(name, keys.Expand(), count);
    std::vector<T> values;
    Elements(name, values, count);
    keys = std::move(values);
}

template <class T, class F>
void CFieldArchive::Array(const char* name, std::vector<T>& elements, F fields)
{
    if (std::is_trivially_copyable_v<T> && m_bLinksOnly) // has no links
        return;
    T least{};
    CFieldCounter counter;
    if (IsReading())
        fields(counter, least);
    elements.resize(Count(name, elements.size(), static_cast<size_t>(counter.ByteCount())));
    BeginArray(name, EListKind::Records);
    for (T& element : elements)
    {
        BeginElement();
        fields(static_cast<CFieldArchive&>(*this), element);
        EndElement();
    }
    EndArray();
}

/// Skips everything but links.
class CLinkArchive : public CFieldArchive
{
public:
    void Text(const char*, CText&) override {}
    bool Presence(const char*, bool present) override { return present; }
    size_t Count(const char*, size_t count, size_t) override { return count; }

protected:
    using CFieldArchive::CFieldArchive;
    void Values(const char*, EFieldKind, void*, size_t) override {}
};

/// Appends the objects that one keeps alive to a list, in file order.
class CHeldCollector : public CLinkArchive
{
public:
    explicit CHeldCollector(std::vector<CObject*>& held) : CLinkArchive(held) {}

protected:
    void Slot(const char*, const CLinkSlot&) override {}
};

/// Passes every link to a function, in file order.
template <class F>
class CLinkVisitor : public CLinkArchive
{
public:
    explicit CLinkVisitor(F visit) : CLinkArchive(kNewestVersion), m_kVisit(visit) {}

protected:
    void Slot(const char*, const CLinkSlot& slot) override { m_kVisit(slot); }

private:
    F m_kVisit;
};

} // namespace gw
