#pragma once

#include "CRTTI.h"

#include <map>
#include <shared_mutex>
#include <span>
#include <string>
#include <string_view>

namespace gw {

class COrrinStream;

/// Creates an object and reads it from the stream; returns null for a class that cannot be created.
using CObjectFactory = CObject* (*)(COrrinStream& stream);

/// Maps class names in containers to factories. One for the whole program, filled before main by the class
/// tables of the rooms (SceneClasses.cpp and similar files). Threads may set and find factories at the same
/// time.
class CFactoryMap
{
public:
    static CFactoryMap& Instance();

    /// Registers a factory; the last one for a name wins.
    void Set(std::string_view className, CObjectFactory factory);
    /// Returns the factory of a class, or null for an unregistered name.
    CObjectFactory Find(std::string_view className) const;
    /// Returns all factories; do not set any meanwhile.
    const std::map<std::string, CObjectFactory, std::less<>>& Entries() const { return m_kFactory; }

private:
    std::map<std::string, CObjectFactory, std::less<>> m_kFactory;
    mutable std::shared_mutex m_kMutex;
};

/// One row of a room's class table.
struct FactoryRow
{
    const CRTTI* m_pkRecord;
    CObjectFactory m_pkFactory;
};

/// Registers all rows of a table. Returns the row count, to initialize the static that calls this.
int RegisterClasses(std::span<const FactoryRow> rows);

/// The factory of abstract classes; returns null.
CObject* MakeNothing(COrrinStream& stream);

} // namespace gw
