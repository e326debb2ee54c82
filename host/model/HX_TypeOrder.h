// Which types stand on which: circles, depth and size.

#ifndef HOST_MODEL_HX_TYPEORDER_H
#define HOST_MODEL_HX_TYPEORDER_H

struct HX_ModelReading;

/// A type stands on the type in `of` and on the types of its fields. Enters the
/// first circle into the model, and reports chains of types that are too long
/// and types with too many elements of arrays, by the limits of the schema.
void HX_CheckTypeOrder(HX_ModelReading& reading);

#endif  // HOST_MODEL_HX_TYPEORDER_H
