#include "CDraftShelf.h"

namespace gw {

// The process that created a temporary folder deletes it.
CDraftShelf::CDraftShelf(const DraftShelfLink& link)
    : m_kFolder(link.folder), m_bTemporary(link.isTemporary), m_uiOwner(0), m_uiJobCount(link.jobCount),
      m_kMemory(link.memory), m_pkStates(static_cast<State*>(m_kMemory.Get()))
{
}

DraftShelfLink CDraftShelf::Link() const
{
    return {.folder = m_kFolder,
            .isTemporary = m_bTemporary,
            .memory = m_kMemory.Name(),
            .jobCount = m_uiJobCount};
}

} // namespace gw
