// The form of a model document.

#ifndef HOST_MODEL_HX_SCHEMA_H
#define HOST_MODEL_HX_SCHEMA_H

struct HX_Document;

/// The text of host/model.schema.json, which the build puts into the program.
extern const char kHxModelSchema[];

/// Throws HX_DocumentError at one place that differs from the schema, always
/// the same one for a document. Understands the part of JSON Schema that the
/// schema uses: $ref to $defs (alone), type, enum, required, properties,
/// additionalProperties (false), items, allOf with if and then, minLength and
/// minItems (1), pattern (of the whole text), minimum, maximum,
/// exclusiveMinimum.
void HX_CheckSchema(const HX_Document& document);

#endif  // HOST_MODEL_HX_SCHEMA_H
