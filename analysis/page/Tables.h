#pragma once

namespace gw {

class CMarkup;
struct MeasuredConversion;

/// Appends how the parts of the body point; with a column for the plain rules where there are such figures.
void AppendPartTable(CMarkup& page, const MeasuredConversion& measured, const MeasuredConversion* plain);
/// The same bone by bone.
void AppendBoneTable(CMarkup& page, const MeasuredConversion& measured, const MeasuredConversion* plain);
/// Appends what feet and hands do, a column each; nothing where none is mapped.
void AppendFeetAndHands(CMarkup& page, const MeasuredConversion& measured);

} // namespace gw
