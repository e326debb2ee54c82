// The form of a model document.

#ifndef HOST_HX_SCHEMA_H
#define HOST_HX_SCHEMA_H

class HX_DocumentNode;

/// The text of host/model.schema.json, which the build puts into the program.
extern const char kHxModelSchema[];

/// Throws HX_DocumentError at one place that differs from the schema, always
/// the same one for a document. Understands the part of JSON Schema that the
/// schema uses: $ref, type, enum, required, properties, additionalProperties,
/// items, allOf with if and then, minItems, minLength, pattern (of the whole
/// text), minimum, maximum, exclusiveMinimum.
void HX_CheckSchema(const HX_DocumentNode& root);

#endif  // HOST_HX_SCHEMA_H
