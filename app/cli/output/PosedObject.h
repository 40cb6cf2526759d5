#pragma once

namespace gw {

class CJsonWriter;
class CSpatial;

/// Writes what an update has left in an object: matrices and bound, and what else its class has.
void WritePosedObject(CJsonWriter& json, CSpatial& object);

} // namespace gw
