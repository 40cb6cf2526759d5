#pragma once

#include "CFieldArchive.h"
#include "COrrinStream.h"

#include <algorithm>
#include <cstring>
#include <gtest/gtest.h>
#include <span>
#include <sstream>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

/// Container bytes assembled by hand, value by value, so that tests do not rely on the writer.
class CSceneBytes
{
public:
    template <class T>
    CSceneBytes& Add(const T& value)
    {
        const auto bytes = std::as_bytes(std::span(&value, 1));
        m_kBytes.insert(m_kBytes.end(), bytes.begin(), bytes.end());
        return *this;
    }
    CSceneBytes& Word(uint32_t value) { return Add(value); }
    CSceneBytes& Words(std::initializer_list<uint32_t> values)
    {
        for (const uint32_t value : values)
            Add(value);
        return *this;
    }
    CSceneBytes& Byte(uint8_t value) { return Add(value); }
    CSceneBytes& Float(float value) { return Add(value); }
    CSceneBytes& Raw(std::string_view text)
    {
        const auto bytes = std::as_bytes(std::span(text));
        m_kBytes.insert(m_kBytes.end(), bytes.begin(), bytes.end());
        return *this;
    }
    CSceneBytes& Text(std::string_view text) { return Word(static_cast<uint32_t>(text.size())).Raw(text); }

    /// Appends the 21 bytes of a file header.
    CSceneBytes& Header(std::string_view version = "1.20")
    {
        return Raw("TKOrrin Version ").Raw(version).Byte(0);
    }
    /// Appends tag and block of an empty thumbnail, 58 bytes.
    CSceneBytes& EmptyThumbnail()
    {
        Text("_OrrinThumbnail").Words({0, 0, 0}).Add<uint16_t>(0).Words({96, 96, 0});
        return Words({1, 0}).Byte(0).Word(0);
    }
    CSceneBytes& Root() { return Text("_OrrinRoot"); }
    /// Appends the start of every record: class, link id, name, heads of the chains.
    CSceneBytes& Object(std::string_view className, uint32_t id, std::string_view name = {},
                        std::initializer_list<uint32_t> heads = {0, 0, 0})
    {
        return Text(className).Word(id).Text(name).Words(heads);
    }
    /// Appends the part common to all spatials: the identity, the flag, no render states.
    CSceneBytes& Spatial() { return Add(kMat4Identity).Byte(1).Word(0); }
    CSceneBytes& Node(uint32_t id, std::initializer_list<uint32_t> children = {}, std::string_view name = {},
                      std::initializer_list<uint32_t> heads = {0, 0, 0})
    {
        Object("CNode", id, name, heads).Spatial().Word(1).Byte(1).Byte(1);
        return Word(static_cast<uint32_t>(children.size())).Words(children);
    }
    /// Appends a track without keys.
    CSceneBytes& Track(uint32_t id, uint32_t target, uint32_t next)
    {
        Object("CKeyframeControl", id).Word(0).Float(0).Float(0).Float(0).Float(1).Byte(1);
        return Words({target, next}).Add(kMat4Identity).Byte(0).Words({0, 0, 0, 0, 0, 0, 0, 0});
    }
    CSceneBytes& RawData(uint32_t id, uint32_t next)
    {
        return Object("CRawData", id).Text("").Words({0, 0, next, 0, 0});
    }

    const std::vector<std::byte>& Bytes() const { return m_kBytes; }
    std::string_view View() const
    {
        return {reinterpret_cast<const char*>(m_kBytes.data()), m_kBytes.size()};
    }

private:
    std::vector<std::byte> m_kBytes;
};

/// Returns the bytes of an object part, ready for records.
inline CSceneBytes Scene()
{
    return CSceneBytes().EmptyThumbnail();
}

/// A description of fields, one per line: values as hexadecimal bytes, links as positions in the save order.
class CFieldDescriber : public CFieldArchive
{
public:
    explicit CFieldDescriber(const std::vector<CObject*>& objects)
        : CFieldArchive(false, kNewestVersion), objects_(objects)
    {
    }

    void Text(const char* name, CText& text) override { Line(name) << text.View() << '\n'; }
    bool Presence(const char* name, bool present) override
    {
        Line(name) << present << '\n';
        return present;
    }
    size_t Count(const char* name, size_t count, size_t) override
    {
        Line(name) << count << '\n';
        return count;
    }
    std::string Result() const { return m_kText.str(); }

protected:
    void Values(const char* name, EFieldKind kind, void* values, size_t count) override
    {
        Line(name) << std::hex;
        const auto* bytes = static_cast<const unsigned char*>(values);
        for (size_t i = 0; i < count * FieldBytes(kind); ++i)
            m_kText << static_cast<int>(bytes[i]) << ' ';
        m_kText << std::dec << '\n';
    }
    void Slot(const char* name, const CLinkSlot& slot) override
    {
        const auto place = std::ranges::find(objects_, slot.Get());
        Line(name) << "-> " << (place == objects_.end() ? 0 : place - objects_.begin() + 1) << '\n';
    }

private:
    std::ostream& Line(const char* name) { return m_kText << "  " << name << ": "; }

    const std::vector<CObject*>& objects_;
    std::ostringstream m_kText;
};

/// Returns everything that a file of the stream's roots would contain, except ids: equal texts mean equal
/// graphs.
inline std::string Describe(COrrinStream& stream)
{
    const std::vector<CObject*> objects = stream.ObjectsInSaveOrder();
    std::string text;
    for (CObject* object : objects)
    {
        CFieldDescriber describer(objects);
        object->Fields(describer);
        text += std::string(stream.IsRoot(object) ? "root " : "") + object->GetRTTI()->m_pcName + '\n' +
                describer.Result();
    }
    return text;
}

inline std::string DescribeRoot(CObject* root)
{
    COrrinStream stream;
    stream.AddRoot(root);
    return Describe(stream);
}

/// Loads an object part without header from its own buffer, so that one byte too many is noticed.
inline bool LoadBytes(COrrinStream& stream, std::span<const std::byte> bytes)
{
    const std::vector<std::byte> block(bytes.begin(), bytes.end());
    return stream.LoadBuffer(block, 0);
}

inline std::vector<std::byte> SaveBytes(COrrinStream& stream)
{
    std::vector<std::byte> bytes;
    stream.SaveBuffer(bytes);
    return bytes;
}

/// Returns whether a scene survives being written and read again.
inline bool SurvivesRewriting(COrrinStream& stream)
{
    const std::string before = Describe(stream);
    COrrinStream again;
    return LoadBytes(again, SaveBytes(stream)) && Describe(again) == before;
}

/// Expects a graph to survive that, in as many bytes as its objects say.
inline void ExpectComesBack(CObject* root)
{
    COrrinStream stream;
    stream.AddRoot(root);
    EXPECT_TRUE(SurvivesRewriting(stream));
    uint64_t size = 58 + 14;
    for (const CObject* object : stream.ObjectsInSaveOrder())
        size += object->GetDiskUsed();
    EXPECT_EQ(SaveBytes(stream).size(), size);
}

/// Reads every beginning of a graph's bytes, and the bytes with a word put over each place, and uses the
/// roots: what is read must be whole, and all of it is freed.
template <class Use>
void ExpectDamageStaysInside(CObject* root, std::initializer_list<uint32_t> words, Use use)
{
    COrrinStream source;
    source.AddRoot(root);
    const std::vector<std::byte> whole = SaveBytes(source);
    const uint32_t before = g_uiObjectCount;
    const auto load = [&](std::span<const std::byte> bytes) {
        COrrinStream stream;
        const bool loaded = LoadBytes(stream, bytes);
        ASSERT_EQ(loaded, !stream.Record().Failure());
        ASSERT_LE(stream.Record().Failure().where, bytes.size());
        ASSERT_TRUE(SurvivesRewriting(stream));
        for (size_t i = 0; i < stream.GetRootCount(); ++i)
            use(*stream.GetRoot(i));
    };
    for (size_t size = 0; size < whole.size() && !testing::Test::HasFatalFailure(); ++size)
    {
        SCOPED_TRACE(size);
        load(std::span(whole).first(size));
    }
    for (const uint32_t word : words)
    {
        for (size_t at = 0; at + 4 <= whole.size() && !testing::Test::HasFatalFailure(); ++at)
        {
            SCOPED_TRACE(testing::Message() << word << " at " << at);
            std::vector<std::byte> bytes = whole;
            std::memcpy(bytes.data() + at, &word, 4);
            load(bytes);
        }
    }
    EXPECT_EQ(g_uiObjectCount, before);
}

} // namespace gw
