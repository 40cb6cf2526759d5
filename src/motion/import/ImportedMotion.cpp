// The message from the import program to the reader: counts and texts in front of arrays, in the byte order
// of the machine, since both programs run on the same one. The reader trusts nothing in it, because the
// program that sent it has just processed a stranger's file: every count is compared with the bytes that are
// left before anything is allocated for it.

#include "ImportedMotion.h"

#include <array>
#include <cstring>
#include <string_view>
#include <type_traits>

namespace gw {

namespace {

constexpr std::string_view kMagic = "gaitwright import 1\n";

class CWriter
{
public:
    explicit CWriter(const CByteSink& sink) : sink_(sink) {}

    bool IsGood() const { return isGood_; }

    template <class T>
    void Put(const T& value)
    {
        PutArray(std::span(&value, 1));
    }

    void Put(const std::string& text)
    {
        Put(static_cast<uint32_t>(text.size()));
        PutArray(std::span(text));
    }

    template <class T>
    void PutArray(std::span<const T> values)
    {
        static_assert(std::is_trivially_copyable_v<T>);
        isGood_ = isGood_ && (values.empty() || sink_(std::as_bytes(values)));
    }

    template <class T>
    void PutArray(std::span<T> values)
    {
        PutArray(std::span<const T>(values));
    }

private:
    const CByteSink& sink_;
    bool isGood_ = true;
};

// Every reading function returns false, and leaves its argument alone, if fewer bytes are left.
class CReader
{
public:
    explicit CReader(std::span<const std::byte> bytes) : bytes_(bytes) {}

    template <class T>
    bool Get(T& value)
    {
        static_assert(std::is_trivially_copyable_v<T>);
        if (bytes_.size() < sizeof value)
            return false;
        std::memcpy(&value, bytes_.data(), sizeof value);
        bytes_ = bytes_.subspan(sizeof value);
        return true;
    }

    bool Get(bool& value)
    {
        uint8_t byte = 0;
        if (!Get(byte))
            return false;
        value = byte != 0;
        return true;
    }

    bool Get(std::string& text)
    {
        uint32_t size = 0;
        if (!Get(size) || bytes_.size() < size)
            return false;
        text.assign(reinterpret_cast<const char*>(bytes_.data()), size);
        bytes_ = bytes_.subspan(size);
        return true;
    }

    template <class T>
    bool GetArray(std::vector<T>& values, size_t count)
    {
        static_assert(std::is_trivially_copyable_v<T>);
        if (bytes_.size() / sizeof(T) < count)
            return false;
        values.resize(count);
        if (count > 0)
            std::memcpy(values.data(), bytes_.data(), count * sizeof(T));
        bytes_ = bytes_.subspan(count * sizeof(T));
        return true;
    }

    // Reads a count of things that take at least so many bytes each.
    bool GetCount(uint32_t& count, size_t leastBytes)
    {
        return Get(count) && count <= bytes_.size() / leastBytes;
    }

    bool IsAtEnd() const { return bytes_.empty(); }

private:
    std::span<const std::byte> bytes_;
};

bool ReadClips(CReader& reader, std::vector<std::string>& clips)
{
    uint32_t count = 0;
    if (!reader.GetCount(count, sizeof(uint32_t)))
        return false;
    clips.resize(count);
    for (std::string& clip : clips)
    {
        if (!reader.Get(clip))
            return false;
    }
    return true;
}

bool ReadJoint(CReader& reader, size_t index, uint32_t frameCount, ImportedJoint& joint)
{
    if (!reader.Get(joint.name) || !reader.Get(joint.parent) || !reader.Get(joint.offset))
        return false;
    const bool isFirst = index == 0;
    const bool hasParent = joint.parent >= 0 && joint.parent < static_cast<int64_t>(index);
    if (isFirst ? joint.parent != -1 : !hasParent)
        return false;
    return reader.GetArray(joint.positions, frameCount) && reader.GetArray(joint.rotations, frameCount);
}

bool ReadJoints(CReader& reader, ImportedMotion& motion)
{
    const size_t keyBytes = size_t{motion.frameCount} * (sizeof(Vec3) + sizeof(Quat));
    uint32_t count = 0;
    if (!reader.GetCount(count, sizeof(uint32_t) + sizeof(int32_t) + sizeof(Vec3) + keyBytes))
        return false;
    motion.joints.resize(count);
    for (size_t i = 0; i < count; ++i)
    {
        if (!ReadJoint(reader, i, motion.frameCount, motion.joints[i]))
            return false;
    }
    return true;
}

} // namespace

bool WriteImported(const ImportedMotion& motion, const CByteSink& sink)
{
    CWriter writer(sink);
    writer.PutArray(std::span(kMagic));
    writer.Put(motion.outcome);
    writer.Put(motion.words);
    writer.Put(static_cast<uint32_t>(motion.clips.size()));
    for (const std::string& clip : motion.clips)
        writer.Put(clip);
    writer.Put(motion.clip);
    writer.Put(motion.rate);
    writer.Put(static_cast<uint8_t>(motion.isRateOfFile));
    writer.Put(motion.unitMeters);
    writer.Put(static_cast<uint8_t>(motion.wasTurnedUp));
    writer.Put(motion.frameCount);
    writer.Put(static_cast<uint32_t>(motion.joints.size()));
    for (const ImportedJoint& joint : motion.joints)
    {
        writer.Put(joint.name);
        writer.Put(joint.parent);
        writer.Put(joint.offset);
        writer.PutArray(std::span(joint.positions));
        writer.PutArray(std::span(joint.rotations));
    }
    return writer.IsGood();
}

bool ReadImported(std::span<const std::byte> bytes, ImportedMotion& motion)
{
    CReader reader(bytes);
    std::array<char, kMagic.size()> magic;
    if (!reader.Get(magic) || std::string_view(magic.data(), magic.size()) != kMagic)
        return false;
    return reader.Get(motion.outcome) && reader.Get(motion.words) && ReadClips(reader, motion.clips) &&
           reader.Get(motion.clip) && reader.Get(motion.rate) && reader.Get(motion.isRateOfFile) &&
           reader.Get(motion.unitMeters) && reader.Get(motion.wasTurnedUp) && reader.Get(motion.frameCount) &&
           ReadJoints(reader, motion) && reader.IsAtEnd();
}

} // namespace gw
