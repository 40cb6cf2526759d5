#pragma once

namespace gw {

class CJsonWriter;
class CSpatial;

/// Writes an object's state after an update: matrices, bound, and the values of its class.
void WritePosedObject(CJsonWriter& json, CSpatial& object);

} // namespace gw
