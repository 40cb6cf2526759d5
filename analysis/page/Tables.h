#pragma once

namespace gw {

class CMarkup;
struct MeasuredConversion;

/// Appends the direction errors of the parts of the body, with a column for the default conversion if `plain`
/// is given.
void AppendPartTable(CMarkup& page, const MeasuredConversion& measured, const MeasuredConversion* plain);
/// Appends the same for each bone.
void AppendBoneTable(CMarkup& page, const MeasuredConversion& measured, const MeasuredConversion* plain);
/// Appends the figures of feet and hands, one column each; nothing if none is mapped.
void AppendFeetAndHands(CMarkup& page, const MeasuredConversion& measured);

} // namespace gw
