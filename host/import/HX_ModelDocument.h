// Writes an imported model as a model document (host/model.schema.json).

#ifndef HOST_IMPORT_HX_MODELDOCUMENT_H
#define HOST_IMPORT_HX_MODELDOCUMENT_H

#include <string>

class HX_Dictionary;
class HX_NameItems;
class HX_Rules;
class HX_TypeTable;
struct HX_ModelBlock;

struct HX_ModelParts {
  const HX_ModelBlock& root;
  const HX_Rules& rules;
  const HX_Dictionary& dictionary;
  const HX_TypeTable& types;
  const HX_NameItems& items;
};

std::string HX_WriteModelDocument(const HX_ModelParts& parts);

#endif  // HOST_IMPORT_HX_MODELDOCUMENT_H
