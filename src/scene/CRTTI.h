#pragma once

namespace gw {

class CObject;

/// The run-time record of a scene class. Two classes are the same exactly when their record addresses are
/// equal.
struct CRTTI
{
    const char* m_pcName;  ///< class name, as written into container files
    const CRTTI* m_pkBase; ///< record of the direct base class, null for CObject
};

/// Whether a record equals an object's class record or one on its base chain.
bool IsDerivedFrom(const CObject& object, const CRTTI* record);
/// The object when IsDerivedFrom holds, else null; a null record yields null.
CObject* DynamicCast(CObject& object, const CRTTI* record);

/// The object as a T when its class records say that it is one, else null. Null in, null out.
template <class T>
T* RecordCast(CObject* object)
{
    return object && IsDerivedFrom(*object, &T::ms_kRTTI) ? static_cast<T*>(object) : nullptr;
}

} // namespace gw
