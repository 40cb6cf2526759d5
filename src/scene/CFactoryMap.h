#pragma once

#include "CRTTI.h"

#include <map>
#include <span>
#include <string>
#include <string_view>

namespace gw {

class COrrinStream;

/// Makes an object and lets it read itself from the stream; null for a class that cannot be made.
using CObjectFactory = CObject* (*)(COrrinStream& stream);

/// From class name to factory: by it a container's class names become objects. One for the whole program,
/// filled before main by the class tables of the rooms (SceneClasses.cpp and its kin).
class CFactoryMap
{
public:
    static CFactoryMap& Instance();

    /// An entry set twice keeps the last value.
    void Set(std::string_view className, CObjectFactory factory)
    {
        m_kFactory[std::string(className)] = factory;
    }
    /// The factory of a class, or null for a name that is not registered.
    CObjectFactory Find(std::string_view className) const;
    const std::map<std::string, CObjectFactory, std::less<>>& Entries() const { return m_kFactory; }

private:
    std::map<std::string, CObjectFactory, std::less<>> m_kFactory;
};

/// One row of a room's class table.
struct FactoryRow
{
    const CRTTI* m_pkRecord;
    CObjectFactory m_pkFactory;
};

/// Enters a table in the map. The answer is the number of rows, for the static that calls this.
int RegisterClasses(std::span<const FactoryRow> rows);

/// The factory of every abstract class.
CObject* MakeNothing(COrrinStream& stream);

} // namespace gw
