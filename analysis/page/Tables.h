#pragma once

namespace gw {

class CMarkup;
struct MeasuredConversion;

/// Appends how the parts of the body point; with a column for the plain rules where there are such figures.
void AppendPartTable(CMarkup& page, const MeasuredConversion& measured, const MeasuredConversion* plain);
/// The same bone by bone, and how the bones shake.
void AppendBoneTable(CMarkup& page, const MeasuredConversion& measured, const MeasuredConversion* plain);
/// Appends what the feet do, a column each; nothing without a mapped foot.
void AppendFootTable(CMarkup& page, const MeasuredConversion& measured);

} // namespace gw
