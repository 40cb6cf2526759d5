#pragma once

namespace gw {

class CObject;

/// The run-time record of a scene class. Two classes are the same if their records have the same address.
struct CRTTI
{
    const char* m_pcName;  ///< class name, as written into container files
    const CRTTI* m_pkBase; ///< record of the direct base class, null for CObject
};

/// Returns whether a record is the object's class record or one of its bases.
bool IsDerivedFrom(const CObject& object, const CRTTI* record);
/// Returns the object if IsDerivedFrom holds, otherwise null; a null record yields null.
CObject* DynamicCast(CObject& object, const CRTTI* record);

/// Returns the object as a T if its class records allow it, otherwise null. Null yields null.
template <class T>
T* RecordCast(CObject* object)
{
    return object && IsDerivedFrom(*object, &T::ms_kRTTI) ? static_cast<T*>(object) : nullptr;
}

} // namespace gw
