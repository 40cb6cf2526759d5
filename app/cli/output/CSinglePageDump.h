#pragma once

#include "CHTMLDump.h"
#include "CSpool.h"

#include <string>

namespace gw {

/// A dump as one page: the folding trees, then a section for each object. Links to the objects' pages become
/// links to their sections.
class CSinglePageDump : public CHTMLDump
{
public:
    CSinglePageDump() : CHTMLDump({}) {}

    /// Writes the sites that were made with WriteSite. Returns false if that fails.
    bool WriteTo(const std::string& path);

protected:
    bool Write(const COrnHTMLPage& page, const std::string& fileName) override;

private:
    std::string m_kTrees; ///< scripts
    CSpool m_kSections;
};

} // namespace gw
